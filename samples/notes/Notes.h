#pragma once

#include "Keyboard.h"
#include "s/CommandLineInfo.h"
#include "s/MessageManager.h"
#include "s/SplashDlg.h"
#include "s/WinApp.h"

#include <memory>

/// The command line of Notes: the switches of the family, one instance only, and a text.
class CNotesCommandLine : public Gui_CommandLineInfo {
public:
    void ParseParam(const char* param, BOOL isSwitch, BOOL isLast) override;
    CString GetCmdOpcodes() const override;
    CString GetUsageText() const override;

    /// Whether a Notes that runs already is to be shown instead of this one.
    bool m_single = false;
};

/// The application object of Notes, which shows one text at a time.
class CNotesApp : public Gui_WinApp {
public:
    CNotesApp();
    BOOL InitInstance() override;
    int ExitInstance() override;
    HICON GetAppIcon() override;
    CString GetAppVersion() override;
    CString GetInitialDirForFileDialog(const CString& fileName) override;

    BOOL PreTranslateMessage(MSG* message) override;
    BOOL OnIdle(LONG count) override;

    CKeyboard& GetKeyboard() {
        return *m_keyboard;
    }

    afx_msg void OnToolsKeyboard();
    afx_msg void OnToolsPreferences();
    afx_msg void OnToolsWebBrowser();

private:
    BOOL ShowMainFrame(CNotesCommandLine& info);

    /// Whether this is to be the only Notes.
    bool m_single = false;
    /// Shows errors in message boxes, those of handlers that have failed among them.
    Gui_MessageManager m_messages;
    /// Shown while the application starts, null afterwards.
    std::unique_ptr<Gui_SplashDlg> m_splash;
    /// Made with the main window.
    std::unique_ptr<CKeyboard> m_keyboard;

    DECLARE_MESSAGE_MAP()
};

extern CNotesApp theApp;
