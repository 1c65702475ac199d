#include "tools/open/Document.h"

#include "platform/base/Address.h"

#include <algorithm>
#include <filesystem>

namespace opening {

namespace {

namespace fs = std::filesystem;

bool exists(const std::string& file) {
    std::error_code error;
    return fs::exists(file, error);
}

std::string absolute(const std::string& file) {
    std::error_code error;
    const fs::path path = fs::absolute(file, error);
    return error ? file : path.string();
}

/// Reads the part of an address before "#".
void readAddress(Document& document, std::string_view name) {
    document.file = name;
    if (exists(document.file)) {
        return;
    }
    const std::size_t query = std::min(name.find('?'), name.size());
    if (name.find('#', query) != std::string_view::npos) {
        return; // no query holds this, so a place begins there
    }
    document.file = tvx::decodeAddress(name.substr(0, query));
    document.query = name.substr(std::min(query + 1, name.size()));
}

/// Reads a name with a place behind it that begins at `end`.
void read(Document& document, std::string_view name, std::size_t end) {
    document.query.clear();
    document.place.clear();
    if (end < name.size()) {
        document.place = name.substr(end + 1);
    }
    if (tvx::isFileAddress(document.text)) {
        document.place = tvx::decodeAddress(document.place);
        readAddress(document, name.substr(0, end));
    } else {
        document.file = name.substr(0, end);
    }
}

std::string_view nameIn(std::string_view text) {
    if (!tvx::isFileAddress(text)) {
        return text;
    }
    text.remove_prefix(5);
    if (text.starts_with("//")) {
        text.remove_prefix(std::min(text.find('/', 2), text.size())); // the name of this machine, if any
    }
    return text;
}

} // namespace

std::string Document::bareAddress() const {
    return "file://" + tvx::encodeAddress(file);
}

std::string Document::address() const {
    return bareAddress() + (query.empty() ? "" : "?" + query) + (place.empty() ? "" : "#" + tvx::encodeAddress(place));
}

Document readDocument(std::string_view text) {
    Document document{std::string(text), {}, {}, {}};
    if (tvx::isAddress(text) && !tvx::isFileAddress(text)) {
        return document;
    }
    const std::string_view name = nameIn(text);
    // From the longest name that may be meant to the shortest, the first that is there.
    for (std::size_t end = name.size(); end != std::string_view::npos && end > 0; end = name.rfind('#', end - 1)) {
        read(document, name, end);
        if (exists(document.file)) {
            document.file = absolute(document.file);
            return document;
        }
    }
    read(document, name, std::min(name.find('#'), name.size()));
    document.file = absolute(document.file);
    return document;
}

} // namespace opening
