// New Folder of the directory dialog.
#include "platform/win/Error.h"
#include "res/resource.h"
#include "s/DirDlgRecord.h"
#include "s/Msg.h"
#include "s/QueryDlg.h"
#include "s/StringOf.h"

namespace {

constexpr int nameWidth = 30; // characters

} // namespace

void Gui_DirDlg::OnNewFolder() {
    // The name is free as far as the tree tells; what else there is the system knows.
    const CString plain = StringOf(GUI_IDS_FOLDER_NEW);
    CString name = plain;
    const auto isTaken = [this](const CString& wanted) {
        for (HTREEITEM item = tree().GetChildItem(m_record->current); item; item = tree().GetNextSiblingItem(item)) {
            if (tree().GetItemText(item).CompareNoCase(wanted) == 0) {
                return true;
            }
        }
        return false;
    };
    for (int number = 2; isTaken(name); ++number) {
        name.Format("%s (%d)", plain.GetString(), number);
    }
    askForFolder(name);
}

void Gui_DirDlg::askForFolder(const CString& name) {
    // An answer to OK must not end the dialog under the query.
    m_record->verdict = {};
    showState();
    Gui_QueryDlg query(this);
    query.SetTitle(StringOf(GUI_IDS_FOLDER_NEW));
    query.SetPrompt(StringOf(GUI_IDS_FOLDER_PROMPT));
    query.SetAnswer(name);
    query.SetAnswerFieldWidth(nameWidth);
    if (query.DoModal() != IDOK) {
        return;
    }
    CString answer = query.GetAnswer();
    if (!answer.Trim().IsEmpty()) {
        createFolder(answer);
    }
}

void Gui_DirDlg::createFolder(const CString& name) {
    m_record->newFolder = name;
    m_record->creation = tvx::Question<DWORD>([folder = m_record->directory.GetMountAndPath(1) + name] {
        return CreateDirectoryA(folder, nullptr) ? ERROR_SUCCESS : GetLastError();
    });
    if (m_record->isAnswered(m_record->creation, Record::created)) {
        finishCreation();
    } else {
        showState();
    }
}

void Gui_DirDlg::finishCreation() {
    const DWORD error = m_record->creation.answer();
    m_record->creation = {};
    m_record->verdict = {};
    showState();
    const CString name = m_record->newFolder;
    if (error == ERROR_SUCCESS) {
        m_record->toSelect = name;
        if (name[0] == '.') {
            CheckDlgButton(GUI_IDC_DIR_HIDDEN, BST_CHECKED);
        }
        fillTree();
        return;
    }
    Gui_Msg message(GUI_IDS_FOLDER_FAILED);
    message << name << tvx::errorText(error).c_str();
    MessageBox(message, AfxGetAppName(), MB_OK | MB_ICONEXCLAMATION);
    askForFolder(name);
}

LRESULT Gui_DirDlg::OnCreated(WPARAM, LPARAM) {
    if (m_record->creation.isAnswered()) {
        finishCreation();
    }
    return 0;
}
