#pragma once

#include "platform/afx/core/Wnd.h"

// Styles of a tool-tip control
#define TTS_ALWAYSTIP 0x01

/// Tips for parts of windows that are no controls: panes, drawn buttons. Each part is a tool: a number, a rectangle of
/// its window's client area, and the text of its tip.
///
/// @code
/// CToolTipCtrl m_tips;
///
/// m_tips.Create(this);
/// m_tips.AddTool(this, IDS_ZOOM_TIP, &zoomArea, 1);
///
/// BOOL CPlanBar::PreTranslateMessage(MSG* message) {
///     m_tips.RelayEvent(message);
///     return CWnd::PreTranslateMessage(message);
/// }
/// @endcode
///
/// The control is never seen itself. It hears of the mouse by RelayEvent only; a tip comes up when the pointer has
/// rested on a tool for as long as the desktop wants it, while the window is active, and goes when the pointer leaves
/// the tool, with a press, and when the control is deactivated. After a press it does not come back before the pointer
/// has left the tool.
///
/// A tool is known by its window and its number. Tools of a window that has ended show nothing.
class TVX_PLATFORM_API CToolTipCtrl : public CWnd {
    DECLARE_DYNAMIC(CToolTipCtrl)

public:
    /// Creates the control, active and without tools. It ends with its parent.
    /// @param style TTS_ALWAYSTIP shows tips in windows that are not active, too
    /// @return FALSE when the parent has no window
    BOOL Create(CWnd* parent, DWORD style = 0);
    using CWnd::Create;

    /// Adds a tool, or replaces the one with its window and number.
    /// @param text shown as it is; the empty one shows nothing
    /// @param rect in the window's client coordinates
    /// @return FALSE when the control or `window` has no window
    BOOL AddTool(CWnd* window, LPCSTR text, const RECT* rect, UINT_PTR tool);
    /// The same with a string of the resources; an unknown number is an empty text.
    BOOL AddTool(CWnd* window, UINT text, const RECT* rect, UINT_PTR tool);
    /// Moves a tool. A tip that is shown goes if the pointer is not in the tool any more. A tool that there is not is
    /// not added.
    void SetToolRect(CWnd* window, UINT_PTR tool, const RECT* rect);
    /// Changes the text of a tool, that of a tip that is shown too. A tool that there is not is not added.
    void UpdateTipText(LPCSTR text, CWnd* window, UINT_PTR tool);
    /// The same with a string of the resources; an unknown number is an empty text.
    void UpdateTipText(UINT text, CWnd* window, UINT_PTR tool);
    /// Lets tips come up, or hides what is shown and keeps them from coming. A control that is active already goes on
    /// as it was.
    void Activate(BOOL activate);
    /// Tells the control of a message; those of the mouse count.
    void RelayEvent(MSG* message);
};
