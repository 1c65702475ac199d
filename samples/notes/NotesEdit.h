#pragma once

#include "s/Edit.h"

/// The control that the text is typed into. Files that are dropped on it are opened, as everywhere in the window;
/// without that their names would be inserted.
class CNotesEdit : public Gui_Edit {
protected:
    afx_msg void OnDropFiles(HANDLE drop);
    DECLARE_MESSAGE_MAP()
};
