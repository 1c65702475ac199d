#include "s/Accel.h"

#include "platform/afx/core/KeyNames.h"
#include "platform/base/Text.h"
#include "res/resource.h"
#include "s/Msg.h"

#include <algorithm>
#include <iterator>
#include <string>

static_assert(sizeof(Gui_Accel) == sizeof(tagACCEL), "tables of accelerators are handed out as they are");

namespace {

constexpr const char* separator = "+";
constexpr int longestName = 49;
constexpr WORD arrowKeys[] = {VK_LEFT, VK_UP, VK_RIGHT, VK_DOWN};
/// Keys that share their scan codes with the numeric keypad, which has other names for them.
constexpr WORD extendedKeys[] = {VK_HOME,   VK_END,  VK_PRIOR, VK_NEXT,  VK_INSERT,
                                 VK_DELETE, VK_LEFT, VK_UP,    VK_RIGHT, VK_DOWN};
constexpr UINT extendedBit = 1U << 24U;

template <std::size_t count>
bool isOneOf(const WORD (&keys)[count], WORD key) {
    return std::find(std::begin(keys), std::end(keys), key) != std::end(keys);
}

CString nameOf(WORD key) {
    const UINT scanCode = MapVirtualKeyA(key, 0) << 16U;
    char name[longestName + 1] = "";
    GetKeyNameTextA(static_cast<LONG>(scanCode | (isOneOf(extendedKeys, key) ? extendedBit : 0U)), name,
                    static_cast<int>(sizeof name));
    return name;
}

CString virtualKeyText(const tagACCEL& accel) {
    CString text;
    for (const auto& [flag, modifier] : {std::pair(FCONTROL, VK_CONTROL), {FALT, VK_MENU}, {FSHIFT, VK_SHIFT}}) {
        if ((accel.fVirt & flag) != 0) {
            text += nameOf(static_cast<WORD>(modifier)) + separator;
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

CString characterText(const tagACCEL& accel) {
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

} // namespace

Gui_Accel::Gui_Accel() : tagACCEL{} {}

Gui_Accel::Gui_Accel(unsigned char flags, unsigned short key, unsigned short command) : tagACCEL{flags, key, command} {}

Gui_Accel::Gui_Accel(const tagACCEL& accel) : tagACCEL(accel) {}

Gui_Accel::Gui_Accel(const tagACCEL* accel) : tagACCEL(*accel) {}

Gui_Accel& Gui_Accel::operator=(const tagACCEL& accel) {
    static_cast<tagACCEL&>(*this) = accel;
    return *this;
}

bool Gui_Accel::IsSame(const tagACCEL& other) const {
    return fVirt == other.fVirt && key == other.key && cmd == other.cmd;
}

int Gui_Accel::IsEmpty() const {
    return IsSame(tagACCEL{}) ? 1 : 0;
}

void Gui_Accel::Clear() {
    *this = tagACCEL{};
}

Gui_Accel::operator tagACCEL*() {
    return this;
}

unsigned long Gui_Accel::EncodeFlagsAndKey() const {
    return static_cast<unsigned long>(key) << 16U | fVirt | FNOINVERT;
}

void Gui_Accel::DecodeFlagsAndKey(unsigned long packed) {
    fVirt = static_cast<BYTE>(packed);
    key = static_cast<WORD>(packed >> 16U);
}

CString Gui_Accel::GetKeyText() const {
    return (fVirt & FVIRTKEY) != 0 ? virtualKeyText(*this) : characterText(*this);
}
