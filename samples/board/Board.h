#pragma once

#include "CommandConsole.h"
#include "Keyboard.h"
#include "Options.h"
#include "s/CommandLineInfo.h"
#include "s/MessageManager.h"
#include "s/SplashDlg.h"
#include "s/WinApp.h"

#include <memory>
#include <optional>
#include <vector>

/// The command line of the board: the switches of the family, the grid, one instance only, and any number of drawings.
class CBoardCommandLine : public Gui_CommandLineInfo {
public:
    void ParseParam(const char* param, BOOL isSwitch, BOOL isLast) override;
    CString GetCmdOpcodes() const override;
    CString GetUsageText() const override;

    /// Distance of the grid points in pixels, for this run; 0 for none.
    std::optional<int> m_grid;
    /// Whether a board that runs already is to be shown instead of this one.
    bool m_single = false;
    /// The drawings to open, as they were named.
    std::vector<CString> m_drawings;

private:
    /// Whether the next word is the value of `-grid`.
    bool m_gridFollows = false;
};

/// The application object.
class CBoardApp : public Gui_WinApp {
public:
    CBoardApp();
    BOOL InitInstance() override;
    int ExitInstance() override;
    HICON GetAppIcon() override;
    CString GetAppVersion() override;
    HWND GetOwnerForFileDialog() override;
    CString GetInitialDirForFileDialog(const CString& fileName) override;

    BOOL PreTranslateMessage(MSG* message) override;
    BOOL OnIdle(LONG count) override;

    const Options& GetOptions() const {
        return m_options;
    }
    /// Puts options in force in all drawings and the console, for this run.
    void SetOptions(const Options& options);
    CKeyboard& GetKeyboard() {
        return *m_keyboard;
    }
    CCommandConsole& GetConsole() {
        return m_console;
    }
    /// A drawing's file: one may be named without its extension.
    static CString DrawingName(const CString& word);

    afx_msg void OnToolsKeyboard();
    afx_msg void OnToolsCommands();
    afx_msg void OnToolsPreferences();

private:
    /// Whether this is to be the only board.
    bool m_single = false;

    /// The window that the user works in: that of a floating drawing, or the main one.
    CFrameWnd* WorkFrame() const;
    BOOL ShowMainFrame(CBoardCommandLine& info);
    BOOL OpenDrawings(CBoardCommandLine& info);

    Options m_options;
    CCommandConsole m_console;
    /// Shows errors in message boxes, those of handlers that have failed among them.
    Gui_MessageManager m_messages;
    /// Shown while the application starts, null afterwards.
    std::unique_ptr<Gui_SplashDlg> m_splash;
    /// Made with the main window.
    std::unique_ptr<CKeyboard> m_keyboard;

    DECLARE_MESSAGE_MAP()
};

extern CBoardApp theApp;
