#include "FamilyPages.h"

#include "FamilyResource.h"
#include "Preferences.h"
#include "platform/port/Env.h"
#include "platform/port/Version.h"
#include "res/resource.h"
#include "s/DirDlg.h"
#include "s/FileName.h"
#include "s/Help.h"
#include "s/Msg.h"
#include "s/WinApp.h"
#include "shlwapi.h"

// --- files and folders ---

// clang-format off
BEGIN_MESSAGE_MAP(CFilesPage, CPreferencePage)
    ON_BN_CLICKED(IDC_PREF_BROWSE, &CFilesPage::OnBrowse)
END_MESSAGE_MAP()
// clang-format on

CFilesPage::CFilesPage(CPreferences& sheet) : CPreferencePage(IDD_PREF_FILES, sheet) {}

BOOL CFilesPage::OnInitDialog() {
    const BOOL result = CPreferencePage::OnInitDialog();
    SHAutoComplete(GetDlgItem(IDC_PREF_FOLDER)->GetSafeHwnd(), SHACF_FILESYS_DIRS);
    return result;
}

void CFilesPage::DoDataExchange(CDataExchange* dx) {
    CPreferencePage::DoDataExchange(dx);
    CString& kept = GetPreferences().GetFamilyOptions().documentFolder;
    CString folder = kept;
    DDX_Text(dx, IDC_PREF_FOLDER, folder);
    if (dx->m_bSaveAndValidate) {
        folder.Trim();
        const Gui_FileName name(folder);
        // One that has gone since it was chosen keeps nobody from choosing other things.
        if (!folder.IsEmpty() && folder != kept && !(name.HasAbsolutePath() && name.IsDirectory())) {
            Gui_Msg message(IDS_PREF_NO_FOLDER);
            message << folder;
            AfxMessageBox(message, MB_OK | MB_ICONEXCLAMATION);
            dx->PrepareEditCtrl(IDC_PREF_FOLDER);
            dx->Fail();
        }
    }
    kept = folder;
}

void CFilesPage::SetDefaults() {
    GetPreferences().GetFamilyOptions().documentFolder = FamilyOptions().documentFolder;
}

void CFilesPage::OnBrowse() {
    CString folder;
    CString title;
    GetDlgItemText(IDC_PREF_FOLDER, folder);
    title.LoadString(IDS_PREF_FOLDER_TITLE);
    Gui_DirDlg dialog(folder.IsEmpty() ? nullptr : folder.GetString(), title, GUI_IDD_DIRECTORY, this, 1, 1, 0);
    if (dialog.DoModal() == IDOK) {
        SetDlgItemText(IDC_PREF_FOLDER, dialog.GetPathName(0));
        SetChanged();
    }
}

// --- keyboard ---

// clang-format off
BEGIN_MESSAGE_MAP(CKeyboardPage, CPreferencePage)
    ON_BN_CLICKED(IDC_PREF_EDIT_KEYS, &CKeyboardPage::OnEditKeys)
    ON_BN_CLICKED(IDC_PREF_RESET_KEYS, &CKeyboardPage::OnResetKeys)
END_MESSAGE_MAP()
// clang-format on

CKeyboardPage::CKeyboardPage(CPreferences& sheet) : CPreferencePage(IDD_PREF_KEYBOARD, sheet) {}

void CKeyboardPage::DoDataExchange(CDataExchange* dx) {
    CPreferencePage::DoDataExchange(dx);
    if (dx->m_bSaveAndValidate) {
        return;
    }
    const int count = GetPreferences().CountOwnKeys();
    Gui_Msg text(count == 0 ? IDS_PREF_NO_OWN_KEYS : IDS_PREF_OWN_KEYS);
    text << count;
    SetDlgItemText(IDC_PREF_KEYS, text.GetValue());
    GetDlgItem(IDC_PREF_RESET_KEYS)->EnableWindow(count != 0);
}

void CKeyboardPage::OnEditKeys() {
    GetPreferences().EditKeys();
    Show();
}

void CKeyboardPage::OnResetKeys() {
    if (AfxMessageBox(IDS_PREF_RESET_KEYS, MB_OKCANCEL | MB_ICONEXCLAMATION) == IDOK) {
        GetPreferences().ResetKeys();
        GotoDlgCtrl(GetDlgItem(IDC_PREF_EDIT_KEYS)); // the button that had the keyboard goes grey
        Show();
    }
}

// --- help ---

namespace {

/// Names of pages are appended to the location as they are.
CString asFolder(CString location) {
    location.Trim();
    const bool isOpen = !location.IsEmpty() && location[location.GetLength() - 1] != '/';
    return isOpen ? location + "/" : location;
}

} // namespace

CHelpPage::CHelpPage(CPreferences& sheet) : CPreferencePage(IDD_PREF_HELP, sheet) {}

