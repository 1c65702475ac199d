#pragma once

#include "platform/sec/Frames.h"
#include "s/Export.h"
#include "s/FloatFrame.h"

/// A main frame whose child frames (Gui_FloatChildFrame) can be given windows of their own on the desktop. It offers
/// the button for a maximised child frame, which has no caption, in its menu bar.
///
/// Its Window menu lists the windows of floating views behind the child frames, and "Dock All" (GUI_ID_DOCK_ALL), put
/// into a menu by the host, brings them all back. When it closes, the document of each floating view is asked as those
/// of the others are, and no window stays behind.
class GUI_API Gui_FloatMainFrame : public FloatFrame<SECWorkbook> {
    DECLARE_DYNAMIC(Gui_FloatMainFrame)

public:
    Gui_FloatMainFrame();
    ~Gui_FloatMainFrame() override;

    /// Whether the button of this frame floats views. True at first.
    /// @{
    void SetRipEnabled(bool enabled);
    bool IsRipEnabled() const;
    /// @}

    /// Brings all floating views back into child frames; those that cannot be brought back stay.
    static void DockAll();

    /// Handlers.
    /// @{
    afx_msg int OnCreate(CREATESTRUCT* cs);
    afx_msg void OnDestroy();
    afx_msg void OnActivate(UINT state, CWnd* other, BOOL minimized);
    afx_msg void OnSysCommand(UINT command, LPARAM parameter);
    afx_msg void OnInitMenu(CMenu* menu);
    afx_msg LRESULT OnThemeChanged();
    afx_msg void OnDockAll();
    afx_msg void OnUpdateDockAll(CCmdUI* item);
    /// @}

protected:
    std::vector<HWND> ListedWindows() const override;

    DECLARE_MESSAGE_MAP()
};
