#include "platform/afx/core/App.h"
#include "platform/afx/frames/RecentFileList.h"
#include "platform/win/Files.h"
#include "platform/win/FrameworkIds.h"

// The application object's list of recent files.

void CWinApp::LoadStdProfileSettings(UINT count) {
    if (count > 0 && !m_pRecentFileList) {
        constexpr UINT most = ID_FILE_MRU_LAST - ID_FILE_MRU_FIRST + 1;
        m_pRecentFileList =
            new CRecentFileList(0, "Recent File List", "File%d", static_cast<int>(count < most ? count : most));
    }
}

void CWinApp::SaveStdProfileSettings() {
    if (m_pRecentFileList) {
        m_pRecentFileList->WriteList();
    }
}

void CWinApp::DeleteRecentFileList() {
    delete m_pRecentFileList;
    m_pRecentFileList = nullptr;
}

void CWinApp::AddToRecentFileList(LPCSTR path) {
    if (m_pRecentFileList) {
        m_pRecentFileList->Add(path);
    }
}

CString CWinApp::GetAbbreviatedFileName(LPCSTR path, int, BOOL) {
    return path;
}

void CWinApp::OnUpdateRecentFileMenu(CCmdUI* item) {
    if (m_pRecentFileList) {
        m_pRecentFileList->UpdateMenu(item);
    } else {
        item->Enable(FALSE);
    }
}

BOOL CWinApp::OnOpenRecentFile(UINT id) {
    const int index = static_cast<int>(id - ID_FILE_MRU_FIRST);
    if (!m_pRecentFileList || index >= m_pRecentFileList->GetSize()) {
        return FALSE;
    }
    const CString path = (*m_pRecentFileList)[index];
    // A file that is there but was not opened, because it is damaged or the user thought better of it, stays.
    if (!path.IsEmpty() && !OpenDocumentFile(path) && tvx::fileKind(path) == tvx::FileKind::None) {
        m_pRecentFileList->Remove(index);
    }
    return TRUE;
}