/// What the environment decides cannot be chosen; the page says why.
BOOL CHelpPage::OnInitDialog() {
    const BOOL result = CPreferencePage::OnInitDialog();
    const struct {
        const char* variable;
        UINT control;
    } fixed[] = {{"TVX_GUI_HELP_ALWAYS_TO_WEB", IDC_PREF_ALWAYS_WEB},
                 {"TVX_GUI_HELP_WEB_LOCATION", IDC_PREF_WEB_LOCATION}};
    CString note;
    GetDlgItemText(IDC_PREF_WEB_NOTE, note);
    for (const auto& [variable, control] : fixed) {
        if (Port_Env::GetEnv(variable)) {
            GetDlgItem(control)->EnableWindow(FALSE);
            Gui_Msg text(IDS_PREF_ENVIRONMENT);
            text << variable;
            note += CString("\n") + text.GetValue();
        }
    }
    SetDlgItemText(IDC_PREF_WEB_NOTE, note);
    return result;
}

void CHelpPage::DoDataExchange(CDataExchange* dx) {
    CPreferencePage::DoDataExchange(dx);
    FamilyOptions& options = GetPreferences().GetFamilyOptions();
    DDX_Check(dx, IDC_PREF_ALWAYS_WEB, options.alwaysOnWeb);
    CString location = options.webLocation;
    DDX_Text(dx, IDC_PREF_WEB_LOCATION, location);
    if (GetDlgItem(IDC_PREF_WEB_LOCATION)->IsWindowEnabled()) {
        options.webLocation = asFolder(location);
    }
}

void CHelpPage::SetDefaults() {
    FamilyOptions& options = GetPreferences().GetFamilyOptions();
    if (GetDlgItem(IDC_PREF_ALWAYS_WEB)->IsWindowEnabled()) {
        options.alwaysOnWeb = FamilyOptions().alwaysOnWeb;
    }
    if (GetDlgItem(IDC_PREF_WEB_LOCATION)->IsWindowEnabled()) {
        options.webLocation = FamilyOptions().webLocation;
    }
}

// --- the installation ---

// clang-format off
BEGIN_MESSAGE_MAP(CInstallationPage, CPreferencePage)
    ON_BN_CLICKED(IDC_PREF_COPY, &CInstallationPage::OnCopy)
END_MESSAGE_MAP()
// clang-format on

CInstallationPage::CInstallationPage(CPreferences& sheet) : CPreferencePage(IDD_PREF_INSTALLATION, sheet) {
    CString none;
    none.LoadString(IDS_PREF_NOT_KNOWN);
    const auto known = [&none](const char* text) { return text && *text ? CString(text) : none; };
    auto* const app = static_cast<Gui_WinApp*>(AfxGetApp());
    Gui_Msg facts(IDS_PREF_FACTS);
    facts << app->m_pszAppName << app->GetAppVersion() << known(Port::Version::getValue("version").c_str())
          << known(Port_Env::GetEnv("TARVEX")) << known(Port_Env::GetEnv("MYTARVEX"))
          << known(Port_Env::GetEnv("LANG"));
    m_facts = facts.GetValue();
}

void CInstallationPage::DoDataExchange(CDataExchange* dx) {
    CPreferencePage::DoDataExchange(dx);
    if (!dx->m_bSaveAndValidate) {
        SetDlgItemText(IDC_PREF_FACTS, m_facts);
    }
}

void CInstallationPage::OnCopy() {
    auto* const field = static_cast<CEdit*>(GetDlgItem(IDC_PREF_FACTS));
    field->SetSel(0, -1);
    field->Copy();
}

// --- pages that were written for a sheet with tabs ---

void OnTabPage(Gui_PropItem* item, CWnd* page, Gui_PropItem::Notification what) {
    auto* const tab = static_cast<CPropertyPage*>(page);
    auto* const sheet = static_cast<CPreferences*>(item->GetPropSheet());
    if (!tab) {
        return;
    }
    switch (what) {
    case Gui_PropItem::NotifyActivate:
    case Gui_PropItem::NotifyReactivate:
        tab->OnSetActive();
        break;
    case Gui_PropItem::NotifyDeactivate:
        tab->OnKillActive();
        sheet->MarkBrowser();
        break;
    case Gui_PropItem::NotifyApply:
        if (!tab->OnKillActive()) {
            sheet->DontClose();
        } else {
            sheet->Store();
        }
        break;
    case Gui_PropItem::NotifyHelp:
        Gui_Help::OnDialog(GUI_IDD_BROWSER);
        break;
    case Gui_PropItem::NotifyFocusFirst:
    case Gui_PropItem::NotifyFocusLast:
        sheet->FocusPage(*tab, what == Gui_PropItem::NotifyFocusLast);
        break;
    }
}
