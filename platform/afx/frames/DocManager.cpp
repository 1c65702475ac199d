#include "platform/afx/frames/DocManager.h"

#include "platform/afx/core/App.h"
#include "platform/afx/core/detail/Paths.h"
#include "platform/afx/dialogs/FileDialog.h"
#include "platform/afx/frames/Document.h"
#include "platform/afx/frames/View.h"
#include "platform/afx/frames/detail/ChooseTemplate.h"

using namespace tvx::afx;

IMPLEMENT_DYNCREATE(CDocManager, CObject)

CDocManager::~CDocManager() {
    for (CDocTemplate* docTemplate : m_templates) {
        if (docTemplate->m_bAutoDelete) {
            delete docTemplate;
        }
    }
}

void CDocManager::AddDocTemplate(CDocTemplate* docTemplate) {
    if (!docTemplate || std::find(m_templates.begin(), m_templates.end(), docTemplate) != m_templates.end()) {
        return;
    }
    docTemplate->LoadTemplate();
    m_templates.push_back(docTemplate);
}

POSITION CDocManager::GetFirstDocTemplatePosition() const {
    return m_templates.empty() ? nullptr : reinterpret_cast<POSITION>(std::uintptr_t{1});
}

CDocTemplate* CDocManager::GetNextDocTemplate(POSITION& position) const {
    // A position is the template's number, counted from 1.
    const auto number = reinterpret_cast<std::uintptr_t>(position);
    position = number < m_templates.size() ? reinterpret_cast<POSITION>(number + 1) : nullptr;
    return number >= 1 && number <= m_templates.size() ? m_templates[number - 1] : nullptr;
}

// --- commands ---

CDocTemplate* CDocManager::chooseTemplate() const {
    std::vector<CDocTemplate*> offered;
    std::vector<CString> names;
    for (CDocTemplate* docTemplate : m_templates) {
        CString name;
        if (docTemplate->GetDocString(name, CDocTemplate::fileNewName) && !name.IsEmpty()) {
            offered.push_back(docTemplate);
            names.push_back(name);
        }
    }
    if (offered.size() < 2) {
        return offered.empty() ? m_templates.front() : offered.front();
    }
    const int chosen = chooseName(names);
    return chosen >= 0 ? offered[static_cast<std::size_t>(chosen)] : nullptr;
}

void CDocManager::OnFileNew() {
    if (m_templates.empty()) {
        AfxMessageBox(AFX_IDP_FAILED_TO_CREATE_DOC);
        return;
    }
    if (CDocTemplate* docTemplate = chooseTemplate()) {
        docTemplate->OpenDocumentFile(nullptr);
    }
}

void CDocManager::OnFileOpen() {
    CString name;
    if (DoPromptFileName(name, AFX_IDS_OPENFILE, OFN_HIDEREADONLY | OFN_FILEMUSTEXIST, TRUE, nullptr)) {
        CWinApp* app = AfxGetApp();
        if (app) {
            app->OpenDocumentFile(name);
        }
    }
}

namespace {

void addFilter(CString& filters, const CDocTemplate& docTemplate, CString& defaultExtension) {
    CString name;
    CString extension;
    if (!docTemplate.GetDocString(extension, CDocTemplate::filterExt) || extension.IsEmpty() ||
        !docTemplate.GetDocString(name, CDocTemplate::filterName) || name.IsEmpty()) {
        return;
    }
    if (defaultExtension.IsEmpty()) {
        defaultExtension = extension.Mid(1);
    }
    filters += name + "|*" + extension + "|";
}

} // namespace

BOOL CDocManager::DoPromptFileName(CString& fileName, UINT titleId, DWORD flags, BOOL openDialog,
                                   CDocTemplate* docTemplate) {
    CString filters;
    CString defaultExtension;
    if (docTemplate) {
        addFilter(filters, *docTemplate, defaultExtension);
    } else {
        for (const CDocTemplate* each : m_templates) {
            addFilter(filters, *each, defaultExtension);
        }
    }
    CString allFiles;
    allFiles.LoadString(AFX_IDS_ALLFILTER);
    filters += allFiles + "|*.*||";
    CString title;
    title.LoadString(titleId);

    CFileDialog dialog(openDialog, nullptr, fileName, flags | OFN_OVERWRITEPROMPT, filters);
    dialog.m_ofn.lpstrTitle = title;
    dialog.m_ofn.lpstrDefExt = defaultExtension.IsEmpty() ? nullptr : defaultExtension.GetString();
    dialog.m_ofn.nFilterIndex = 1;
    if (dialog.DoModal() != IDOK) {
        return FALSE;
    }
    fileName = dialog.GetPathName();
    return TRUE;
}

CDocTemplate* CDocManager::bestTemplate(LPCSTR fileName, CDocument*& open) const {
    CDocTemplate* best = nullptr;
    auto bestMatch = CDocTemplate::noAttempt;
    for (CDocTemplate* docTemplate : m_templates) {
        CDocument* match = nullptr;
        const auto confidence = docTemplate->MatchDocType(fileName, match);
        if (confidence > bestMatch) {
            bestMatch = confidence;
            best = docTemplate;
            open = match;
        }
        if (confidence == CDocTemplate::yesAlreadyOpen) {
            break;
        }
    }
    return best;
}

namespace {

void activate(const CDocument& document) {
    POSITION at = document.GetFirstViewPosition();
    const CView* view = at ? document.GetNextView(at) : nullptr;
    CFrameWnd* frame = view ? view->GetParentFrame() : nullptr;
    if (!frame) {
        return;
    }
    frame->ActivateFrame();
    // The main window, or one beside it.
    if (CFrameWnd* top = frame->GetTopLevelFrame()) {
        top->ActivateFrame();
        top->SetForegroundWindow();
    }
}

} // namespace

CDocument* CDocManager::OpenDocumentFile(LPCSTR fileName) {
    CString name(fileName);
    name.Trim();
    // Names that come from other programs may stand in quotation marks.
    if (name.GetLength() > 1 && name[0] == '"' && name[name.GetLength() - 1] == '"') {
        name = name.Mid(1, name.GetLength() - 2);
    }
    const CString path = fullPath(name);
    CDocument* open = nullptr;
    CDocTemplate* docTemplate = bestTemplate(path, open);
    if (open) {
        activate(*open);
        return open;
    }
    if (!docTemplate) {
        AfxMessageBox(AFX_IDP_FAILED_TO_OPEN_DOC);
        return nullptr;
    }
    return docTemplate->OpenDocumentFile(path);
}

BOOL CDocManager::SaveAllModified() {
    for (CDocTemplate* docTemplate : m_templates) {
        if (!docTemplate->SaveAllModified()) {
            return FALSE;
        }
    }
    return TRUE;
}

void CDocManager::CloseAllDocuments(BOOL endSession) {
    for (CDocTemplate* docTemplate : m_templates) {
        docTemplate->CloseAllDocuments(endSession);
    }
}

int CDocManager::GetOpenDocumentCount() {
    int count = 0;
    for (const CDocTemplate* docTemplate : m_templates) {
        for (POSITION at = docTemplate->GetFirstDocPosition(); at; docTemplate->GetNextDoc(at)) {
            ++count;
        }
    }
    return count;
}
