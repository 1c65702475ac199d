#include "s/KeyTexts.h"

#include "platform/afx/core/KeyNames.h"
#include "platform/base/Text.h"
#include "res/resource.h"
#include "s/Msg.h"

#include <algorithm>
#include <iterator>
#include <string>

namespace {

constexpr const char* separator = "+";
constexpr int longestName = 49;
constexpr int usualLength = 24;
constexpr WORD arrowKeys[] = {VK_LEFT, VK_UP, VK_RIGHT, VK_DOWN};
/// Keys that share their scan codes with the numeric keypad, which has other names for them.
constexpr WORD extendedKeys[] = {VK_HOME,   VK_END,  VK_PRIOR, VK_NEXT,  VK_INSERT,
                                 VK_DELETE, VK_LEFT, VK_UP,    VK_RIGHT, VK_DOWN};
constexpr UINT extendedBit = 1U << 24U;

template <std::size_t count>
bool isOneOf(const WORD (&keys)[count], WORD key) {
    return std::find(std::begin(keys), std::end(keys), key) != std::end(keys);
}

CString lookUp(WORD key) {
    const UINT scanCode = MapVirtualKeyA(key, 0) << 16U;
    char name[longestName + 1] = "";
    GetKeyNameTextA(static_cast<LONG>(scanCode | (isOneOf(extendedKeys, key) ? extendedBit : 0U)), name,
                    static_cast<int>(sizeof name));
    return name;
}

} // namespace

CString KeyTexts::textOf(const tagACCEL& accel) {
    return (accel.fVirt & FVIRTKEY) != 0 ? virtualKeyText(accel) : characterText(accel);
}

const CString& KeyTexts::nameOf(WORD key) {
    const auto known = m_names.find(key);
    return known != m_names.end() ? known->second
                                  : *tvx::allocating([&] { return &m_names.emplace(key, lookUp(key)).first->second; });
}

CString KeyTexts::virtualKeyText(const tagACCEL& accel) {
    CString text;
    text.Preallocate(usualLength);
    for (const auto& [flag, modifier] : {std::pair(FCONTROL, VK_CONTROL), {FALT, VK_MENU}, {FSHIFT, VK_SHIFT}}) {
        if ((accel.fVirt & flag) != 0) {
            text += nameOf(static_cast<WORD>(modifier));
            text += separator;
        }
    }
    if (accel.key != 0) {
        text += nameOf(accel.key);
    }
    if (isOneOf(arrowKeys, accel.key)) {
        Gui_Msg message(GUI_IDS_ARROW_KEY);
        message << text;
        text = message.GetValue();
    }
    return text;
}

CString KeyTexts::characterText(const tagACCEL& accel) {
    CString text;
    if ((accel.fVirt & FCONTROL) != 0) {
        text = nameOf(VK_CONTROL) + separator;
    }
    if (accel.key != 0) {
        std::string character;
        tvx::text::append(character, accel.key);
        const bool isUpper = (accel.fVirt & (FSHIFT | FCONTROL)) != 0;
        text += CString(isUpper ? tvx::text::toUpper(character) : character);
    }
    return text;
}
