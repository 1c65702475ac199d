#include "s/DocManager.h"

#include "afxdlgs.h"
#include "s/WinApp.h"

IMPLEMENT_DYNCREATE(Gui_DocManager, CDocManager)

namespace {

/// Size of the name field's buffer: the longest name that the family's platform has.
constexpr DWORD nameRoom = 260;

/// The filter of the last accepted dialog, counted from 1.
DWORD lastFilter = 1;

} // namespace

int Gui_DocManager::DoPromptFileName(CString& fileName, unsigned int titleId, DWORD flags, int openDialog,
                                     CDocTemplate* docTemplate) {
    auto* app = DYNAMIC_DOWNCAST(Gui_WinApp, AfxGetApp());
    if (!app) {
        return CDocManager::DoPromptFileName(fileName, titleId, flags, openDialog, docTemplate);
    }
    CFileDialog dialog(openDialog, nullptr, nullptr, OFN_HIDEREADONLY | OFN_OVERWRITEPROMPT);
    OPENFILENAME& record = dialog.m_ofn;
    record.hwndOwner = app->GetOwnerForFileDialog();
    const CString title = app->GetTitleForFileDialog(titleId);
    record.lpstrTitle = title;
    record.Flags = app->GetFlagsForFileDialog(record.Flags | flags);
    const CString filter = app->GetFilterForFileDialog(docTemplate, 1);
    record.lpstrFilter = filter;
    const CString folder = app->GetInitialDirForFileDialog(fileName);
    record.lpstrInitialDir = folder;
    const CString extension = app->GetDefaultExtForFileDialog(docTemplate);
    record.lpstrDefExt = extension;
    CString name = app->GetBaseNameForFileDialog(fileName).Left(nameRoom - 1);
    record.lpstrFile = name.GetBuffer(nameRoom);
    record.nMaxFile = nameRoom;
    record.nFilterIndex = lastFilter;
    if (dialog.DoModal() != IDOK) {
        return 0;
    }
    fileName = app->GetPathNameFromFileDialog(dialog);
    lastFilter = record.nFilterIndex;
    return 1;
}
