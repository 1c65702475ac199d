// What shapes the file dialogs.
#include "s/WinApp.h"

#include "afxdlgs.h"
#include "platform/base/SystemPath.h"
#include "s/FileName.h"
#include "s/MainWindow.h"
#include "s/StringOf.h"

namespace {

/// Whether a full name has the family's form. One that has no other than the system's, because it holds a backslash,
/// must stay as it is.
bool hasOwnForm(std::string_view path) {
    return !path.starts_with('/');
}

} // namespace

HWND Gui_WinApp::GetOwnerForFileDialog() {
    return MainWindowHandle();
}

CString Gui_WinApp::GetInitialDirForFileDialog(const CString& fileName) {
    const Gui_FileName name(fileName);
    return name.HasAbsolutePath() ? name.GetMountAndPath() : CString(tvx::currentFolderName().c_str());
}

CString Gui_WinApp::GetBaseNameForFileDialog(const CString& fileName) {
    const Gui_FileName name(fileName);
    return name.HasAbsolutePath() ? name.GetBaseAndExtension() : fileName;
}

CString Gui_WinApp::GetFilterForFileDialog(CDocTemplate* docTemplate, int addAllFiles) {
    CString filter;
    if (docTemplate) {
        AddFileFilter(filter, docTemplate);
    }
    for (POSITION at = docTemplate ? nullptr : GetFirstDocTemplatePosition(); at;) {
        AddFileFilter(filter, GetNextDocTemplate(at));
    }
    if (addAllFiles) {
        AddFileFilter(filter, AFX_IDS_ALLFILTER, "*.*");
    }
    return filter;
}

CString Gui_WinApp::GetDefaultExtForFileDialog(CDocTemplate* docTemplate) {
    POSITION first = docTemplate ? nullptr : GetFirstDocTemplatePosition();
    if (first) {
        docTemplate = GetNextDocTemplate(first);
    }
    CString extension;
    if (docTemplate) {
        docTemplate->GetDocString(extension, CDocTemplate::filterExt);
    }
    return extension.Mid(1);
}

CString Gui_WinApp::GetTitleForFileDialog(unsigned int titleId) {
    return StringOf(titleId);
}

unsigned int Gui_WinApp::GetFlagsForFileDialog(unsigned int flags) {
    return flags & ~OFN_SHOWHELP;
}

CString Gui_WinApp::GetPathNameFromFileDialog(CFileDialog& dialog) {
    const CString path = dialog.GetPathName();
    return hasOwnForm(path.View()) ? Gui_FileName(path).GetFullName() : path;
}

CString Gui_WinApp::GetAbbreviatedFileName(const char* path, int maxLength, BOOL keepName) {
    return hasOwnForm(path) ? Gui_FileName(path).GetAbbreviatedName(maxLength, keepName) : CString(path);
}

void Gui_WinApp::AddFileFilter(CString& filter, const CString& description, const CString& pattern) {
    // The new entry follows the zero that ends the one before.
    if (filter.GetLength() >= 2 && filter.View().ends_with(std::string_view("\0\0", 2))) {
        filter.Truncate(filter.GetLength() - 1);
    }
    filter += description;
    filter += '\0';
    filter += pattern;
    filter.Append("\0\0", 2);
}

void Gui_WinApp::AddFileFilter(CString& filter, unsigned int descriptionId, const CString& pattern) {
    AddFileFilter(filter, StringOf(descriptionId), pattern);
}

void Gui_WinApp::AddFileFilter(CString& filter, CDocTemplate* docTemplate) {
    CString name;
    CString extension;
    if (docTemplate->GetDocString(name, CDocTemplate::filterName) && !name.IsEmpty() &&
        docTemplate->GetDocString(extension, CDocTemplate::filterExt) && !extension.IsEmpty()) {
        AddFileFilter(filter, name, '*' + extension);
    }
}
