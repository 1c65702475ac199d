#include "platform/afx/core/KeyNames.h"

#include "platform/afx/core/detail/KeyTable.h"
#include "platform/base/Text.h"
#include "platform/win/ResourceConstants.h"

using namespace tvx::afx;

namespace {

UINT characterOf(int virtualKey) {
    switch (virtualKey) {
    case VK_BACK:
    case VK_TAB:
    case VK_RETURN:
    case VK_ESCAPE:
        return static_cast<UINT>(virtualKey); // their control characters
    default:
        return usualSign(virtualKey);
    }
}

} // namespace

UINT MapVirtualKeyA(UINT code, UINT type) {
    switch (type) {
    case 0:
        return static_cast<UINT>(scanCodeOf(static_cast<int>(code)) & 0xFF);
    case 1:
    case 3: {
        const auto scanCode = static_cast<int>(code & 0xFF);
        const int plain = virtualKeyAt(scanCode);
        // Without a bit that tells, the cursor block's key is meant where the keypad's has the same code.
        const bool shared = plain >= VK_NUMPAD0 && plain <= VK_DIVIDE;
        return static_cast<UINT>(shared || code > 0xFF ? virtualKeyAt(scanCode | extendedKey) : plain);
    }
    case 2:
        return characterOf(static_cast<int>(code));
    default:
        return 0;
    }
}

int GetKeyNameTextA(LONG parameter, LPSTR buffer, int size) {
    const auto bits = static_cast<DWORD>(parameter);
    const bool extended = (bits & (1U << 24)) != 0;
    const int scanCode = static_cast<int>((bits >> 16) & 0xFFU) | (extended ? extendedKey : 0);
    const std::string name = keyName(virtualKeyAt(scanCode)).toStdString();
    return size > 0 ? static_cast<int>(tvx::text::copyCut(name, buffer, static_cast<std::size_t>(size))) : 0;
}
