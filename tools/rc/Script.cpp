#include "tools/rc/Script.h"

#include "tools/rc/Encoding.h"

#include <algorithm>
#include <array>
#include <cctype>
#include <charconv>
#include <set>

namespace rc {

namespace {

// Types that are followed by a block; a statement of any other type ends with its line when that names a file.
constexpr std::array<std::string_view, 8> blockTypes = {"STRINGTABLE", "DIALOG",  "DIALOGEX",     "MENU",
                                                        "MENUEX",      "TOOLBAR", "ACCELERATORS", "VERSIONINFO"};

char upper(char c) {
    return static_cast<char>(std::toupper(static_cast<unsigned char>(c)));
}

bool isHeader(const std::string& file) {
    const std::string extension = upperCase(std::filesystem::path(file).extension().string());
    return extension == ".H" || extension == ".HPP" || extension == ".HXX" || extension == ".C";
}

// The file name of a line mark, in which the preprocessor escapes quotes and backslashes.
std::string markedFile(std::string_view mark) {
    std::string result;
    for (std::size_t i = mark.find('"') + 1; i < mark.size() && mark[i] != '"'; ++i) {
        if (mark[i] == '\\' && i + 1 < mark.size()) {
            ++i;
        }
        result += mark[i];
    }
    return result;
}

// Reads `# 12 "file" flags`; answers whether the line was such a mark.
bool readMark(std::string_view line, Place& place) {
    if (!line.starts_with("# ") || line.find('"') == std::string_view::npos) {
        return false;
    }
    int number = 0;
    const auto [end, error] = std::from_chars(line.data() + 2, line.data() + line.size(), number);
    if (error != std::errc()) {
        return false;
    }
    place = {markedFile(line), number};
    return true;
}

// Old scripts are in the western code page. A file is in UTF-8 or in that page as a whole, so one line tells.
void decodeByFile(std::vector<Line>& lines) {
    std::set<std::string> western;
    for (const Line& line : lines) {
        if (!isUtf8(line.text)) {
            western.insert(line.place.file);
        }
    }
    for (Line& line : lines) {
        if (western.contains(line.place.file)) {
            line.text = westernToUtf8(line.text);
        }
    }
}

std::vector<Line> readLines(std::string_view text, std::vector<std::filesystem::path>& files) {
    std::vector<Line> lines;
    std::set<std::string> seen;
    Place place;
    while (!text.empty()) {
        const std::size_t end = std::min(text.find('\n'), text.size());
        std::string_view line = text.substr(0, end);
        text.remove_prefix(std::min(end + 1, text.size()));
        if (readMark(line, place)) {
            if (!place.file.starts_with('<') && seen.insert(place.file).second) {
                files.emplace_back(place.file);
            }
            continue;
        }
        if (line.ends_with('\r')) {
            line.remove_suffix(1);
        }
        if (!isHeader(place.file) && !line.starts_with('#')) {
            lines.push_back({std::string(line), place});
        }
        ++place.line;
    }
    decodeByFile(lines);
    return lines;
}

// Behind the quote that ends the string whose opening quote stands at `at`; a doubled quote is part of the string.
std::size_t stringEnd(std::string_view text, std::size_t at) {
    for (++at; at < text.size(); ++at) {
        const bool isPair = at + 1 < text.size() && (text[at] == '\\' || (text[at] == '"' && text[at + 1] == '"'));
        if (isPair) {
            ++at;
        } else if (text[at] == '"') {
            return at + 1;
        }
    }
    return text.size();
}

bool isWordCharacter(char c) {
    return std::isalnum(static_cast<unsigned char>(c)) || static_cast<unsigned char>(c) >= 0x80 ||
           std::string_view("_.#\\/").find(c) != std::string_view::npos;
}

Token readToken(std::string_view text, std::size_t& at, std::size_t line) {
    const std::size_t start = at;
    const bool isWide = upper(text[at]) == 'L' && at + 1 < text.size() && text[at + 1] == '"';
    auto kind = Token::Kind::Mark;
    if (isWide || text[at] == '"') {
        kind = Token::Kind::String;
        at = stringEnd(text, at + (isWide ? 1 : 0));
    } else if (isWordCharacter(text[at])) {
        kind = std::isdigit(static_cast<unsigned char>(text[at])) ? Token::Kind::Number : Token::Kind::Word;
        while (at < text.size() && isWordCharacter(text[at])) {
            ++at;
        }
    } else {
        ++at;
    }
    return {kind, std::string(text.substr(start, at - start)), line};
}

std::vector<Token> tokensOf(std::string_view text, std::size_t line) {
    std::vector<Token> tokens;
    for (std::size_t at = 0; at < text.size();) {
        if (std::isspace(static_cast<unsigned char>(text[at]))) {
            ++at;
        } else {
            tokens.push_back(readToken(text, at, line));
        }
    }
    return tokens;
}

// Collects words line by line and closes a statement where its block or its line ends.
class StatementCutter {
public:
    explicit StatementCutter(std::vector<Statement>& statements) : m_statements(statements) {}

    void addLine(const std::vector<Token>& tokens) {
        for (const Token& token : tokens) {
            add(token);
        }
        if (m_depth == 0 && !m_current.tokens.empty() && endsWithLine()) {
            close();
        }
    }

    void close() {
        if (!m_current.tokens.empty()) {
            m_statements.push_back(std::move(m_current));
        }
        m_current = {};
        m_depth = 0;
    }

private:
    void add(const Token& token) {
        m_current.tokens.push_back(token);
        if (token.opensBlock()) {
            ++m_depth;
        }
        if (token.closesBlock() && --m_depth <= 0) {
            close();
        }
    }

    [[nodiscard]] bool endsWithLine() const {
        const std::string type = m_current.type();
        if (type == "LANGUAGE") {
            return true;
        }
        return std::ranges::find(blockTypes, type) == blockTypes.end() && m_current.tokens.size() > 2 &&
               m_current.tokens.back().kind == Token::Kind::String;
    }

    std::vector<Statement>& m_statements;
    Statement m_current;
    int m_depth = 0;
};

} // namespace

std::string upperCase(std::string_view text) {
    std::string result(text);
    std::ranges::transform(result, result.begin(), upper);
    return result;
}

bool Token::is(std::string_view keyword) const {
    return kind != Kind::String && std::ranges::equal(text, keyword, {}, upper);
}

std::string Statement::type() const {
    const Token& first = tokens.front();
    if (first.is("STRINGTABLE") || first.is("LANGUAGE") || tokens.size() < 2) {
        return upperCase(first.text);
    }
    return upperCase(tokens[1].text);
}

Script parseScript(std::string_view preprocessed) {
    Script script;
    script.lines = readLines(preprocessed, script.files);
    StatementCutter cutter(script.statements);
    for (std::size_t i = 0; i < script.lines.size(); ++i) {
        cutter.addLine(tokensOf(script.lines[i].text, i));
    }
    cutter.close();
    return script;
}

} // namespace rc
