#pragma once

/// @file
/// CDockState: where the bars of a frame stand, as a value that can be kept in the application profile.

#include "platform/base/Array.h"
#include "platform/base/Geometry.h"

class CControlBar;
class CDockState;

/// Where one bar stands.
///
/// In the profile it is the section "NAME-Bar0" (1, 2, ...), where NAME is the profile name, with the numbers below
/// as decimal texts: "BarID", "Visible", "Floating", "XPos", "YPos", "MRUDockID", "Row", "Place".
class TVX_PLATFORM_API CControlBarInfo {
public:
    /// The bar's identifier.
    UINT m_nBarID = 0;
    BOOL m_bVisible = TRUE;
    /// Whether the bar is a small window of its own.
    BOOL m_bFloating = FALSE;
    /// The corner of a floating bar on the screen.
    CPoint m_pointPos{0, 0};
    /// The side it is docked at, or was last before it floated: AFX_IDW_DOCKBAR_...; 0 for bars whose place is fixed.
    UINT m_uMRUDockID = 0;
    /// Which row of bars on that side it stands in, the outermost one being 0, and the how manieth bar of the row it
    /// is.
    int m_nRow = 0;
    int m_nPlace = 0;
    /// The bar itself; null in what was loaded.
    CControlBar* m_pBar = nullptr;

    /// Reads the record of a number.
    /// @return FALSE when it is missing or names no bar; the object is unchanged then
    BOOL LoadState(LPCSTR profileName, int index, CDockState* state = nullptr);
    /// Writes the record of a number.
    BOOL SaveState(LPCSTR profileName, int index) const;
};

/// Where all bars of a frame stand. A value made for the asking: CFrameWnd::GetDockState fills it, SetDockState puts
/// the bars where it says, LoadState and SaveState bring it from and to the application profile.
///
/// @code
/// CDockState state;
/// frame->GetDockState(state);
/// state.SaveState("Bars");
/// @endcode
class TVX_PLATFORM_API CDockState : public CObject {
    DECLARE_DYNAMIC(CDockState)

public:
    CDockState() = default;
    /// Deletes the records.
    ~CDockState() override;
    CDockState(const CDockState&) = delete;
    CDockState& operator=(const CDockState&) = delete;

    /// The records: CControlBarInfo*, owned. Null stands for one that could not be read.
    CPtrArray m_arrBarInfo;

    /// Replaces the records by those of a profile name, as many as the entry "Bars" in the section "NAME-Summary"
    /// says; none when there is no such entry or it is damaged.
    void LoadState(LPCSTR profileName);
    /// Writes the records.
    void SaveState(LPCSTR profileName) const;
    /// Deletes the records.
    void Clear();
};
