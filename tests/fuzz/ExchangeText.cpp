// Reads arbitrary text as settings, writes what was read and reads that again: it must be the same.
#include "tools/settings/ExchangeText.h"

#include <cstdint>
#include <cstdlib>
#include <string>

using namespace settings;

namespace {

void checkRoundTrip(const Change& change) {
    const std::string text = writeHeader() + writeKey({HKEY_CURRENT_USER, "k"}) + writeSetting(change.setting);
    const auto again = readExchangeText(text);
    if (again.size() != 2 || again[1].setting.name != change.setting.name ||
        again[1].setting.type != change.setting.type || again[1].setting.data != change.setting.data) {
        std::abort();
    }
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    try {
        for (const Change& change : readExchangeText({reinterpret_cast<const char*>(data), size})) {
            if (change.kind == Change::Kind::SetValue) {
                checkRoundTrip(change);
            }
        }
    } catch (const TextFault& fault) {
        if (fault.line < 0 || fault.message.empty()) {
            std::abort();
        }
    }
    return 0;
}
