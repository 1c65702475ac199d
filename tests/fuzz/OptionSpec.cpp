// Reads arbitrary text as an option specification, asks for its usage summary and checks its own lines as arguments.
#include "platform/port/detail/OptionSpec.h"

#include "platform/port/CmdArgs.h"
#include "platform/port/CmdOpcodes.h"
#include "platform/port/MsgDispatcher.h"

#include <cstdint>
#include <cstdlib>
#include <sstream>

namespace {

class Counter : public Port_MsgMan {
public:
    Counter() : Port_MsgMan("Counter") {
        Port_MsgDispatcher::addMsgMan(this);
    }

protected:
    void msgWrite(MsgType, const wchar_t*) override {}
};

void checkSpec(const std::string& text) {
    const auto spec = Port::detail::parseOptionSpec(text);
    for (const auto& rule : spec.options) {
        const auto found = spec.find(rule.name);
        if (found.size() != 1 || found.front() != &rule) {
            std::abort();
        }
    }
    std::free(UT_CMDOPCODES(text.c_str()).usage());
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const std::string text(reinterpret_cast<const char*>(data), size);
    checkSpec(text);

    std::vector<std::string> words;
    std::istringstream stream(text);
    for (std::string word; stream >> word;) {
        words.push_back(word);
    }
    std::vector<const char*> arguments;
    for (const std::string& word : words) {
        arguments.push_back(word.c_str());
    }
    const Counter counter;
    const UT_CMDARGS check(static_cast<int>(arguments.size()), arguments.data(), text.c_str(), nullptr,
                           UT_CMDARGS::NoProgramName);
    if (check.iserror() != (counter.getErrorCount() > 0)) {
        std::abort();
    }
    return 0;
}
