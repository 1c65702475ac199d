#include "s/WinApp.h"

#include "platform/port/Env.h"
#include "platform/win/Locale.h"
#include "res/resource.h"
#include "s/AboutDlg.h"
#include "s/FileName.h"
#include "s/HelpDocument.h"
#include "s/Msg.h"
#include "s/Process.h"
#include "s/WebHosts.h"
#include "s/WinAppData.h"

// Help requests and the commands of the Help menu.

// clang-format off
BEGIN_MESSAGE_MAP(Gui_WinApp, CWinApp)
    ON_COMMAND(GUI_ID_HELP_MANUALS, &Gui_WinApp::OnCommonHelpOnlineDocuments)
    ON_COMMAND(GUI_ID_HELP_SUPPORT, &Gui_WinApp::OnCommonHelpSupportServices)
    ON_COMMAND(GUI_ID_HELP_ABOUT, &Gui_WinApp::OnHelpAbout)
END_MESSAGE_MAP()
// clang-format on

namespace {

/// The language of the family's web pages for a user's.
const char* webLanguage(LCID locale) {
    switch (PRIMARYLANGID(LANGIDFROMLCID(locale))) {
    case LANG_JAPANESE:
        return "jp";
    case LANG_KOREAN:
        return "kr";
    case LANG_CHINESE:
        break;
    default:
        return "en";
    }
    switch (SUBLANGID(LANGIDFROMLCID(locale))) {
    case SUBLANG_CHINESE_TRADITIONAL:
        return "tw";
    case SUBLANG_CHINESE_SIMPLIFIED:
        return "cn";
    default:
        return "en";
    }
}

} // namespace

void Gui_WinApp::WinHelpA(DWORD_PTR data, UINT command) {
    const CString helpFile = m_pszHelpFilePath;
    if (helpFile.Right(4).CompareNoCase(".map") == 0) {
        m_data->help.SetHelpMapFileName(helpFile);
        m_data->help.BrowserHelp(data, command);
    } else if (data == mainFrameHelpContext) {
        CWinApp::WinHelpA(0, HELP_CONTENTS);
    } else {
        CWinApp::WinHelpA(data, command);
    }
}

void Gui_WinApp::WinHelpInternal(DWORD_PTR data, UINT command) {
    WinHelpA(data, command);
}

CString Gui_WinApp::GetRedirectUrl() {
    CString url = RedirectHost().c_str();
    url += "/cgi-bin/SW_Docs_Redirect/sw_docs_redirect?locale=";
    return url + webLanguage(GetUserDefaultLCID());
}

void Gui_WinApp::OnCommonHelpOnlineDocuments() {
    const CWaitCursor wait;
    const char* const installed = Port_Env::GetDocFileName("manuals", 0);
    if (!installed) {
        // A viewer would only say that there is no such file.
        Gui_Msg missing(GUI_IDS_HELP_NOT_FOUND);
        missing << "manuals" << " ";
        AfxMessageBox(missing);
        return;
    }
    ShowInPDFViewer(Gui_FileName(installed).GetFullName());
}

void Gui_WinApp::OnCommonHelpSupportServices() {
    Gui_Process browser;
    browser.RunWebBrowser(GetRedirectUrl() + "&topic=support", nullptr, 1, documentTimeout);
}

void Gui_WinApp::OnHelpAbout() {
    Gui_AboutDlg about(nullptr);
    about.DoModal();
}
