#include "s/Accel.h"

#include "s/KeyTexts.h"

static_assert(sizeof(Gui_Accel) == sizeof(tagACCEL), "tables of accelerators are handed out as they are");

Gui_Accel& Gui_Accel::operator=(const tagACCEL& accel) {
    static_cast<tagACCEL&>(*this) = accel;
    return *this;
}

int Gui_Accel::IsEmpty() const {
    return *this == Gui_Accel() ? 1 : 0;
}

void Gui_Accel::Clear() {
    *this = tagACCEL{};
}

Gui_Accel::operator tagACCEL*() {
    return this;
}

CString Gui_Accel::GetKeyText() const {
    return KeyTexts().textOf(*this);
}
