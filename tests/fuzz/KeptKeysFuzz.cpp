// Reads arbitrary text as the record of a user's keys; the keys that come of it are the same after they were written
// and read again.
#include "s/KeptKeys.h"

#include <cstdint>
#include <cstdlib>

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const tagACCEL accels[] = {
        {FVIRTKEY | FCONTROL, 'N', 100}, {FVIRTKEY | FCONTROL, 'O', 101}, {FVIRTKEY, VK_F2, 102}};
    const Gui_AccelMap own(accels, 3);
    Gui_AccelMap first(own);
    ApplyKeptKeys({reinterpret_cast<const char*>(data), size}, first);
    Gui_AccelMap second(own);
    ApplyKeptKeys(KeptKeysText(first, own).View(), second);
    if (!first.IsSame(second)) {
        std::abort();
    }
    return 0;
}
