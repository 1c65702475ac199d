#include "tools/settings/Commands.h"

#include "platform/base/Text.h"
#include "tools/settings/SettingsTree.h"

#include <algorithm>
#include <array>
#include <cerrno>
#include <charconv>
#include <cstring>
#include <fstream>
#include <iostream>
#include <optional>
#include <sstream>

namespace settings {

namespace {

constexpr const char* usage = R"(Usage: tvxsettings COMMAND ...
Looks into the settings of the user and changes them.

  list [-r] [KEY]               keys and values of KEY; -r: of the keys below too
  get KEY NAME                  the value NAME of KEY; @ is the default value
  set [-t TYPE] KEY NAME VALUE  writes a value; TYPE: text (usual), number, bytes
  delete KEY NAME               deletes a value
  delete -r KEY                 deletes KEY with everything below it
  export [-o FILE] [KEY]        writes KEY and what is below it as REGEDIT4 text
  import FILE                   does what such a text says, all or nothing; -: standard input
  --help, --version

KEY is a path such as 'Software\Tarvex\Common', below HKEY_CURRENT_USER unless it
begins with another root. TVX_REGISTRY names another file than the user's own.
Exit code: 0 done, 1 no such key or value, 2 wrong usage, 3 the settings cannot
be read or written, 4 the exchange file is wrong or cannot be read or written.
)";

/// A command line that makes no sense.
struct Misuse {
    std::string message;
};
/// An exchange file that is of no use.
struct FileFault {
    std::string message;
};

struct Streams {
    std::istream& in;
    std::ostream& out;
};

/// The words behind a command: switches and the rest.
class Words {
public:
    Words(std::vector<std::string> words, std::size_t least, std::size_t most, std::string_view flags,
          std::string_view options)
        : m_flags(flags), m_options(options) {
        bool isOver = false;
        for (auto word = words.begin(); word != words.end(); ++word) {
            if (!isOver && *word == "--") {
                isOver = true;
            } else if (!isOver && word->size() == 2 && word->front() == '-') {
                takeSwitch(word, words.end());
            } else {
                m_plain.push_back(std::move(*word));
            }
        }
        if (m_plain.size() < least || m_plain.size() > most) {
            throw Misuse{m_plain.size() < least ? "something is missing" : "unexpected \"" + m_plain.back() + "\""};
        }
    }

    [[nodiscard]] bool has(char flag) const {
        return m_given.find(flag) != std::string::npos;
    }
    [[nodiscard]] std::string option(const std::string& preset) const {
        return m_option.value_or(preset);
    }
    [[nodiscard]] const std::string& operator[](std::size_t index) const {
        return m_plain[index];
    }
    [[nodiscard]] std::size_t size() const {
        return m_plain.size();
    }

private:
    using Iterator = std::vector<std::string>::iterator;

    void takeSwitch(Iterator& word, Iterator end) {
        const char letter = (*word)[1];
        if (m_flags.find(letter) != std::string_view::npos) {
            m_given += letter;
        } else if (m_options.find(letter) != std::string_view::npos) {
            if (std::next(word) == end) {
                throw Misuse{*word + " needs a word behind it"};
            }
            m_option = *++word;
        } else {
            throw Misuse{"unknown option " + *word};
        }
    }

