#include "tools/open/Call.h"

#include "platform/base/Address.h"
#include "tools/open/Document.h"
#include "tools/open/ForwardPage.h"
#include "tools/open/Viewers.h"

#include <algorithm>
#include <cctype>
#include <charconv>
#include <filesystem>
#include <string_view>

namespace opening {

namespace {

namespace fs = std::filesystem;

constexpr std::string_view marker = "{}";

/// The program in a call, behind what only starts it.
struct Viewer {
    std::size_t index = 0; ///< of its word
    std::string name;      ///< without folder
};

/// "flatpak run --branch=stable org.gnome.Evince": the first word behind "run" that is no option.
Viewer flatpakViewer(const std::vector<std::string>& words, std::size_t index) {
    index = std::min(index + 2, words.size() - 1);
    while (index + 1 < words.size() && words[index].starts_with('-')) {
        ++index;
    }
    std::string name = words[index].substr(words[index].rfind('.') + 1);
    std::ranges::transform(name, name.begin(), [](unsigned char letter) { return std::tolower(letter); });
    return {index, name};
}

/// A program that is not known by its own name may be a link to one that is: "/etc/alternatives/pdf-viewer".
std::string knownName(const fs::path& program) {
    std::error_code error;
    const std::string name = program.filename().string();
    return isKnownViewer(name) ? name : fs::weakly_canonical(program, error).filename().string();
}

Viewer viewerOf(const std::vector<std::string>& words) {
    std::size_t index = 0;
    if (fs::path(words[0]).filename() == "env") {
        for (++index; index + 1 < words.size() && words[index].find('=') != std::string::npos; ++index) {
        }
    }
    const fs::path program = words[index];
    return program.filename() == "flatpak" ? flatpakViewer(words, index) : Viewer{index, knownName(program)};
}

/// A flatpak takes the document in from behind this word only if it is an address.
bool isForwarded(const std::vector<std::string>& words) {
    return std::ranges::find(words, "@@u") != words.end();
}

/// Takes the markers of a word away.
std::string expanded(const std::string& word, const std::string& document) {
    std::string text;
    for (std::size_t at = 0; at < word.size(); ++at) {
        unsigned code = 0;
        const char* digits = word.data() + at + 1;
        if (word.compare(at, marker.size(), marker) == 0) {
            text += document;
            at += 1;
        } else if (word[at] == '{' && at + 3 < word.size() && word[at + 3] == '}' &&
                   std::from_chars(digits, digits + 2, code, 16).ptr == digits + 2) {
            text += static_cast<char>(code);
            at += 3;
        } else {
            text += word[at];
        }
    }
    return text;
}

/// What stands for any document but a PDF.
std::string pageFor(const Call& call, const Document& document) {
    const bool hasPlace = !document.place.empty() || !document.query.empty();
    if (call.takes == Takes::Names) {
        return hasPlace ? makeForwardPage(document.address()) : document.file;
    }
    return isForwarded(call.words) || hasPlace ? document.address() : document.text;
}

PaperCall callFor(const Call& call, const Document& document) {
    if (!document.isFile() && call.takes == Takes::Names) {
        throw Failure{call.words[0] + " takes names of files only, not " + document.text};
    }
    if (!isPaper(document)) {
        return {document.isFile() ? pageFor(call, document) : document.text, {}, {}};
    }
    PaperCall paper = paperCall(document, viewerOf(call.words).name);
    if (isForwarded(call.words) && !tvx::isFileAddress(paper.document)) {
        paper.document = document.bareAddress();
    }
    return paper;
}

} // namespace

std::vector<std::string> wordsFor(const Call& call, const std::string& text) {
    const PaperCall paper = callFor(call, readDocument(text));
    std::vector<std::string> words;
    std::size_t behindDocument = 0;
    for (const std::string& word : call.words) {
        words.push_back(expanded(word, paper.document));
        behindDocument = word.find(marker) != std::string::npos ? words.size() : behindDocument;
    }
    if (behindDocument == 0) {
        words.push_back(paper.document);
        behindDocument = words.size();
    }
    const auto insert = [&words](std::size_t index, const std::vector<std::string>& more) {
        words.insert(words.begin() + static_cast<std::ptrdiff_t>(index), more.begin(), more.end());
    };
    insert(behindDocument, paper.behind);
    insert(viewerOf(call.words).index + 1, paper.before);
    return words;
}

} // namespace opening
