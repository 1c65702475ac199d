#include "NotesDoc.h"

#include "NotesView.h"
#include "Resource.h"
#include "platform/base/SystemPath.h"
#include "s/Msg.h"

#include <utility>

namespace {

constexpr ULONGLONG largestFile = 16 * 1024 * 1024;

int tell(UINT id, LPCSTR path, UINT buttons, UINT help) {
    Gui_Msg message(id);
    message << tvx::shownName(path).c_str();
    return AfxMessageBox(message, buttons | MB_ICONEXCLAMATION, help);
}

std::string bytesOf(CFile& file, ULONGLONG length) {
    std::string bytes(length, '\0');
    bytes.resize(file.Read(bytes.data(), static_cast<UINT>(length)));
    return bytes;
}

} // namespace

IMPLEMENT_DYNCREATE(CNotesDoc, CDocument)

void CNotesDoc::DeleteContents() {
    m_text = {};
}

// The whole file is read before anything is given up: one that cannot be shown leaves the present text as it is.
BOOL CNotesDoc::OnOpenDocument(LPCSTR path) {
    std::string bytes;
    try {
        CWaitCursor wait;
        CFile file(path, CFile::modeRead | CFile::shareDenyWrite);
        const ULONGLONG length = file.GetLength();
        if (length > largestFile) {
            tell(IDS_TOO_LARGE, path, MB_OK, AFX_IDP_FAILED_TO_OPEN_DOC);
            return FALSE;
        }
        bytes = bytesOf(file, length);
    } catch (CException* problem) {
        ReportSaveLoadException(path, problem, FALSE, AFX_IDP_FAILED_TO_OPEN_DOC);
        problem->Delete();
        return FALSE;
    }
    if (!FileText::isText(bytes)) {
        tell(IDS_NO_TEXT, path, MB_OK, AFX_IDP_FAILED_TO_OPEN_DOC);
        return FALSE;
    }
    DeleteContents();
    m_text = FileText(bytes);
    SetModifiedFlag(FALSE);
    return TRUE;
}

// The base writes a new file beside the old one, whose place it takes when all is written.
BOOL CNotesDoc::OnSaveDocument(LPCSTR path) {
    if (hasChangedFile(path) && tell(IDS_CHANGED, path, MB_YESNO | MB_DEFBUTTON2, IDS_CHANGED) != IDYES) {
        return FALSE;
    }
    POSITION first = GetFirstViewPosition();
    auto* view = static_cast<CNotesView*>(GetNextView(first));
    m_bytes = m_text.bytesOf(view->GetText());
    const BOOL saved = CDocument::OnSaveDocument(path);
    const std::string bytes = std::exchange(m_bytes, {});
    if (saved) {
        m_text = FileText(bytes);
        view->SetSaved();
    }
    return saved;
}

// Compared byte by byte: times of files tell of changes that are none, and miss those within a second.
bool CNotesDoc::hasChangedFile(LPCSTR path) const {
    CFile file;
    if (path != GetPathName() || !file.Open(path, CFile::modeRead | CFile::shareDenyNone)) {
        return false;
    }
    const std::string read = m_text.bytesOf(m_text.edited());
    try {
        return file.GetLength() != read.size() || bytesOf(file, read.size()) != read;
    } catch (CException* problem) {
        problem->Delete();
        return false;
    }
}

void CNotesDoc::Serialize(CArchive& archive) {
    archive.Write(m_bytes.data(), static_cast<UINT>(m_bytes.size()));
}
