#pragma once

#include "afxwin.h"
#include "s/Export.h"

#include <memory>

/// The window that an application shows while it starts: a picture with the application's name, its versions and the
/// copyright notice, over the place where the main window will appear.
///
/// It goes at the first key or button press, after three seconds, or at once when a dialog or message box opens, which
/// it must not hide. The host hands it messages and asks it about the time; it is a member of the application object:
///
/// @code
/// BOOL BoardApp::InitInstance() {
///     ...
///     if (info.m_bShowSplash) {
///         m_splash = std::make_unique<Gui_SplashDlg>(nullptr);
///         m_splash->Create(nullptr);
///     }
///     ... // the main window
/// }
/// BOOL BoardApp::PreTranslateMessage(MSG* message) {
///     if (m_splash)
///         m_splash->CheckMessage(message, m_pMainWnd);
///     return Gui_WinApp::PreTranslateMessage(message);
/// }
/// BOOL BoardApp::OnIdle(LONG count) {
///     if (m_splash && !m_splash->CheckTimeout(m_pMainWnd))
///         m_splash.reset();
///     return Gui_WinApp::OnIdle(count);
/// }
/// @endcode
///
/// While it is shown it has the thread come to its idle time several times a second, so that it goes in time when the
/// user does nothing. docs/start-and-about.md tells more.
class GUI_API Gui_SplashDlg : public CDialog {
public:
    /// No window yet.
    /// @param parent the window to stand over; null, as there is no main window yet
    explicit Gui_SplashDlg(CWnd* parent);
    ~Gui_SplashDlg() override;

    /// Makes the window and shows it, without taking the keyboard. It stands in the middle of where the main window
    /// was when the settings were written last, unless that was minimised, maximised or off the screen: then in the
    /// middle of the screen. Of several screens it is on one, never across two. It is painted when the call returns.
    /// @return 1; 0 when there is no window: without a display, for example. 1 too when the picture is missing: then
    ///     the window stays hidden
    int Create(CWnd* parent);

    /// To be called with every message before it is translated. A key or a button that goes down, on a caption too,
    /// removes the splash window.
    /// @param mainWindow repainted at once then; may be null
    void CheckMessage(MSG* message, CWnd* mainWindow);
    /// To be called when the application is idle. Removes the splash window when more than three seconds have gone by
    /// since it was made, counted in whole seconds.
    /// @param mainWindow as in CheckMessage
    /// @return 1 while the window is there, 0 once it is gone
    int CheckTimeout(CWnd* mainWindow);
    /// Removes the window at once.
    void Destroy();

protected:
    BOOL OnInitDialog() override;
    void DoDataExchange(CDataExchange* dx) override;
    void PostNcDestroy() override;
    afx_msg void OnPaint();
    afx_msg void OnTimer(UINT_PTR id);
    DECLARE_MESSAGE_MAP()

private:
    struct Record;

    bool loadPicture();
    void place();
    void showNow();
    void dismiss(CWnd* mainWindow);

    std::unique_ptr<Record> m_record;
};
