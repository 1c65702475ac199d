#include "tools/rc/Rewriter.h"

#include "tools/rc/StatementReader.h"

#include <algorithm>
#include <map>

namespace rc {

namespace {

// Numbers of 16 bits on their way into a raw data statement.
class RawData {
public:
    [[nodiscard]] std::size_t size() const {
        return m_words.size();
    }
    void word(std::uint16_t value) {
        m_words.push_back(value);
    }
    void doubleWord(std::int64_t value) {
        word(static_cast<std::uint16_t>(value & 0xFFFF));
        word(static_cast<std::uint16_t>(value >> 16 & 0xFFFF));
    }
    void text(const std::u16string& value) {
        m_words.insert(m_words.end(), value.begin(), value.end());
        word(0);
    }
    void alignToDoubleWord() {
        if (m_words.size() % 2 != 0) {
            word(0);
        }
    }
    /// The bits `flags` are added to the word at `at`.
    void mark(std::size_t at, std::uint16_t flags) {
        m_words[at] = static_cast<std::uint16_t>(m_words[at] | flags);
    }
    [[nodiscard]] std::string statement(const std::string& name, int type) const {
        std::string result = name + " " + std::to_string(type) + "\nBEGIN\n";
        for (std::size_t i = 0; i < m_words.size(); ++i) {
            result += (i > 0 ? (i % 8 == 0 ? ",\n" : ", ") : "") + std::to_string(m_words[i]);
        }
        return result + "\nEND\n";
    }

private:
    std::vector<std::uint16_t> m_words;
};

constexpr int menuType = 4;
constexpr int acceleratorType = 9;
constexpr int dialogDataType = 240;
constexpr int toolBarType = 241;

std::string sourceText(const Script& script, const Statement& statement) {
    std::string text;
    for (std::size_t line = statement.firstLine(); line <= statement.tokens.back().line; ++line) {
        text += script.lines[line].text + "\n";
    }
    return text;
}

// name TOOLBAR width, height BEGIN (BUTTON id | SEPARATOR)... END
std::string rewriteToolBar(const Script& script, const Statement& statement) {
    StatementReader reader(script, statement);
    const std::string name = reader.next("a name").text;
    reader.expect("TOOLBAR");
    reader.skipMemoryFlags();
    const std::uint16_t width = reader.word();
    reader.expect(",");
    const std::uint16_t height = reader.word();
    reader.beginBlock();
    std::vector<std::uint16_t> commands;
    while (!reader.blockEndAhead()) {
        if (!reader.accept("SEPARATOR")) {
            reader.expect("BUTTON");
            commands.push_back(reader.word());
        } else {
            commands.push_back(0);
        }
    }
    RawData data;
    constexpr std::uint16_t version = 1;
    for (const std::uint16_t word : {version, width, height, static_cast<std::uint16_t>(commands.size())}) {
        data.word(word);
    }
    for (const std::uint16_t command : commands) {
        data.word(command);
    }
    return data.statement(name, toolBarType);
}

// name DLGINIT BEGIN numbers and texts END: raw data already, under a name where a number is wanted.
std::string rewriteDialogData(const Script&, const Statement& statement) {
    std::string text = statement.tokens.front().text + " " + std::to_string(dialogDataType);
    std::size_t line = statement.firstLine();
    for (auto token = statement.tokens.begin() + 2; token != statement.tokens.end(); ++token) {
        text += (token->line == line ? " " : "\n") + token->text;
        line = token->line;
    }
    return text + "\n";
}

struct AcceleratorEntry {
    std::uint16_t flags = 0;
    std::uint16_t key = 0;
    std::uint16_t command = 0;
};

constexpr int virtualKeyFlag = 0x01;
constexpr int modifierFlags = 0x1C;
constexpr int lastEntryFlag = 0x80;

// A number, a character, or the control character of one: "^A".
std::uint16_t readKey(StatementReader& reader) {
    const Token* first = reader.peek();
    if (!first || first->kind != Token::Kind::String) {
        return reader.word();
    }
    const std::u16string text = reader.text();
    if (text.size() == 1) {
        return text[0];
    }
    if (text.size() == 2 && text[0] == u'^') {
        return text[1] & 0x1F;
    }
    reader.fail(*first, "one character");
}

AcceleratorEntry readAccelerator(StatementReader& reader) {
    static constexpr std::pair<std::string_view, std::uint16_t> options[] = {
        {"VIRTKEY", virtualKeyFlag}, {"ASCII", 0}, {"NOINVERT", 0x02}, {"SHIFT", 0x04},
        {"CONTROL", 0x08},           {"ALT", 0x10}};
    AcceleratorEntry entry;
    entry.key = readKey(reader);
    reader.expect(",");
    entry.command = reader.word();
    const auto isAhead = [&](const auto& option) { return reader.ahead(option.first); };
    while (reader.accept(",") || std::ranges::any_of(options, isAhead)) {
        const auto* option = std::ranges::find_if(options, isAhead);
        const Token& word = reader.next("an option");
        if (option == std::end(options)) {
            reader.fail(word, "an option such as VIRTKEY or ALT");
        }
        entry.flags = static_cast<std::uint16_t>(entry.flags | option->second);
    }
    return entry;
}

bool isModifiedCharacter(const AcceleratorEntry& entry) {
    return (entry.flags & virtualKeyFlag) == 0 && (entry.flags & modifierFlags) != 0;
}

// name ACCELERATORS BEGIN key, command [, VIRTKEY | ASCII] [, NOINVERT] [, ALT] [, SHIFT] [, CONTROL] ... END
// The compiler refuses modifiers of characters, and options that no comma separates.
std::string rewriteAccelerators(const Script& script, const Statement& statement) {
    StatementReader reader(script, statement);
    const std::string name = reader.next("a name").text;
    reader.expect("ACCELERATORS");
    reader.beginBlock();
    std::vector<AcceleratorEntry> entries;
    while (!reader.blockEndAhead()) {
        entries.push_back(readAccelerator(reader));
    }
    if (std::ranges::none_of(entries, isModifiedCharacter) || entries.empty()) {
        return sourceText(script, statement);
    }
    entries.back().flags |= lastEntryFlag;
    RawData data;
    for (const AcceleratorEntry& entry : entries) {
        for (const std::uint16_t word : {entry.flags, entry.key, entry.command, std::uint16_t{0}}) {
            data.word(word);
        }
    }
    return data.statement(name, acceleratorType);
}

// One of the numbers behind a text of an extended menu, each of which may be left out.
std::int64_t optionalNumber(StatementReader& reader) {
    if (!reader.accept(",") || reader.ahead(",")) {
        return 0;
    }
    return reader.number();
}

// The lines of an extended menu up to its END.
void readMenuItems(StatementReader& reader, RawData& data) {
    constexpr std::uint16_t popupFlag = 0x01;
    constexpr std::uint16_t lastFlag = 0x80;
    std::size_t flagsAt = 0;
    while (!reader.blockEndAhead()) {
        const bool isPopup = reader.accept("POPUP");
        if (!isPopup) {
            reader.expect("MENUITEM");
        }
        const std::u16string text = reader.text();
        const std::int64_t id = optionalNumber(reader);
        const std::int64_t type = optionalNumber(reader);
        const std::int64_t state = optionalNumber(reader);
        data.alignToDoubleWord();
        data.doubleWord(type);
        data.doubleWord(state);
        data.doubleWord(id);
        flagsAt = data.size();
        data.word(isPopup ? popupFlag : std::uint16_t{0});
        data.text(text);
        if (isPopup) {
            data.alignToDoubleWord();
            data.doubleWord(optionalNumber(reader)); // help context
            reader.beginBlock();
            readMenuItems(reader, data);
        }
    }
    if (flagsAt == 0) {
        reader.fail(reader.next("END"), "MENUITEM or POPUP");
    }
    data.mark(flagsAt, lastFlag);
    reader.next("END");
}

// name MENUEX BEGIN (MENUITEM text [, id [, type [, state]]] | POPUP text [, id ... [, help]] BEGIN ... END)... END
std::string rewriteExtendedMenu(const Script& script, const Statement& statement) {
    StatementReader reader(script, statement);
    const std::string name = reader.next("a name").text;
    reader.expect("MENUEX");
    reader.beginBlock();
    RawData data;
    data.word(1);       // version
    data.word(4);       // from here to the first item
    data.doubleWord(0); // help context
    readMenuItems(reader, data);
    return data.statement(name, menuType);
}

std::string withoutQuotes(const std::string& text) {
    return text.substr(1, text.size() - 2);
}

bool equalIgnoringCase(std::string_view left, std::string_view right) {
    return upperCase(left) == upperCase(right);
}

std::filesystem::path childIgnoringCase(const std::filesystem::path& folder, const std::filesystem::path& name) {
    std::error_code error;
    for (const auto& entry : std::filesystem::directory_iterator(folder, error)) {
        if (equalIgnoringCase(entry.path().filename().string(), name.string())) {
            return entry.path();
        }
    }
    return {};
}

} // namespace

std::filesystem::path findFile(const std::filesystem::path& folder, std::string name) {
    // A name in a script separates folders by one backslash or, as in a C string, by two.
    for (std::size_t at; (at = name.find("\\\\")) != std::string::npos;) {
        name.erase(at, 1);
    }
    std::ranges::replace(name, '\\', '/');
    if (std::filesystem::is_regular_file(folder / name)) {
        return folder / name;
    }
    std::filesystem::path path = std::filesystem::path(name).is_absolute() ? "/" : folder;
    for (const auto& part : std::filesystem::path(name).relative_path()) {
        path = std::filesystem::exists(path / part) ? path / part : childIgnoringCase(path, part);
        if (path.empty()) {
            return {};
        }
    }
    return std::filesystem::is_regular_file(path) ? path : std::filesystem::path();
}

std::string Rewriter::rewrite(const Script& script, const Statement& statement) {
    using Rewrite = std::string (*)(const Script&, const Statement&);
    static const std::map<std::string, Rewrite, std::less<>> rewrites = {{"TOOLBAR", rewriteToolBar},
                                                                         {"DLGINIT", rewriteDialogData},
                                                                         {"ACCELERATORS", rewriteAccelerators},
                                                                         {"MENUEX", rewriteExtendedMenu}};
    const std::string type = statement.type();
    // What resource editors keep for themselves.
    if (type == "DESIGNINFO" || type == "TEXTINCLUDE") {
        return {};
    }
    if (const auto found = rewrites.find(type); found != rewrites.end()) {
        return found->second(script, statement);
    }
    const Token& last = statement.tokens.back();
    if (type != "STRINGTABLE" && statement.tokens.size() > 2 && last.kind == Token::Kind::String) {
        return rewriteFile(script, statement);
    }
    return sourceText(script, statement);
}

std::string Rewriter::rewriteFile(const Script& script, const Statement& statement) {
    const Token& last = statement.tokens.back();
    std::filesystem::path found;
    for (auto folder = m_folders.begin(); folder != m_folders.end() && found.empty(); ++folder) {
        found = findFile(*folder, withoutQuotes(last.text));
    }
    if (found.empty()) {
        throw Fault{script.placeOf(last), "file not found: " + withoutQuotes(last.text)};
    }
    m_files.push_back(found);
    std::string text;
    for (const Token& token : statement.tokens) {
        text += &token == &last ? "\"" + found.string() + "\"" : token.text + " ";
    }
    return text + "\n";
}

} // namespace rc
