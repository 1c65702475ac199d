#pragma once

#include "afxwin.h"

#include <unordered_map>

/// The names of accelerators for display. The names of keys are looked up once in the life of an object, which is to be
/// short: users change keyboards. Whoever names many keys uses one object for them all.
class KeyTexts {
public:
    /// What Gui_Accel::GetKeyText answers.
    CString textOf(const tagACCEL& accel);

private:
    const CString& nameOf(WORD key);
    CString virtualKeyText(const tagACCEL& accel);
    CString characterText(const tagACCEL& accel);

    std::unordered_map<WORD, CString> m_names;
};
