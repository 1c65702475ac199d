// Splits arbitrary text as a command file and checks what holds for every one.
#include "platform/port/detail/CommandFile.h"

#include <cstdint>
#include <cstdlib>

namespace {

std::string quoted(const std::string& word) {
    const char quote = word.find('"') == std::string::npos ? '"' : '\'';
    return quote + word + quote;
}

bool canBeQuoted(const std::string& word) {
    return word.find('"') == std::string::npos || word.find('\'') == std::string::npos;
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const std::string_view text(reinterpret_cast<const char*>(data), size);
    const auto read = Port::detail::splitCommandText(text);
    std::string again;
    std::vector<std::string> expected;
    for (const std::string& word : read.words) {
        if (word.size() > size || word.find_first_of("\r\n") != std::string::npos) {
            std::abort();
        }
        if (canBeQuoted(word)) {
            again += quoted(word) + "\r\n";
            expected.push_back(word);
        }
    }
    // What is written with quotes reads back as it was.
    const auto back = Port::detail::splitCommandText(again);
    if (back.words != expected || !back.unclosedLines.empty()) {
        std::abort();
    }
    return 0;
}
