#pragma once

#include "afxwin.h"
#include "s/Export.h"

/// Moves a view between a child frame of the main window and a window of its own on the desktop, and draws the button
/// in a frame's caption by which the user asks for that. Each of the three frames with such a button
/// (Gui_FloatChildFrame, Gui_FloatMainFrame, Gui_ExternFrame) owns one and hands it its messages; hosts set it up
/// through their frames.
///
/// What a view holds (scroll position, selection, what can be undone, the keyboard) stays with it: its window moves, it
/// is not made anew.
///
/// A move that is asked for while a window is being activated waits until that is done.
class GUI_API Gui_FloatHelp {
public:
    /// One for no frame, which docks back, is enabled, has no resources and makes a Gui_ExternFrame.
    Gui_FloatHelp();
    Gui_FloatHelp(const Gui_FloatHelp&) = default;
    Gui_FloatHelp& operator=(const Gui_FloatHelp&) = default;
    virtual ~Gui_FloatHelp();

    /// @param isRipOut true: the button floats the frame's view; false: it docks the view back
    void SetIsRipOut(bool isRipOut);
    /// The frame whose caption has the button. It stays the caller's and must outlive this object's use.
    void SetOwner(CFrameWnd* owner);
    /// The class of the window that a view gets when it floats: Gui_ExternFrame or a class derived from it, with
    /// DECLARE_DYNCREATE. Of another class, no view floats.
    /// @{
    void SetRipOutFrame(CRuntimeClass* frameClass);
    CRuntimeClass* GetRipOutFrame() const;
    /// @}
    /// The number of the menu, accelerators, icon, title and tool bar of that window. 0xFFFFFFFF, as at first, stands
    /// for none: then no view floats and a child frame shows no button.
    /// @{
    void SetResourceId(unsigned int id);
    unsigned int GetResourceId();
    bool HasValidResourceId();
    static bool IsValidResourceId(unsigned int id);
    /// @}
    /// Whether views move at all. True at first.
    /// @{
    void SetEnabled(bool enabled);
    bool IsEnabled() const;
    /// @}

    /// Gives the frame's view a window of its own; the frame goes. Of the main window it is the view of its active
    /// child frame.
    ///
    /// Nothing happens, and nothing is shown, when moves are disabled, when there is no number of resources, when the
    /// frame has no view that stands in it directly (a splitter's do not), and when the new window cannot be made.
    void RipOutView();
    /// Docks the view of an extern frame into a new child frame, which its document's template makes; the extern frame
    /// goes. Nothing happens when moves are disabled or the frame has no such view.
    void UnripView();
    /// Draws the button with the sign for floating. In the main window only while its active child frame is maximised:
    /// the button then stands in the menu bar.
    void DrawRipRect();
    /// Draws the button with the sign for docking.
    void DrawUnripRect();
    /// What a press in the frame's caption, and a release anywhere, mean for the button. A press captures the mouse; a
    /// release on the button moves the view.
    /// @param point in coordinates of the screen
    /// @return non-zero when the click was the button's. After that the frame may be gone.
    /// @{
    int OnNcLButtonDown(unsigned int hitTest, CPoint point);
    int OnNcLButtonUp(unsigned int hitTest, CPoint point);
    /// @}

    /// Forgets a press whose release will not be heard of.
    void CancelPress();

    /// Whether the move that this object is for, RipOutView or UnripView, would find a view that may be moved.
    bool CanMove();
    /// That move.
    void Move();

protected:
    /// The button's rectangle.
    /// @param onScreen in coordinates of the screen, else of the frame's window
    void GetButtonRect(CRect& rect, bool onScreen);
    /// The active view of a frame, when it stands in the frame directly; null otherwise.
    CView* GetFramesView(CFrameWnd* frame);

private:
    void drawButton(bool floats);
    void announce();
    bool isShown() const;
    bool isMainWindow() const;
    CFrameWnd* source() const;
    const Gui_FloatHelp& settings() const;
    bool isPutOff();
    void floatView(CFrameWnd& from, CView& view) const;
    void dockView(CView& view) const;

    bool m_isPushed = false;
    bool m_isRipOut = false;
    bool m_isEnabled = true;
    CFrameWnd* m_owner = nullptr;
    unsigned int m_resourceId = 0xFFFFFFFF;
    CRuntimeClass* m_ripOutFrame;
};
