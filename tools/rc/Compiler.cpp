#include "tools/rc/Compiler.h"

#include "tools/rc/Encoding.h"
#include "tools/rc/Process.h"
#include "tools/rc/Rewriter.h"

#include <algorithm>
#include <fstream>
#include <iterator>

namespace rc {

namespace {

namespace fs = std::filesystem;

std::string readFile(const fs::path& path) {
    std::ifstream file(path, std::ios::binary);
    if (!file) {
        throw Fault{{path.string(), 0}, "cannot be read"};
    }
    return {std::istreambuf_iterator<char>(file), {}};
}

void writeFile(const fs::path& path, const std::string& text) {
    std::ofstream file(path, std::ios::binary);
    if (!(file << text).flush()) {
        throw Fault{{path.string(), 0}, "cannot be written"};
    }
}

fs::path beside(const fs::path& output, const char* extension) {
    return fs::path(output).concat(extension);
}

// Paths that an `#include` line of the script may mean: with backslashes, or in another case than the file's.
std::string withRealInclude(const std::string& line, const std::vector<fs::path>& folders) {
    const std::size_t start = line.find_first_not_of(" \t");
    if (start == std::string::npos || line[start] != '#' || line.find("include", start) == std::string::npos) {
        return line;
    }
    const std::size_t open = line.find('"');
    const std::size_t close = open == std::string::npos ? open : line.find('"', open + 1);
    if (close == std::string::npos) {
        return line;
    }
    for (const fs::path& folder : folders) {
        if (const fs::path found = findFile(folder, line.substr(open + 1, close - open - 1)); !found.empty()) {
            return line.substr(0, open + 1) + found.string() + line.substr(close);
        }
    }
    return line;
}

// The script in UTF-8, behind a mark that keeps the author's file and lines in every message.
std::string preparedScript(const Options& options, const std::vector<fs::path>& folders) {
    const std::string text = withoutByteOrderMark(readFile(options.script));
    std::string prepared = "#line 1 \"" + options.script.string() + "\"\n";
    for (std::size_t at = 0; at < text.size();) {
        const std::size_t end = std::min(text.find('\n', at), text.size());
        prepared += withRealInclude(text.substr(at, end - at), folders) + "\n";
        at = end + 1;
    }
    return prepared;
}

std::string preprocess(const Options& options, const std::vector<fs::path>& folders) {
    std::vector<std::string> command = {options.preprocessor, "-E", "-xc", "-w", "-undef", "-DRC_INVOKED"};
    for (const std::string& definition : options.definitions) {
        command.push_back("-D" + definition);
    }
    for (const fs::path& folder : folders) {
        command.push_back("-I" + folder.string());
    }
    command.emplace_back("-");
    const ChildResult result = run(command, preparedScript(options, folders));
    // The preprocessor's messages carry the author's file and line already.
    if (result.exitCode != 0) {
        throw Fault{{}, result.errors};
    }
    return result.output;
}

ChildResult compileText(const Options& options, const std::string& text, const fs::path& output) {
    const fs::path source = beside(options.output, ".rc");
    writeFile(source, text);
    // Without the end of options, the compiler takes a name such as /check/x.rc for its option /c.
    return run({options.compiler, "/no-preprocess", "/C", "65001", "/FO", output.string(), "--", source.string()});
}

// The compiler tells what is wrong but not where. The statement is the first one with which it fails; the line within
// it is that of the word the message ends with, if there is just one.
Place placeOfError(const Script& script, const Statement& statement, const std::string& message) {
    const std::size_t got = message.rfind("got ");
    std::size_t line = statement.firstLine();
    if (got != std::string::npos) {
        const std::string word = message.substr(got + 4, message.find_last_not_of(" \n") + 1 - got - 4);
        const auto isWord = [&](const Token& token) { return token.text == word || token.text == '"' + word + '"'; };
        if (std::ranges::count_if(statement.tokens, isWord) == 1) {
            line = std::ranges::find_if(statement.tokens, isWord)->line;
        }
    }
    return script.lines[line].place;
}

std::string oneLine(std::string message) {
    if (message.starts_with("llvm-rc: ")) {
        message.erase(0, 9);
    }
    std::ranges::replace(message, '\n', ' ');
    message.erase(message.find_last_not_of(' ') + 1);
    return message;
}

// Finds the shortest beginning of the script that fails and reports its last statement.
[[noreturn]] void reportError(const Options& options, const Script& script, const std::vector<std::string>& texts) {
    const fs::path output = beside(options.output, ".failed");
    const auto compileFirst = [&](std::size_t count) {
        std::string text;
        for (std::size_t i = 0; i < count; ++i) {
            text += texts[i];
        }
        return compileText(options, text, output);
    };
    std::size_t good = 0;
    std::size_t bad = texts.size();
    while (bad - good > 1) {
        const std::size_t middle = good + (bad - good) / 2;
        (compileFirst(middle).exitCode == 0 ? good : bad) = middle;
    }
    const std::string message = compileFirst(bad).errors;
    fs::remove(output);
    const Place place =
        texts.empty() ? Place{options.script.string(), 1} : placeOfError(script, script.statements[bad - 1], message);
    throw Fault{place, oneLine(message)};
}

// The script itself may be in UTF-16, but what it includes is read by the preprocessor, which would see garbage.
void refuseWideIncludes(const Options& options, const Script& script) {
    for (const fs::path& file : script.files) {
        char mark[2] = {};
        std::ifstream(file, std::ios::binary).read(mark, sizeof mark);
        const std::string_view bytes(mark, sizeof mark);
        if (file != options.script && (bytes == "\xFF\xFE" || bytes == "\xFE\xFF")) {
            throw Fault{{file.string(), 1}, "an included file in UTF-16: save it as UTF-8"};
        }
    }
}

std::string escapedForMake(const fs::path& path) {
    std::string text;
    for (const char c : path.string()) {
        if (c == ' ' || c == '#') {
            text += '\\';
        }
        text += c == '$' ? "$$" : std::string(1, c);
    }
    return text;
}

void writeDependencies(const Options& options, const Script& script, const Rewriter& rewriter) {
    std::string rule = escapedForMake(options.output) + ":";
    for (const auto* files : {&script.files, &rewriter.files()}) {
        for (const fs::path& file : *files) {
            rule += " \\\n  " + escapedForMake(fs::absolute(file));
        }
    }
    writeFile(options.dependencies, rule + "\n");
}

} // namespace

void compile(const Options& options) {
    std::vector<fs::path> folders = {fs::absolute(options.script).parent_path()};
    folders.insert(folders.end(), options.includes.begin(), options.includes.end());
    const Script script = parseScript(preprocess(options, folders));
    refuseWideIncludes(options, script);
    Rewriter rewriter(folders);
    std::vector<std::string> texts;
    std::string all;
    for (const Statement& statement : script.statements) {
        all += texts.emplace_back(rewriter.rewrite(script, statement));
    }

    const fs::path fresh = beside(options.output, ".new");
    if (compileText(options, all, fresh).exitCode != 0) {
        reportError(options, script, texts);
    }
    if (!options.dependencies.empty()) {
        writeDependencies(options, script, rewriter);
    }
    fs::rename(fresh, options.output);
}

} // namespace rc
