#include "platform/afx/frames/Document.h"

#include "platform/afx/core/App.h"
#include "platform/afx/core/detail/Paths.h"
#include "platform/afx/dialogs/FileDialog.h"
#include "platform/afx/frames/DocTemplate.h"
#include "platform/afx/frames/View.h"
#include "platform/base/SystemPath.h"

#include <cerrno>

using namespace tvx::afx;

IMPLEMENT_DYNAMIC(CDocument, CCmdTarget)

// clang-format off
BEGIN_MESSAGE_MAP(CDocument, CCmdTarget)
    ON_COMMAND(ID_FILE_CLOSE, &CDocument::OnFileClose)
    ON_COMMAND(ID_FILE_SAVE, &CDocument::OnFileSave)
    ON_COMMAND(ID_FILE_SAVE_AS, &CDocument::OnFileSaveAs)
END_MESSAGE_MAP()
// clang-format on

CDocument::~CDocument() {
    disconnectViews();
    if (m_pDocTemplate) {
        m_pDocTemplate->RemoveDocument(this);
    }
}

void CDocument::disconnectViews() {
    for (CView* view : m_views) {
        view->m_pDocument = nullptr;
    }
    m_views.clear();
}

// --- name ---

void CDocument::SetTitle(LPCSTR title) {
    m_strTitle = title;
    UpdateFrameCounts();
}

void CDocument::SetPathName(LPCSTR path, BOOL addToRecent) {
    m_strPathName = fullPath(path);
    SetTitle(lastPart(m_strPathName));
    if (addToRecent && AfxGetApp()) {
        AfxGetApp()->AddToRecentFileList(m_strPathName);
    }
}

// --- views ---

void CDocument::AddView(CView* view) {
    m_views.push_back(view);
    view->m_pDocument = this;
    OnChangedViewList();
}

void CDocument::RemoveView(CView* view) {
    std::erase(m_views, view);
    view->m_pDocument = nullptr;
    OnChangedViewList(); // may delete this
}

void CDocument::OnChangedViewList() {
    if (m_views.empty() && m_bAutoDelete) {
        OnCloseDocument();
    } else {
        UpdateFrameCounts();
    }
}

POSITION CDocument::GetFirstViewPosition() const {
    return m_views.empty() ? nullptr : reinterpret_cast<POSITION>(std::uintptr_t{1});
}

CView* CDocument::GetNextView(POSITION& position) const {
    // A position is the view's number, counted from 1.
    const auto number = reinterpret_cast<std::uintptr_t>(position);
    position = number < m_views.size() ? reinterpret_cast<POSITION>(number + 1) : nullptr;
    return number >= 1 && number <= m_views.size() ? m_views[number - 1] : nullptr;
}

void CDocument::UpdateAllViews(CView* sender, LPARAM hint, CObject* object) {
    // A view's handler may end other views, which must not be told then.
    const auto views = m_views;
    for (CView* view : views) {
        if (view != sender && std::find(m_views.begin(), m_views.end(), view) != m_views.end()) {
            view->OnUpdate(sender, hint, object);
        }
    }
}

void CDocument::SendInitialUpdate() {
    const auto views = m_views;
    for (CView* view : views) {
        if (std::find(m_views.begin(), m_views.end(), view) != m_views.end()) {
            view->OnInitialUpdate();
        }
    }
}

std::vector<CFrameWnd*> CDocument::frames() const {
    std::vector<CFrameWnd*> all;
    for (const CView* view : m_views) {
        CFrameWnd* frame = view->m_hWnd ? view->GetParentFrame() : nullptr;
        if (frame && std::find(all.begin(), all.end(), frame) == all.end()) {
            all.push_back(frame);
        }
    }
    return all;
}

void CDocument::UpdateFrameCounts() {
    const auto all = frames();
    int number = 0;
    for (CFrameWnd* frame : all) {
        frame->m_nWindow = all.size() > 1 ? ++number : 0;
        frame->OnUpdateFrameTitle(TRUE);
    }
}

// --- life of the contents ---

void CDocument::DeleteContents() {}

BOOL CDocument::OnNewDocument() {
    DeleteContents();
    m_bModified = FALSE;
    m_strPathName.Empty();
    return TRUE;
}

