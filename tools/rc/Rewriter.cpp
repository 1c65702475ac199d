#include "tools/rc/Rewriter.h"

#include <algorithm>
#include <array>
#include <functional>
#include <map>

namespace rc {

namespace {

// Memory flags of old scripts, without meaning for a long time.
constexpr std::array<std::string_view, 8> memoryFlags = {"DISCARDABLE", "MOVEABLE", "PURE",       "FIXED",
                                                         "IMPURE",      "PRELOAD",  "LOADONCALL", "NONDISCARDABLE"};

// Reads a statement's words in order and complains with the place where something else was expected.
class Reader {
public:
    Reader(const Script& script, const Statement& statement) : m_script(script), m_tokens(statement.tokens) {}

    [[nodiscard]] bool atEnd() const {
        return m_at == m_tokens.size();
    }
    [[nodiscard]] bool ahead(std::string_view keyword) const {
        return !atEnd() && m_tokens[m_at].is(keyword);
    }
    [[nodiscard]] bool blockEndAhead() const {
        return !atEnd() && m_tokens[m_at].closesBlock();
    }
    [[nodiscard]] bool memoryFlagAhead() const {
        return std::ranges::any_of(memoryFlags, [&](std::string_view flag) { return ahead(flag); });
    }

    const Token& next(std::string_view expected) {
        if (atEnd())
            throw Fault{m_script.placeOf(m_tokens.back()), "expected " + std::string(expected) + " behind this line"};
        return m_tokens[m_at++];
    }
    bool accept(std::string_view keyword) {
        const bool isThere = ahead(keyword);
        m_at += isThere ? 1 : 0;
        return isThere;
    }
    const Token& expect(std::string_view keyword) {
        const Token& token = next(keyword);
        if (!token.is(keyword))
            fail(token, keyword);
        return token;
    }
    void beginBlock() {
        while (memoryFlagAhead())
            ++m_at;
        if (const Token& token = next("BEGIN"); !token.opensBlock())
            fail(token, "BEGIN");
    }
    /// The words of a number's expression, up to a comma, a keyword of the caller's or a block's border.
    std::string expression(const std::function<bool(const Token&)>& isEnd) {
        std::string text;
        while (!atEnd() && !m_tokens[m_at].is(",") && !m_tokens[m_at].opensBlock() && !m_tokens[m_at].closesBlock() &&
               !isEnd(m_tokens[m_at]))
            text += m_tokens[m_at++].text;
        if (text.empty())
            fail(next("a number"), "a number");
        return text;
    }
    std::string expression() {
        return expression([](const Token& token) { return memoryFlag(token); });
    }

    [[noreturn]] void fail(const Token& token, std::string_view expected) const {
        throw Fault{m_script.placeOf(token), "expected " + std::string(expected) + ", got " + token.text};
    }

private:
    static bool memoryFlag(const Token& token) {
        return std::ranges::any_of(memoryFlags, [&](std::string_view flag) { return token.is(flag); });
    }

