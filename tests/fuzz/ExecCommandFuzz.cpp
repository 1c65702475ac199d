// Calls of desktop entries: the command of the settings and the one through the helper program end in the same words.
#include "platform/win/detail/CommandLine.h"
#include "platform/win/detail/ExecCommand.h"
#include "tools/open/Call.h"

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <iterator>
#include <sstream>
#include <string>
#include <vector>

namespace {

const std::string document = "notes.txt";

/// The words of a command, the program's among them, as a child gets them.
std::vector<std::string> wordsOf(const std::string& command) {
    const tvx::win::CommandLine line = tvx::win::readings(command).front();
    std::vector<std::string> words = tvx::win::splitArguments(line.arguments);
    words.insert(words.begin(), std::string(line.program));
    return words;
}

std::string withDocument(std::string command) {
    for (std::size_t at = command.find("%1"); at != std::string::npos; at = command.find("%1", at + document.size())) {
        command.replace(at, 2, document);
    }
    return command;
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    std::string text(reinterpret_cast<const char*>(data), size);
    std::erase(text, '\0'); // no word of a call holds one
    std::istringstream lines(text);
    std::vector<std::string> call{"program"};
    for (std::string word; std::getline(lines, word);) {
        call.push_back(word);
    }
    const std::string plain = tvx::win::commandFor(call, tvx::win::Opens::Papers, {});
    const std::string helped = tvx::win::commandFor(call, tvx::win::Opens::Papers, "/bin/tvxopen");
    std::vector<std::string> words = wordsOf(withDocument(helped));
    words.erase(words.begin());
    if (words.front() == "--names") {
        return 0; // the helper makes an absolute name of the document
    }
    if (std::ranges::find(words, "@@u") != words.end()) {
        return 0; // it makes an address of it
    }
    words.pop_back();
    const std::vector<std::string> reached = opening::wordsFor({opening::Takes::AddressesAndNames, words}, document);
    if (!plain.empty() && wordsOf(withDocument(plain)) != reached) {
        std::abort();
    }
    return 0;
}
