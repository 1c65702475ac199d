#pragma once

#include "afxwin.h"

#include <vector>

/// What Gui_FrameWnd and Gui_MDIFrameWnd keep for themselves.
struct Gui_MainFrameRecord {
    int placementRestored = 0;    ///< 1 once the frame has been activated
    std::vector<HWND> dockedBars; ///< the windows of the bars that DockControlBar was called for, each once

    /// Gives a frame that has just been loaded the family's title.
    static void SetFamilyTitle(CFrameWnd& frame);
    /// Puts window and bars where they stood, at the first call only, and records the application's window.
    /// @param command how the caller wants the window to be shown
    /// @return how it is to be shown
    int Restore(CFrameWnd& frame, int command);
    /// Keeps where window and bars stand.
    static void Save(CFrameWnd& frame);

    /// Notes a bar that is being docked.
    void NoteBar(const CControlBar& bar);
    /// The noted bar with this window, null when it is none or has ended.
    CControlBar* BarOf(HWND window) const;
};
