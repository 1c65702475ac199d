#pragma once

#include "afxwin.h"
#include "s/Export.h"

#include <memory>

struct Gui_MainFrameRecord;

/// The main window of an application with several documents: what Gui_FrameWnd is for one document at a time, and bars
/// that a command docks.
///
/// @code
/// int CMainFrame::OnCreate(CREATESTRUCT* cs) {
///     if (CMDIFrameWnd::OnCreate(cs) == -1 || !m_toolBar.Create(this) || !m_toolBar.LoadToolBar(IDR_MAINFRAME)) {
///         return -1;
///     }
///     m_toolBar.EnableDocking(CBRS_ALIGN_ANY);
///     EnableDocking(CBRS_ALIGN_ANY);
///     DockControlBar(&m_toolBar);
///     return 0;
/// }
/// @endcode
class GUI_API Gui_MDIFrameWnd : public CMDIFrameWnd { // NOLINT(cppcoreguidelines-virtual-class-destructor)
    DECLARE_DYNAMIC(Gui_MDIFrameWnd)

public:
    /// See Gui_FrameWnd.
    /// @{
    BOOL LoadFrame(UINT id, DWORD style = WS_OVERLAPPEDWINDOW | FWS_ADDTOTITLE, CWnd* parent = nullptr,
                   CCreateContext* context = nullptr) override;
    void ActivateFrame(int command = -1) override;
    afx_msg void OnClose();
    afx_msg BOOL OnHelpInfo(HELPINFO* info);
    /// @}

    /// Docks a bar as the base does, and notes it for OnSysCommand. Call it in place of the base's.
    void DockControlBar(CControlBar* bar, unsigned int side = 0, const RECT* rect = nullptr);

    /// The three that follow are for hosts' message maps (`ON_WM_CREATE()` and so on); the library's own routes none of
    /// them.
    /// @{

    /// The creation of a plain frame window: makes the client and lays out.
    /// @return 0, or -1 where that failed
    afx_msg int OnCreate(CREATESTRUCT* cs);
    /// The background of a plain frame window.
    afx_msg BOOL OnEraseBkgnd(CDC* dc);
    /// SC_KEYMENU with the window of a bar as parameter docks that bar if it floats and makes it float if it is docked;
    /// the bar is one that DockControlBar was called for. Everything else goes to the base.
    ///
    /// @code
    /// SendMessage(WM_SYSCOMMAND, SC_KEYMENU, reinterpret_cast<LPARAM>(m_toolBar.m_hWnd)); // a command "Dock"
    /// @endcode
    afx_msg void OnSysCommand(unsigned int command, LPARAM parameter);
    /// @}

protected:
    Gui_MDIFrameWnd();
    ~Gui_MDIFrameWnd() override;

    DECLARE_MESSAGE_MAP()

private:
    void toggleDocking(CControlBar& bar);

    std::unique_ptr<Gui_MainFrameRecord> m_record;
};
