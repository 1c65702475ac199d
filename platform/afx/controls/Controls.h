#pragma once

/// @file
/// The plain controls.

#include "platform/afx/controls/Button.h"
#include "platform/afx/controls/ComboBox.h"
#include "platform/afx/controls/Edit.h"
#include "platform/afx/controls/ListBox.h"
#include "platform/afx/controls/ScrollBar.h"
#include "platform/afx/controls/Static.h"

// Kinds of controls that a host asks for
#define ICC_WIN95_CLASSES 0x00FF
#define ICC_STANDARD_CLASSES 0x4000

/// What a host says of the controls that it needs. Nothing looks at it.
struct INITCOMMONCONTROLSEX {
    DWORD dwSize; ///< sizeof(INITCOMMONCONTROLSEX).
    DWORD dwICC;  ///< ICC_...
};

/// Calls that hosts make in InitInstance: all controls that there are can be used at once.
/// @{
inline void InitCommonControls() {}
inline BOOL InitCommonControlsEx(const INITCOMMONCONTROLSEX* controls) {
    return TRUE;
}
/// @}