    std::string_view m_flags;
    std::string_view m_options;
    std::string m_given;
    std::optional<std::string> m_option;
    std::vector<std::string> m_plain;
};

KeyName keyOf(const std::string& text) {
    KeyName key;
    if (!readKeyName(text, key)) {
        key.path = text;
    }
    return key;
}

std::string nameOf(const std::string& word) {
    return word == "@" ? std::string() : word;
}

// --- values as a person reads and types them ---

std::string shown(const Setting& setting) {
    if (setting.type == REG_SZ || setting.type == REG_EXPAND_SZ) {
        return setting.data.substr(0, setting.data.find('\0'));
    }
    if (setting.type == REG_DWORD && setting.data.size() == sizeof(DWORD)) {
        DWORD number = 0;
        std::memcpy(&number, setting.data.data(), sizeof number);
        return std::to_string(number);
    }
    std::string bytes;
    for (const char c : setting.data) {
        bytes +=
            tvx::text::format(bytes.empty() ? "%02x" : " %02x", static_cast<unsigned>(static_cast<unsigned char>(c)));
    }
    return bytes;
}

std::string numberBytes(const std::string& text) {
    std::uint32_t number = 0;
    const bool isHex = text.starts_with("0x") || text.starts_with("0X");
    const char* const first = text.data() + (isHex ? 2 : 0);
    const char* const last = text.data() + text.size();
    const auto [end, error] = std::from_chars(first, last, number, isHex ? 16 : 10);
    if (error != std::errc() || end != last) {
        throw Misuse{"\"" + text + "\" is no number from 0 to 4294967295"};
    }
    return {reinterpret_cast<const char*>(&number), sizeof number};
}

std::string hexBytes(const std::string& text) {
    std::string digits;
    std::ranges::copy_if(text, std::back_inserter(digits), [](char c) { return c != ' ' && c != ','; });
    std::string bytes;
    for (std::size_t i = 0; i < digits.size(); i += 2) {
        unsigned byte = 0;
        const char* const first = digits.data() + i;
        const auto [end, error] = std::from_chars(first, first + std::min<std::size_t>(2, digits.size() - i), byte, 16);
        if (error != std::errc() || end != first + 2) {
            throw Misuse{"bytes are pairs of hexadecimal digits, such as \"00 ff 7a\""};
        }
        bytes += static_cast<char>(byte);
    }
    return bytes;
}

Setting typed(const std::string& type, const std::string& name, const std::string& value) {
    if (type == "text") {
        return {name, REG_SZ, value + '\0'};
    }
    if (type == "number") {
        return {name, REG_DWORD, numberBytes(value)};
    }
    if (type == "bytes") {
        return {name, REG_BINARY, hexBytes(value)};
    }
    throw Misuse{"unknown type \"" + type + "\"; there are text, number and bytes"};
}

// --- commands ---

void list(std::vector<std::string> given, Streams& streams) {
    const Words words(std::move(given), 0, 1, "r", "");
    const KeyName name = keyOf(words.size() > 0 ? words[0] : "");
    if (words.has('r')) {
        streams.out << writeTree(name);
        return;
    }
    const Key key(name, Key::Way::Read);
    for (const std::string& subKey : key.subKeys()) {
        streams.out << writeKey(below(name, subKey));
    }
    for (const Setting& setting : key.settings()) {
        streams.out << writeSetting(setting);
    }
}

void get(std::vector<std::string> given, Streams& streams) {
    const Words words(std::move(given), 2, 2, "", "");
    streams.out << shown(Key(keyOf(words[0]), Key::Way::Read).setting(nameOf(words[1]))) << "\n";
}

void set(std::vector<std::string> given, Streams&) {
    const Words words(std::move(given), 3, 3, "", "t");
    const Setting setting = typed(words.option("text"), nameOf(words[1]), words[2]);
    Key(keyOf(words[0]), Key::Way::Create).set(setting);
}

void remove(std::vector<std::string> given, Streams&) {
    const Words words(std::move(given), 1, 2, "r", "");
    if (words.has('r') != (words.size() == 1)) {
        throw Misuse{words.has('r') ? "-r deletes a whole key and takes no value" : "name a value, or use -r"};
    }
    const KeyName key = keyOf(words[0]);
    if (words.has('r')) {
        Key(key, Key::Way::Write); // tells when there is none
        apply({{Change::Kind::DeleteKey, 0, key, {}}}, "delete");
    } else {
        Key(key, Key::Way::Write).remove(nameOf(words[1]));
    }
}

void exportText(std::vector<std::string> given, Streams& streams) {
    const Words words(std::move(given), 0, 1, "", "o");
    const std::string text = writeHeader() + writeTree(keyOf(words.size() > 0 ? words[0] : ""));
    const std::string file = words.option("-");
    if (file == "-") {
        streams.out << text;
        return;
    }
    std::ofstream stream(file, std::ios::binary);
    stream << text;
    stream.close();
    if (!stream) {
        throw FileFault{file + ": " + std::strerror(errno)};
    }
}

/// What is in a stream. Where that cannot be read, as where a folder has been named, an iterator over it would throw.
std::string readAll(std::istream& in, const std::string& place) {
    std::ostringstream text;
    if (in && in.peek() != std::istream::traits_type::eof()) {
        text << in.rdbuf();
    }
    if (!in && !in.eof()) {
        throw FileFault{place + ": " + std::strerror(errno)};
    }
    return text.str();
}

std::string readFile(const std::string& file, std::istream& in) {
    if (file == "-") {
        return readAll(in, "standard input");
    }
    std::ifstream stream(file, std::ios::binary);
    return readAll(stream, file);
}

void importText(std::vector<std::string> given, Streams& streams) {
    const Words words(std::move(given), 1, 1, "", "");
    const std::string file = words[0];
    const std::string place = file == "-" ? "standard input" : file;
    std::vector<Change> changes;
    try {
        changes = readExchangeText(readFile(file, streams.in));
    } catch (const TextFault& fault) {
        throw FileFault{place + ":" + std::to_string(fault.line) + ": " + fault.message};
    }
    apply(changes, place);
}

struct Command {
    std::string_view name;
    void (*run)(std::vector<std::string> words, Streams& streams);
};

constexpr std::array<Command, 6> commands{{
    {"list", &list},
    {"get", &get},
    {"set", &set},
    {"delete", &remove},
    {"export", &exportText},
    {"import", &importText},
}};

void dispatch(const std::vector<std::string>& words, Streams& streams) {
    if (words.empty()) {
        throw Misuse{"name a command"};
    }
    const auto* command = std::ranges::find(commands, words.front(), &Command::name);
    if (command == commands.end()) {
        throw Misuse{"unknown command \"" + words.front() + "\""};
    }
    command->run({words.begin() + 1, words.end()}, streams);
}

bool answers(const std::vector<std::string>& words, std::ostream& out) {
    if (std::ranges::find(words, "--help") != words.end()) {
        out << usage;
    } else if (words.size() == 1 && words.front() == "--version") {
        out << "tvxsettings " TVX_VERSION "\n";
    } else {
        return false;
    }
    return true;
}

} // namespace

Outcome run(const std::vector<std::string>& words, std::istream& in, std::ostream& out, std::ostream& errors) {
    Streams streams{in, out};
    try {
        if (!answers(words, out)) {
            dispatch(words, streams);
        }
        return Outcome::Done;
    } catch (const Misuse& misuse) {
        errors << "tvxsettings: " << misuse.message << ". See tvxsettings --help.\n";
        return Outcome::Misused;
    } catch (const FileFault& fault) {
        errors << "tvxsettings: " << fault.message << "\n";
        return Outcome::BadFile;
    } catch (const Failure& failure) {
        errors << "tvxsettings: " << failure.what() << "\n";
        return failure.result() == ERROR_FILE_NOT_FOUND ? Outcome::Missing : Outcome::Failed;
    }
}

} // namespace settings
