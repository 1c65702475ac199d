#include "s/BrowserPref.h"

#include "res/resource.h"
#include "s/CommandText.h"
#include "s/Profile.h"
#include "s/Record.h"

#include <string>

struct Gui_BrowserPref::Record {
    CString command;
    CEdit commandField;
};

// clang-format off
BEGIN_MESSAGE_MAP(Gui_BrowserPref, CPropertyPage)
    ON_BN_CLICKED(GUI_IDC_BROWSER_BROWSE, &Gui_BrowserPref::OnBrowse)
    ON_BN_CLICKED(GUI_IDC_BROWSER_SHOW_DEFAULT, &Gui_BrowserPref::OnShowDefault)
    ON_EN_CHANGE(GUI_IDC_BROWSER_COMMAND, &Gui_BrowserPref::OnChangeCommand)
END_MESSAGE_MAP()
// clang-format on

Gui_BrowserPref::Gui_BrowserPref() : CPropertyPage(GUI_IDD_BROWSER), m_record(MakeRecord<Record>()) {
    Gui_Profile::ReadWebBrowserName(m_record->command);
}

Gui_BrowserPref::~Gui_BrowserPref() = default;

void Gui_BrowserPref::DoDataExchange(CDataExchange* dx) {
    CPropertyPage::DoDataExchange(dx);
    DDX_Control(dx, GUI_IDC_BROWSER_COMMAND, m_record->commandField);
    DDX_Text(dx, GUI_IDC_BROWSER_COMMAND, m_record->command);
}

void Gui_BrowserPref::OnOK() {
    CString current;
    Gui_Profile::ReadWebBrowserName(current);
    if (current != m_record->command) {
        Gui_Profile::WriteWebBrowserName(m_record->command);
    }
    CPropertyPage::OnOK();
}

namespace {

CString currentFolder() {
    std::string folder(GetCurrentDirectoryA(0, nullptr), '\0');
    GetCurrentDirectoryA(static_cast<DWORD>(folder.size()), folder.data());
    return folder.c_str();
}

} // namespace

void Gui_BrowserPref::OnBrowse() {
    CFileDialog dialog(TRUE, "*.*", nullptr, OFN_HIDEREADONLY | OFN_FILEMUSTEXIST, nullptr, this);
    const CString folder = currentFolder();
    dialog.m_ofn.lpstrInitialDir = folder;
    if (dialog.DoModal() != IDOK) {
        return;
    }
    CString command;
    m_record->commandField.GetWindowText(command);
    m_record->commandField.SetWindowText(WithProgram(command, dialog.GetPathName()));
}

void Gui_BrowserPref::OnShowDefault() {
    CString command;
    Gui_Profile::GetDefaultWebBrowserName(command);
    m_record->commandField.SetWindowText(command);
}

void Gui_BrowserPref::OnChangeCommand() {
    SetModified();
}