    const Script& m_script;
    const std::vector<Token>& m_tokens;
    std::size_t m_at = 0;
};

std::string rawData(const std::string& name, int type, const std::string& numbers) {
    return name + " " + std::to_string(type) + "\nBEGIN\n" + numbers + "END\n";
}

std::string sourceText(const Script& script, const Statement& statement) {
    std::string text;
    for (std::size_t line = statement.firstLine(); line <= statement.tokens.back().line; ++line)
        text += script.lines[line].text + "\n";
    return text;
}

// name TOOLBAR width, height BEGIN (BUTTON id | SEPARATOR)... END
std::string rewriteToolBar(const Script& script, const Statement& statement) {
    Reader reader(script, statement);
    const std::string name = reader.next("a name").text;
    reader.expect("TOOLBAR");
    while (reader.memoryFlagAhead())
        reader.next("a width");
    const std::string width = reader.expression();
    reader.expect(",");
    const std::string height = reader.expression();
    reader.beginBlock();
    std::string commands;
    int count = 0;
    for (; !reader.blockEndAhead(); ++count) {
        if (reader.accept("SEPARATOR")) {
            commands += ", 0\n";
            continue;
        }
        const std::size_t line = reader.expect("BUTTON").line;
        commands += ", " + reader.expression([&](const Token& token) {
            return token.line != line || token.is("BUTTON") || token.is("SEPARATOR");
        }) + "\n";
    }
    return rawData(name, 241, "1, " + width + ", " + height + ", " + std::to_string(count) + "\n" + commands);
}

// name DLGINIT BEGIN numbers and texts END
std::string rewriteDialogData(const Script& script, const Statement& statement) {
    std::string text = statement.tokens.front().text + " 240\n";
    std::size_t line = statement.firstLine();
    for (auto token = statement.tokens.begin() + 2; token != statement.tokens.end(); ++token) {
        text += token->line == line ? " " : "\n";
        line = token->line;
        text += token->text;
    }
    return text + "\n";
}

struct AcceleratorEntry {
    std::string key;
    std::string command;
    int flags = 0;
};

constexpr int virtualKeyFlag = 0x01;
constexpr int modifierFlags = 0x1C;
constexpr int lastEntryFlag = 0x80;

// "A" is a character, "^A" the control character of it.
std::string keyOfText(const Reader& reader, const Token& token) {
    const std::string text = token.text.substr(1, token.text.size() - 2);
    if (text.size() == 1)
        return std::to_string(static_cast<unsigned char>(text[0]));
    if (text.size() == 2 && text[0] == '^')
        return std::to_string(text[1] & 0x1F);
    reader.fail(token, "one character");
}

AcceleratorEntry readAccelerator(Reader& reader) {
    static constexpr std::pair<std::string_view, int> options[] = {{"VIRTKEY", virtualKeyFlag}, {"ASCII", 0},
                                                                   {"NOINVERT", 0x02},          {"SHIFT", 0x04},
                                                                   {"CONTROL", 0x08},           {"ALT", 0x10}};
    AcceleratorEntry entry;
    const Token key = reader.next("a key");
    entry.key = key.kind == Token::Kind::String ? keyOfText(reader, key) : key.text;
    reader.expect(",");
    // Nothing but the line's end may stand between a command and the next key.
    entry.command = reader.expression([&](const Token& token) { return token.line != key.line; });
    bool isMore = reader.accept(",");
    while (isMore) {
        const auto* option = std::ranges::find_if(options, [&](const auto& pair) { return reader.ahead(pair.first); });
        const Token& word = reader.next("an option");
        if (option == std::end(options))
            reader.fail(word, "an option such as VIRTKEY or ALT");
        entry.flags |= option->second;
        isMore = reader.accept(",") ||
                 std::ranges::any_of(options, [&](const auto& pair) { return reader.ahead(pair.first); });
    }
    return entry;
}

// name ACCELERATORS BEGIN key, command [, VIRTKEY | ASCII] [, NOINVERT] [, ALT] [, SHIFT] [, CONTROL] ... END
std::string rewriteAccelerators(const Script& script, const Statement& statement) {
    Reader reader(script, statement);
    const std::string name = reader.next("a name").text;
    reader.expect("ACCELERATORS");
    reader.beginBlock();
    std::vector<AcceleratorEntry> entries;
    while (!reader.blockEndAhead())
        entries.push_back(readAccelerator(reader));
    const bool hasModifiedCharacter = std::ranges::any_of(entries, [](const AcceleratorEntry& entry) {
        return (entry.flags & virtualKeyFlag) == 0 && (entry.flags & modifierFlags) != 0;
    });
    if (!hasModifiedCharacter)
        return sourceText(script, statement);
    entries.back().flags |= lastEntryFlag;
    std::string numbers;
    for (const AcceleratorEntry& entry : entries)
        numbers += (numbers.empty() ? "" : ", ") + std::to_string(entry.flags) + ", " + entry.key + ", " +
                   entry.command + ", 0\n";
    return rawData(name, 9, numbers);
}

std::string withoutQuotes(const std::string& text) {
    return text.substr(1, text.size() - 2);
}

bool equalIgnoringCase(std::string_view left, std::string_view right) {
    return upperCase(left) == upperCase(right);
}

std::filesystem::path childIgnoringCase(const std::filesystem::path& folder, const std::filesystem::path& name) {
    std::error_code error;
    for (const auto& entry : std::filesystem::directory_iterator(folder, error))
        if (equalIgnoringCase(entry.path().filename().string(), name.string()))
            return entry.path();
    return {};
}

} // namespace

std::filesystem::path findFile(const std::filesystem::path& folder, std::string name) {
    // A name in a script separates folders by one backslash or, as in a C string, by two.
    for (std::size_t at; (at = name.find("\\\\")) != std::string::npos;)
        name.erase(at, 1);
    std::ranges::replace(name, '\\', '/');
    if (std::filesystem::is_regular_file(folder / name))
        return folder / name;
    std::filesystem::path path = std::filesystem::path(name).is_absolute() ? "/" : folder;
    for (const auto& part : std::filesystem::path(name).relative_path()) {
        path = std::filesystem::exists(path / part) ? path / part : childIgnoringCase(path, part);
        if (path.empty())
            return {};
    }
    return std::filesystem::is_regular_file(path) ? path : std::filesystem::path();
}

std::string Rewriter::rewrite(const Script& script, const Statement& statement) {
    using Rewrite = std::string (*)(const Script&, const Statement&);
    static const std::map<std::string, Rewrite, std::less<>> rewrites = {
        {"TOOLBAR", rewriteToolBar}, {"DLGINIT", rewriteDialogData}, {"ACCELERATORS", rewriteAccelerators}};
    const std::string type = statement.type();
    // What resource editors keep for themselves.
    if (type == "DESIGNINFO" || type == "TEXTINCLUDE")
        return {};
    if (const auto found = rewrites.find(type); found != rewrites.end())
        return found->second(script, statement);
    const Token& last = statement.tokens.back();
    if (type != "STRINGTABLE" && statement.tokens.size() > 2 && last.kind == Token::Kind::String)
        return rewriteFile(script, statement);
    return sourceText(script, statement);
}

std::string Rewriter::rewriteFile(const Script& script, const Statement& statement) {
    const Token& last = statement.tokens.back();
    std::filesystem::path found;
    for (auto folder = m_folders.begin(); folder != m_folders.end() && found.empty(); ++folder)
        found = findFile(*folder, withoutQuotes(last.text));
    if (found.empty())
        throw Fault{script.placeOf(last), "file not found: " + withoutQuotes(last.text)};
    m_files.push_back(found);
    std::string text;
    for (const Token& token : statement.tokens)
        text += &token == &last ? "\"" + found.string() + "\"" : token.text + " ";
    return text + "\n";
}

} // namespace rc
