#include "NotesDoc.h"

#include "NotesView.h"
#include "Resource.h"
#include "platform/base/SystemPath.h"
#include "s/Msg.h"

#include <utility>

namespace {

constexpr ULONGLONG largestFile = 16 * 1024 * 1024;

void tell(UINT id, LPCSTR path) {
    Gui_Msg message(id);
    message << tvx::shownName(path).c_str();
    AfxMessageBox(message, MB_OK | MB_ICONEXCLAMATION, AFX_IDP_FAILED_TO_OPEN_DOC);
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
            tell(IDS_TOO_LARGE, path);
            return FALSE;
        }
        bytes.resize(length);
        bytes.resize(file.Read(bytes.data(), static_cast<UINT>(length)));
    } catch (CException* problem) {
        ReportSaveLoadException(path, problem, FALSE, AFX_IDP_FAILED_TO_OPEN_DOC);
        problem->Delete();
        return FALSE;
    }
    if (!FileText::isText(bytes)) {
        tell(IDS_NO_TEXT, path);
        return FALSE;
    }
    DeleteContents();
    m_text = FileText(bytes);
    SetModifiedFlag(FALSE);
    return TRUE;
}

// The base writes a new file beside the old one, whose place it takes when all is written.
BOOL CNotesDoc::OnSaveDocument(LPCSTR path) {
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

void CNotesDoc::Serialize(CArchive& archive) {
    archive.Write(m_bytes.data(), static_cast<UINT>(m_bytes.size()));
}