namespace {

/// Runs the document's Serialize over a file. What it raises comes out of here, with the file as it is.
void serialize(CDocument& document, CFile& file, UINT mode) {
    CArchive archive(&file, mode | CArchive::bNoFlushOnDelete);
    archive.m_pDocument = &document;
    archive.m_strFileName = file.GetFilePath();
    try {
        document.Serialize(archive);
        archive.Close();
    } catch (...) {
        archive.Abort();
        throw;
    }
}

} // namespace

BOOL CDocument::OnOpenDocument(LPCSTR path) {
    CFileException error;
    CFile* file = GetFile(path, CFile::modeRead | CFile::shareDenyWrite, &error);
    if (!file) {
        ReportSaveLoadException(path, &error, FALSE, AFX_IDP_FAILED_TO_OPEN_DOC);
        return FALSE;
    }
    DeleteContents();
    SetModifiedFlag(); // so that a failure half-way is not taken for the old contents
    try {
        CWaitCursor wait;
        // An empty file is an empty document; Serialize would fail at its end.
        if (file->GetLength() != 0) {
            serialize(*this, *file, CArchive::load);
        }
    } catch (CException* problem) {
        ReleaseFile(file, TRUE);
        DeleteContents();
        ReportSaveLoadException(path, problem, FALSE, AFX_IDP_FAILED_TO_OPEN_DOC);
        problem->Delete();
        return FALSE;
    } catch (...) {
        ReleaseFile(file, TRUE);
        DeleteContents();
        throw;
    }
    ReleaseFile(file, FALSE);
    SetModifiedFlag(FALSE);
    return TRUE;
}

BOOL CDocument::OnSaveDocument(LPCSTR path) {
    CFileException error;
    CFile* file = GetFile(path, CFile::modeCreate | CFile::modeReadWrite | CFile::shareExclusive, &error);
    if (!file) {
        ReportSaveLoadException(path, &error, TRUE, AFX_IDP_INVALID_FILENAME);
        return FALSE;
    }
    try {
        CWaitCursor wait;
        serialize(*this, *file, CArchive::store);
        file->Close(); // here errors of the last writing appear, while the file can still be given up
    } catch (CException* problem) {
        ReleaseFile(file, TRUE);
        ReportSaveLoadException(path, problem, TRUE, AFX_IDP_FAILED_TO_SAVE_DOC);
        problem->Delete();
        return FALSE;
    } catch (...) {
        ReleaseFile(file, TRUE);
        throw;
    }
    ReleaseFile(file, FALSE);
    SetModifiedFlag(FALSE);
    return TRUE;
}

void CDocument::OnCloseDocument() {
    const BOOL autoDelete = std::exchange(m_bAutoDelete, FALSE); // the last view's end must not delete it meanwhile
    while (!m_views.empty()) {
        CView* view = m_views.front();
        CFrameWnd* frame = view->m_hWnd ? view->GetParentFrame() : nullptr;
        if (frame) {
            PreCloseFrame(frame);
            frame->DestroyWindow();
        }
        // A frame that keeps living, or a view without one, must not hold the loop up.
        if (!m_views.empty() && m_views.front() == view) {
            RemoveView(view);
        }
    }
    m_bAutoDelete = autoDelete;
    DeleteContents();
    if (m_bAutoDelete) {
        delete this;
    }
}

namespace {

UINT messageOf(const CFileException& error, BOOL saving) {
    if (error.m_lOsError == EISDIR) {
        return TVX_IDS_IS_FOLDER;
    }
    if (error.m_lOsError == ESPIPE) {
        return TVX_IDS_IS_PIPE;
    }
    switch (error.m_cause) {
    case CFileException::fileNotFound:
    case CFileException::badPath:
        return AFX_IDP_FAILED_INVALID_PATH;
    case CFileException::diskFull:
        return AFX_IDP_FAILED_DISK_FULL;
    case CFileException::accessDenied:
    case CFileException::sharingViolation:
    case CFileException::lockViolation:
        return saving ? AFX_IDP_FAILED_ACCESS_WRITE : AFX_IDP_FAILED_ACCESS_READ;
    case CFileException::hardIO:
    case CFileException::badSeek:
        return saving ? AFX_IDP_FAILED_IO_ERROR_WRITE : AFX_IDP_FAILED_IO_ERROR_READ;
    default:
        return 0;
    }
}

UINT messageOf(const CException& error, BOOL saving) {
    if (const auto* file = dynamic_cast<const CFileException*>(&error)) {
        return messageOf(*file, saving);
    }
    return dynamic_cast<const CArchiveException*>(&error) ? AFX_IDP_FAILED_INVALID_FORMAT : 0;
}

} // namespace

