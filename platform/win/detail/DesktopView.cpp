#include "platform/win/detail/DesktopView.h"

#include "platform/win/Module.h"
#include "platform/win/Registry.h"
#include "platform/win/detail/DesktopHandlers.h"
#include "platform/win/detail/ExecCommand.h"
#include "platform/win/detail/ProgramSearch.h"

#include <algorithm>
#include <array>
#include <cstdlib>
#include <filesystem>

namespace tvx::registry {

namespace {

namespace fs = std::filesystem;

/// The installed program that takes documents to others the way they need it; empty where it is not installed. It
/// stands beside this library's folder: in a build tree, and in an installation with or without a folder for the
/// processor's kind ("lib/x86_64-linux-gnu").
std::string helper() {
    static const char own = 0;
    const fs::path folder = fs::path(moduleFileName(moduleFromAddress(&own))).parent_path();
    for (const char* bin : {"../bin", "../../bin"}) {
        const fs::path file = (folder / bin / "tvxopen").lexically_normal();
        std::error_code error;
        if (fs::exists(file, error)) {
            return file.string();
        }
    }
    return {};
}

std::string firstCommand(std::initializer_list<const char*> types, win::Opens opens) {
    const std::string file = helper();
    for (const char* type : types) {
        for (const std::vector<std::string>& words : win::handlersOf(type)) {
            std::string command = win::commandFor(words, opens, file);
            if (!command.empty()) {
                return command;
            }
        }
    }
    return {};
}

std::string pageCommand() {
    return firstCommand({"text/html", "x-scheme-handler/http"}, win::Opens::Pages);
}

std::string paperCommand() {
    return firstCommand({"application/pdf"}, win::Opens::Papers);
}

std::string textCommand() {
    return firstCommand({"text/plain"}, win::Opens::Texts);
}

std::string editorCommand() {
    return firstCommand({"text/plain"}, win::Opens::TextsBehind);
}

/// Whether a browser shows its pages in a terminal, which it would not have.
bool needsTerminal(const std::string& program) {
    constexpr std::array<std::string_view, 7> names{"w3m", "lynx", "links", "links2", "elinks", "browsh", "edbrowse"};
    std::error_code error;
    const std::string name = fs::canonical(program, error).filename().string();
    return std::ranges::find(names, name) != names.end();
}

/// The file of a browser with windows; empty when there is none.
std::string browserFile(const char* name) {
    const std::string file = name ? win::findProgram(name).file : std::string();
    return file.empty() || needsTerminal(file) ? std::string() : file;
}

/// Debian's names for "a browser". "sensible-browser" starts what the user has set in BROWSER, and without it only what
/// the others name too.
std::string genericBrowserCommand() {
    std::string file = browserFile(std::getenv("BROWSER"));
    file = file.empty() ? file : browserFile("sensible-browser");
    for (const char* name : {"x-www-browser", "gnome-www-browser", "www-browser"}) {
        file = file.empty() ? browserFile(name) : file;
    }
    return file.empty() ? file : win::quoted(file) + " \"%1\"";
}

constexpr std::string_view ownClasses = "software\\classes\\tarvex.desktop.";

/// A key of the view.
struct Entry {
    std::string_view key;     ///< its path without case
    std::string (*command)(); ///< the command that it is about; without one the key has no value
    std::string_view value;   ///< what the default value is when there is one, empty: the command itself
};

constexpr std::array<Entry, 9> entries{{
    {"software\\classes\\.htm", &pageCommand, "tarvex.desktop.text-html"},
    {"software\\classes\\.html", &pageCommand, "tarvex.desktop.text-html"},
    {"software\\classes\\.pdf", &paperCommand, "tarvex.desktop.application-pdf"},
    {"software\\classes\\.txt", &textCommand, "tarvex.desktop.text-plain"},
    {"software\\classes\\tarvex.desktop.text-html\\shell\\open\\command", &pageCommand, {}},
    {"software\\classes\\tarvex.desktop.application-pdf\\shell\\open\\command", &paperCommand, {}},
    {"software\\classes\\tarvex.desktop.text-plain\\shell\\open\\command", &textCommand, {}},
    {"software\\classes\\applications\\iexplore.exe\\shell\\open\\command", &genericBrowserCommand, {}},
    {"software\\microsoft\\windows\\currentversion\\app paths\\wordpad.exe", &editorCommand, {}},
}};

const Entry* entryOf(const KeyPath& key) {
    const auto found = std::ranges::find(entries, std::string_view(key.folded), &Entry::key);
    return found != entries.end() ? found : nullptr;
}

/// Whether a key stands above one of the view's, within its own classes.
bool isAbove(const KeyPath& key) {
    return key.folded.starts_with(ownClasses) &&
           std::ranges::any_of(entries, [&](const Entry& entry) { return entry.key.starts_with(key.folded + "\\"); });
}

std::shared_ptr<const Value> valueOf(const Entry& entry) {
    std::string text = entry.command();
    if (text.empty()) {
        return nullptr;
    }
    text = entry.value.empty() ? text : std::string(entry.value);
    text += '\0';
    return std::make_shared<const Value>(Value{{}, REG_SZ, std::move(text)});
}

} // namespace

DWORD DesktopView::findKey(const KeyPath& key) {
    return entryOf(key) || isAbove(key) ? ERROR_SUCCESS : ERROR_FILE_NOT_FOUND;
}

DWORD DesktopView::readValue(const KeyPath& key, std::string_view name, std::shared_ptr<const Value>& value) {
    const Entry* entry = name.empty() ? entryOf(key) : nullptr;
    value = entry ? valueOf(*entry) : nullptr;
    return value ? ERROR_SUCCESS : ERROR_FILE_NOT_FOUND;
}

DWORD DesktopView::keyAt(const KeyPath& /*key*/, DWORD /*index*/, Cursor& /*cursor*/, std::string& /*name*/) {
    return ERROR_NO_MORE_ITEMS;
}

DWORD DesktopView::valueAt(const KeyPath& key, DWORD index, Cursor& /*cursor*/, Value& value) {
    std::shared_ptr<const Value> found;
    if (index != 0 || readValue(key, {}, found) != ERROR_SUCCESS) {
        return ERROR_NO_MORE_ITEMS;
    }
    value = *found;
    return ERROR_SUCCESS;
}

} // namespace tvx::registry
