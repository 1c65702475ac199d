#include "s/AccelProfile.h"

#include "s/KeptKeys.h"
#include "s/Profile.h"

int Gui_AccelProfile::Read(Gui_AccelMap& map, const char* entry, const char* section) {
    CString text;
    if (!Gui_Profile::ReadString(text, entry, section)) {
        return 0;
    }
    ApplyKeptKeys(text.View(), map);
    return 1;
}

void Gui_AccelProfile::Write(const Gui_AccelMap& map, const Gui_AccelMap& own, const char* entry, const char* section) {
    const CString text = KeptKeysText(map, own);
    Gui_Profile::WriteString(text.IsEmpty() ? nullptr : text.GetString(), entry, section);
}

void Gui_AccelProfile::Forget(const char* entry, const char* section) {
    Gui_Profile::WriteString(nullptr, entry, section);
}
