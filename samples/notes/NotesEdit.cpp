#include "NotesEdit.h"

// clang-format off
BEGIN_MESSAGE_MAP(CNotesEdit, Gui_Edit)
    ON_WM_DROPFILES()
END_MESSAGE_MAP()
// clang-format on

void CNotesEdit::OnDropFiles(HANDLE drop) {
    GetTopLevelFrame()->SendMessage(WM_DROPFILES, reinterpret_cast<WPARAM>(drop));
}
