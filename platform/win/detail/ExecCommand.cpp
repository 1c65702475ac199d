#include "platform/win/detail/ExecCommand.h"

#include <algorithm>
#include <string_view>

namespace tvx::win {

namespace {

/// A word in quotes, as splitArguments() reads it.
std::string inQuotes(const std::string& word) {
    std::string text = "\"";
    std::size_t backslashes = 0;
    for (const char character : word) {
        if (character == '"') {
            text.append(backslashes + 1, '\\'); // so that the quote, and each backslash before it, stays what it is
        }
        backslashes = character == '\\' ? backslashes + 1 : 0;
        text += character;
    }
    text.append(backslashes, '\\');
    return text + "\"";
}

/// Stands for the document; words hold no zero.
constexpr char document = '\0';

/// A call with its field codes replaced.
struct Call {
    std::vector<std::string> words; ///< with marks for the document
    bool takesAddresses = false;
    bool hasDocument = false;
};

/// Appends what a field code stands for. What would be an icon, a translated name or a file of the entry's is nothing
/// here, as are the codes that entries no longer have.
void expandCode(Call& call, std::string& word, char code) {
    constexpr std::string_view addresses = "uU";
    constexpr std::string_view names = "fF";
    if (code == '%') {
        word += '%';
    } else if (addresses.find(code) != std::string_view::npos || names.find(code) != std::string_view::npos) {
        word += document;
        call.hasDocument = true;
        call.takesAddresses |= addresses.find(code) != std::string_view::npos;
    }
}

Call expand(const std::vector<std::string>& words) {
    Call call;
    for (const std::string& word : words) {
        std::string expanded;
        for (std::size_t at = 0; at < word.size(); ++at) {
            if (word[at] != '%') {
                expanded += word[at];
            } else if (++at < word.size()) {
                expandCode(call, expanded, word[at]);
            }
        }
        if (word.empty() || !expanded.empty()) {
            call.words.push_back(expanded);
        }
    }
    if (!call.hasDocument) {
        call.words.emplace_back(1, document);
    }
    return call;
}

bool anyHolds(const Call& call, char character) {
    return std::ranges::any_of(
        call.words, [character](const std::string& word) { return word.find(character) != std::string::npos; });
}

/// A flatpak hands on what stands behind this word only if it is an address.
bool wantsAddress(const Call& call) {
    return std::ranges::find(call.words, "@@u") != call.words.end();
}

bool endsWithDocument(const Call& call) {
    const auto marks = std::ranges::count_if(
        call.words, [](const std::string& word) { return word.find(document) != std::string::npos; });
    return marks == 1 && call.words.back() == std::string(1, document);
}

/// Whether the document is but a part of a word: the name of a file has to be a word by itself to become one of the
/// system's on its way to a child.
bool isWithinWord(const Call& call) {
    return std::ranges::any_of(call.words, [](const std::string& word) {
        return word.size() > 1 && word.find(document) != std::string::npos;
    });
}

bool needsHelper(const Call& call, Opens opens) {
    if (anyHolds(call, '%') || isWithinWord(call) || opens == Opens::Papers) {
        return true;
    }
    if (opens == Opens::Pages) {
        return !call.takesAddresses;
    }
    return wantsAddress(call) || (opens == Opens::TextsBehind && !endsWithDocument(call));
}

/// In the helper's arguments "{}" is the document, and "{25}" what has that number: a percent sign.
std::string forHelper(const std::string& word) {
    std::string text;
    for (const char character : word) {
        switch (character) {
        case document:
            text += "{}";
            break;
        case '{':
            text += "{7B}";
            break;
        case '%':
            text += "{25}";
            break;
        default:
            text += character;
        }
    }
    return quoted(text);
}

std::string helpedCommand(const Call& call, Opens opens, const std::string& helper) {
    std::string command = quoted(helper);
    command += call.takesAddresses ? "" : " --names";
    for (const std::string& word : call.words) {
        command += " " + forHelper(word);
    }
    return opens == Opens::TextsBehind ? command : command + " \"%1\"";
}

/// A word with the marker of the settings. It is in quotes, because the document is put in as it is.
std::string withMarker(const std::string& word) {
    if (word.find(document) == std::string::npos) {
        return quoted(word);
    }
    std::string text = inQuotes(word);
    for (std::size_t at = text.find(document); at != std::string::npos; at = text.find(document)) {
        text.replace(at, 1, "%1");
    }
    return text;
}

std::string plainCommand(Call call, Opens opens) {
    if (opens == Opens::TextsBehind) {
        call.words.pop_back();
    }
    std::string command;
    for (const std::string& word : call.words) {
        command += (command.empty() ? "" : " ") + withMarker(word);
    }
    return command;
}

} // namespace

std::string commandFor(const std::vector<std::string>& words, Opens opens, const std::string& helper) {
    const Call call = expand(words);
    if (call.words.front().find_first_of(std::string_view("\"\0", 2)) != std::string::npos) {
        return {}; // no program has such a name
    }
    const bool canHelp = !helper.empty() && helper.find('%') == std::string::npos;
    if (needsHelper(call, opens) && canHelp) {
        return helpedCommand(call, opens, helper);
    }
    const bool isPlain = !anyHolds(call, '%') && (opens != Opens::TextsBehind || endsWithDocument(call));
    return isPlain ? plainCommand(call, opens) : std::string();
}

std::string quoted(const std::string& word) {
    const bool isPlain = !word.empty() && word.find_first_of(" \t\n\"") == std::string::npos;
    return isPlain ? word : inQuotes(word);
}

} // namespace tvx::win
