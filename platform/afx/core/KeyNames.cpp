#include "platform/afx/core/KeyNames.h"

#include "platform/afx/core/detail/KeyLayout.h"
#include "platform/afx/core/detail/KeyTable.h"
#include "platform/afx/core/detail/Keys.h"
#include "platform/afx/core/detail/OwnText.h"
#include "platform/base/Text.h"
#include "platform/win/FrameworkIds.h"
#include "platform/win/ResourceConstants.h"

namespace tvx::afx {

namespace {

/// What is on a key, in the user's layout where that is known; letters and digits are their own signs.
char32_t signOf(int virtualKey) {
    const KeyLayout* layout = presentLayout();
    const char32_t sign = layout && usualSign(virtualKey) != virtualKey ? layout->sign(virtualKey) : 0;
    return sign != 0 ? QChar::toUpper(sign) : usualSign(virtualKey);
}

QString toText(char32_t sign) {
    return QString::fromUcs4(&sign, 1);
}

} // namespace

QString keyName(int virtualKey) {
    if (virtualKey >= VK_F1 && virtualKey <= VK_F24) {
        return QStringLiteral("F%1").arg(virtualKey - VK_F1 + 1);
    }
    if (isKeypadSign(virtualKey)) {
        return ownText(TVX_IDS_KEYPAD).arg(toText(signOf(virtualKey)));
    }
    if (isCharacterKey(virtualKey) && virtualKey != VK_SPACE) {
        return toText(signOf(virtualKey));
    }
    return scanCodeOf(virtualKey) != 0 ? ownText(static_cast<UINT>(TVX_IDS_KEY + virtualKey)) : QString();
}

} // namespace tvx::afx

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
        return signOf(virtualKey);
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
