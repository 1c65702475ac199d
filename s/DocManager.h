#pragma once

#include "afxwin.h"
#include "s/Export.h"

/// The document manager of the family's applications: where the framework asks for the name of a file to open or save,
/// it shows a dialog that the application object shapes (the operations `...FileDialog` of Gui_WinApp).
///
/// Gui_WinApp::InitApplication makes one and puts it into `m_pDocManager`. A host with a manager of its own derives it
/// from this class, and puts it there in InitInstance, before the first template is added and in place of the one that
/// it deletes:
///
/// @code
/// delete m_pDocManager;
/// m_pDocManager = new CPlanManager;
/// @endcode
class GUI_API Gui_DocManager : public CDocManager {
    DECLARE_DYNCREATE(Gui_DocManager)

public:
    Gui_DocManager() = default;

    /// Asks for a file by the application's dialog. It begins with the filter that the last accepted dialog of the
    /// process was left with, counted by its position. Where the application is no Gui_WinApp the framework's own
    /// dialog asks.
    /// @param fileName   in: the name shown first; out: the chosen one, unchanged when the user cancelled
    /// @param titleId    string that becomes the dialog's title
    /// @param flags      OFN_ bits, in addition to those for no read-only box and the question before overwriting
    /// @param openDialog non-zero to open a file, 0 to save one
    /// @param docTemplate whose files are shown; null for those of all templates
    /// @return 1 when the user chose a file, else 0
    int DoPromptFileName(CString& fileName, unsigned int titleId, DWORD flags, int openDialog,
                         CDocTemplate* docTemplate) override;
};
