#include "platform/win/Associations.h"

#include "platform/base/Address.h"
#include "platform/base/SystemPath.h"
#include "platform/win/detail/CommandLine.h"
#include "platform/win/detail/ProgramSearch.h"
#include "platform/win/detail/Sandbox.h"

#include <algorithm>
#include <cstdlib>
#include <filesystem>
#include <optional>
#include <vector>

namespace tvx {

namespace {

namespace fs = std::filesystem;

/// A command with everything taken away that only leads to another one.
struct Call {
    std::vector<std::string> words; ///< the program's file first; none when there is no such program
    bool takesFilesOnly = false;
};

/// Programs that call programs that call programs: more than this is a circle.
constexpr int mostSteps = 8;

std::vector<std::string> wordsOf(const std::string& commandLine) {
    const win::Program program = win::findProgram(commandLine);
    std::vector<std::string> words;
    if (!program.file.empty()) {
        words = win::splitArguments(program.arguments);
        words.insert(words.begin(), program.file);
    }
    return words;
}

/// Drops the program and the words behind it that `isSkipped` holds for; the next one becomes the program.
template <typename Predicate>
void skipTo(std::vector<std::string>& words, Predicate isSkipped) {
    words.erase(words.begin(), std::find_if_not(words.begin() + 1, words.end(), isSkipped));
    const std::string file = words.empty() ? std::string() : win::findProgram("\"" + words.front() + "\"").file;
    if (file.empty()) {
        words.clear();
    } else {
        words.front() = file;
    }
}

/// Takes one caller away. False when the first word is the program itself.
bool unwrap(Call& call) {
    const std::string name = fs::path(call.words.front()).filename().string();
    if (name == "tvxopen") {
        call.takesFilesOnly = std::ranges::find(call.words, "--names") != call.words.end();
        skipTo(call.words, [](const std::string& word) { return word.starts_with("--"); });
        return true;
    }
    if (name == "env") {
        skipTo(call.words,
               [](const std::string& word) { return word.starts_with('-') || word.find('=') != std::string::npos; });
        return true;
    }
    if (name == "sensible-browser") {
        const char* chosen = std::getenv("BROWSER");
        call.words = wordsOf(chosen && *chosen != '\0' ? chosen : "x-www-browser");
        return true;
    }
    return false;
}

Call callOf(const std::string& commandLine) {
    Call call{wordsOf(commandLine)};
    for (int count = 0; count < mostSteps && !call.words.empty() && unwrap(call); ++count) {
    }
    return call;
}

/// The name of the file that a document's name or address means.
std::optional<std::string> fileOf(const std::string& address) {
    const std::string word = win::wordForChild(address);
    if (!isFileAddress(word)) {
        return systemPath(word);
    }
    std::string name = word.substr(5);
    if (name.starts_with("//")) {
        name.erase(0, std::min(name.find('/', 2), name.size()));
    }
    std::error_code error;
    return fs::exists(name, error) ? name : decodeAddress(name.substr(0, name.find_first_of("?#")));
}

} // namespace

std::string obstacleTo(const std::string& commandLine, const std::string& address) {
    const Call call = callOf(commandLine);
    if (call.words.empty()) {
        return {};
    }
    if (isAddress(address) && !isFileAddress(address)) {
        return call.takesFilesOnly ? "files only" : "";
    }
    const win::Sandbox sandbox = win::sandboxOf(call.words);
    std::error_code error;
    const fs::path file = fs::weakly_canonical(fileOf(address).value_or(std::string()), error);
    if (win::canRead(sandbox, file)) {
        return {};
    }
    return sandbox.kind == win::SandboxKind::Snap ? "snap" : "flatpak";
}

} // namespace tvx
