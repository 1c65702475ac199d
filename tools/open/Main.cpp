#include "tools/open/Call.h"

#include <cerrno>
#include <cstring>
#include <iostream>
#include <string>
#include <string_view>
#include <unistd.h>
#include <vector>

namespace {

constexpr const char* usage = R"(Usage: tvxopen [--names] [--] COMMAND [WORD...] DOCUMENT
Starts COMMAND with DOCUMENT the way that it needs it: places within PDF documents
as its own option, addresses of files as names.

  --names    COMMAND takes names of files only, no addresses
  --help, --version

In COMMAND and each WORD "{}" stands for the document and "{25}" for the character
with that hexadecimal number. Without "{}" the document comes last.
)";

enum Code { CannotOpen = 1, WrongUsage = 2, CannotStart = 126, NotFound = 127 };

/// Reads the switches. False when there is nothing to start, with the code to end with.
bool readSwitches(std::vector<std::string>& words, opening::Call& call, int& code) {
    while (!words.empty() && words[0].starts_with("--")) {
        const std::string word = words[0];
        words.erase(words.begin());
        if (word == "--") {
            break;
        }
        if (word == "--names") {
            call.takes = opening::Takes::Names;
            continue;
        }
        if (word == "--help" || word == "--version") {
            std::cout << (word == "--help" ? usage : "tvxopen " TVX_VERSION "\n");
            code = 0;
        } else {
            std::cerr << "tvxopen: unknown option " << word << "\n" << usage;
            code = WrongUsage;
        }
        return false;
    }
    return true;
}

/// Becomes the program. Comes back only when that fails.
int become(std::vector<std::string> words) {
    std::vector<char*> arguments;
    arguments.reserve(words.size() + 1);
    for (std::string& word : words) {
        arguments.push_back(word.data());
    }
    arguments.push_back(nullptr);
    ::execvp(arguments[0], arguments.data());
    std::cerr << "tvxopen: " << words[0] << ": " << std::strerror(errno) << "\n";
    return errno == ENOENT ? NotFound : CannotStart;
}

} // namespace

int main(int argc, char** argv) {
    std::vector<std::string> words(argv + 1, argv + argc);
    opening::Call call;
    int code = 0;
    if (!readSwitches(words, call, code)) {
        return code;
    }
    if (words.size() < 2) {
        std::cerr << "tvxopen: a command and a document are needed\n" << usage;
        return WrongUsage;
    }
    const std::string document = words.back();
    words.pop_back();
    call.words = std::move(words);
    try {
        return become(opening::wordsFor(call, document));
    } catch (const opening::Failure& failure) {
        std::cerr << "tvxopen: " << failure.message << "\n";
        return CannotOpen;
    }
}
