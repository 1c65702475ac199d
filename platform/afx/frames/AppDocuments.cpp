#include "platform/afx/core/App.h"
#include "platform/afx/frames/DocManager.h"
#include "platform/afx/frames/Document.h"

// The application object's dealings with documents: its document manager does the work.

void CWinApp::AddDocTemplate(CDocTemplate* docTemplate) {
    if (!m_pDocManager) {
        m_pDocManager = new CDocManager;
    }
    m_pDocManager->AddDocTemplate(docTemplate);
}

void CWinApp::DeleteDocManager() {
    delete m_pDocManager;
    m_pDocManager = nullptr;
}

POSITION CWinApp::GetFirstDocTemplatePosition() const {
    return m_pDocManager ? m_pDocManager->GetFirstDocTemplatePosition() : nullptr;
}

CDocTemplate* CWinApp::GetNextDocTemplate(POSITION& position) const {
    return m_pDocManager ? m_pDocManager->GetNextDocTemplate(position) : nullptr;
}

CDocument* CWinApp::OpenDocumentFile(LPCSTR fileName) {
    return m_pDocManager ? m_pDocManager->OpenDocumentFile(fileName) : nullptr;
}

BOOL CWinApp::SaveAllModified() {
    return !m_pDocManager || m_pDocManager->SaveAllModified() ? TRUE : FALSE;
}

void CWinApp::CloseAllDocuments(BOOL endSession) {
    if (m_pDocManager) {
        m_pDocManager->CloseAllDocuments(endSession);
    }
}

int CWinApp::GetOpenDocumentCount() {
    return m_pDocManager ? m_pDocManager->GetOpenDocumentCount() : 0;
}

BOOL CWinApp::DoPromptFileName(CString& fileName, UINT titleId, DWORD flags, BOOL openDialog,
                               CDocTemplate* docTemplate) {
    return m_pDocManager ? m_pDocManager->DoPromptFileName(fileName, titleId, flags, openDialog, docTemplate) : FALSE;
}

void CWinApp::OnFileNew() {
    if (m_pDocManager) {
        m_pDocManager->OnFileNew();
    }
}

void CWinApp::OnFileOpen() {
    if (m_pDocManager) {
        m_pDocManager->OnFileOpen();
    }
}

BOOL CWinApp::ProcessShellCommand(CCommandLineInfo& info) {
    switch (info.m_nShellCommand) {
    case CCommandLineInfo::FileNew: {
        // By the command's own road, so that a host's handler of it is the one that acts.
        const bool handled = OnCmdMsg(ID_FILE_NEW, CN_COMMAND, nullptr, nullptr) != FALSE;
        if (!handled) {
            OnFileNew();
        }
        return m_pMainWnd ? TRUE : FALSE;
    }
    case CCommandLineInfo::FileOpen:
        return OpenDocumentFile(info.m_strFileName) ? TRUE : FALSE;
    case CCommandLineInfo::FileNothing:
    case CCommandLineInfo::FileDDE:
        return TRUE;
    default:
        return FALSE; // printing and entries in the desktop end the application
    }
}
