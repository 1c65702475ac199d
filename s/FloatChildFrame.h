#pragma once

#include "platform/sec/Frames.h"
#include "s/Export.h"
#include "s/FloatFrame.h"

/// A child frame whose view can be given a window of its own on the desktop: by a button in its caption, left of the
/// minimise button, and by "Float Window" in its system menu. Document templates make it, as any child frame.
///
/// @code
/// class CDrawingFrame : public Gui_FloatChildFrame {
///     DECLARE_DYNCREATE(CDrawingFrame)
/// protected:
///     CDrawingFrame() { SetRipResourceId(IDR_DRAWING_WINDOW); }
/// };
/// @endcode
///
/// A frame without a number of resources shows no button, and its system-menu item does nothing.
class GUI_API Gui_FloatChildFrame : public FloatFrame<SECWorksheet> {
    DECLARE_DYNCREATE(Gui_FloatChildFrame)

public:
    Gui_FloatChildFrame();
    ~Gui_FloatChildFrame() override;

    /// Whether the view may be floated. True at first.
    /// @{
    void SetRipEnabled(bool enabled);
    bool IsRipEnabled() const;
    /// @}
    /// The number of the menu, accelerators, icon, title and tool bar of the window that the view gets; 0xFFFFFFFF, as
    /// at first, for none.
    /// @{
    void SetRipResourceId(unsigned int id);
    unsigned int GetRipResourceId();
    /// @}
    /// The class of that window: Gui_ExternFrame or one derived from it.
    /// @{
    void SetRipOutFrame(CRuntimeClass* frameClass);
    CRuntimeClass* GetRipOutFrame();
    /// @}
    /// Called before and after a view that comes back becomes the active view of this frame. They do nothing.
    /// @{
    virtual void PreSetActiveView(CView* view);
    virtual void PostSetActiveView(CView* view);
    /// @}

    /// Handlers.
    /// @{
    virtual afx_msg int OnCreate(CREATESTRUCT* cs);
    afx_msg void OnSysCommand(UINT command, LPARAM parameter);
    afx_msg void OnInitMenu(CMenu* menu);
    /// The command that floats the view (GUI_ID_FLOAT_VIEW), and whether it would.
    afx_msg void OnFloatView();
    afx_msg void OnUpdateFloatView(CCmdUI* item);
    /// @}

protected:
    DECLARE_MESSAGE_MAP()
};