void CDocument::ReportSaveLoadException(LPCSTR path, CException* error, BOOL saving, UINT fallback) {
    if (error && error->IsKindOf(RUNTIME_CLASS(CUserException))) {
        return; // the user knows already
    }
    const UINT id = error ? messageOf(*error, saving) : 0;
    const std::string name = tvx::shownName(path ? path : "");
    CString text;
    char description[512] = "";
    if (id != 0) {
        AfxFormatString1(text, id, name.c_str());
    } else if (error && error->GetErrorMessage(description, sizeof(description))) {
        text = description;
    } else {
        AfxFormatString1(text, fallback, name.c_str());
    }
    AfxMessageBox(text, MB_OK | MB_ICONEXCLAMATION, id != 0 ? id : fallback);
}

// --- closing and saving ---

BOOL CDocument::CanCloseFrame(CFrameWnd* frame) {
    for (const CFrameWnd* other : frames()) {
        if (other != frame) {
            return TRUE;
        }
    }
    return SaveModified();
}

void CDocument::PreCloseFrame(CFrameWnd*) {}

void CDocument::OnIdle() {}

BOOL CDocument::SaveModified() {
    if (!IsModified()) {
        return TRUE;
    }
    CString name = m_strPathName.IsEmpty() ? m_strTitle : lastPart(m_strPathName);
    if (name.IsEmpty()) {
        name.LoadString(AFX_IDS_UNTITLED);
    }
    CString question;
    AfxFormatString1(question, AFX_IDP_ASK_TO_SAVE, name);
    switch (AfxMessageBox(question, MB_YESNOCANCEL | MB_ICONEXCLAMATION, AFX_IDP_ASK_TO_SAVE)) {
    case IDYES:
        return DoFileSave();
    case IDNO:
        return TRUE;
    default:
        return FALSE;
    }
}

BOOL CDocument::DoFileSave() {
    CFileStatus status;
    const bool writable = CFile::GetStatus(m_strPathName, status) && (status.m_attribute & CFile::readOnly) == 0;
    return DoSave(writable ? m_strPathName.GetString() : nullptr);
}

bool CDocument::askForPath(CString& path, BOOL replace) {
    CDocTemplate* docTemplate = GetDocTemplate();
    path = m_strPathName;
    if (path.IsEmpty() && replace) {
        path = m_strTitle;
        // A title may hold what a file's name cannot: it is offered up to there.
        const int unfit = path.FindOneOf("#%;/\\:*?\"<>|");
        if (unfit >= 0) {
            path = path.Left(unfit);
        }
        CString extension;
        if (docTemplate && docTemplate->GetDocString(extension, CDocTemplate::filterExt)) {
            path += extension;
        }
    }
    CWinApp* app = AfxGetApp();
    return app && app->DoPromptFileName(path, replace ? AFX_IDS_SAVEFILE : AFX_IDS_SAVEFILECOPY,
                                        OFN_HIDEREADONLY | OFN_PATHMUSTEXIST, FALSE, docTemplate);
}

BOOL CDocument::DoSave(LPCSTR path, BOOL replace) {
    CString name(path ? path : "");
    if (name.IsEmpty() && !askForPath(name, replace)) {
        return FALSE;
    }
    if (!OnSaveDocument(name)) {
        return FALSE;
    }
    if (replace) {
        SetPathName(name);
    }
    return TRUE;
}

// --- commands ---

BOOL CDocument::OnCmdMsg(UINT id, int code, void* extra, AFX_CMDHANDLERINFO* info) {
    if (CCmdTarget::OnCmdMsg(id, code, extra, info)) {
        return TRUE;
    }
    return m_pDocTemplate ? m_pDocTemplate->OnCmdMsg(id, code, extra, info) : FALSE;
}

void CDocument::OnFileSave() {
    DoFileSave();
}

void CDocument::OnFileSaveAs() {
    DoSave(nullptr);
}

void CDocument::OnFileClose() {
    if (SaveModified()) {
        OnCloseDocument();
    }
}
