#pragma once

#include "afxext.h"
#include "platform/sec/Frames.h"
#include "s/Export.h"
#include "s/FloatFrame.h"
#include "s/StatusBar.h"

/// The window of a view that floats on the desktop: with a menu, accelerators, a tool bar and a status bar of its own,
/// and an entry in the task list. A button in its caption and "Dock Window" in its system menu dock the view back.
///
/// Views get it from Gui_FloatChildFrame. Its resources have one number: menu, accelerators, icon, title (first part of
/// the string), tool bar. Derived classes, named by Gui_FloatChildFrame::SetRipOutFrame, override the operations.
///
/// Commands go to the view, its document and this frame, then to what the main frame itself handles. While the frame is
/// active, commands that reach the main frame by a key go this way, too.
class GUI_API Gui_ExternFrame : public FloatFrame<SECFrameWnd> {
    DECLARE_DYNCREATE(Gui_ExternFrame)

public:
    /// What the close button of such a frame does.
    enum class CloseAction {
        Close,   ///< closes the view; the document is asked when it is its last one
        DockBack ///< docks the view back
    };

    Gui_ExternFrame();
    ~Gui_ExternFrame() override;

    /// Whether the view may be docked back. True at first.
    /// @{
    void SetUnRipEnabled(bool enabled);
    bool IsUnRipEnabled() const;
    /// @}
    /// The number of the resources that the frame was made from; the child frame of a view that is docked back gets it.
    /// @{
    void SetRipResourceId(unsigned int id);
    unsigned int GetRipResourceId();
    /// @}

    /// Makes the tool bar from the resources, in the frame's creation. 0 when there is none: the frame goes without.
    virtual int CreateToolBar();
    /// Makes the status bar: prompts and the lock keys. 0 makes the frame's creation fail.
    virtual int CreateStatusBar();
    /// Lets the tool bar dock at every side, and docks it.
    virtual void SetupToolBarDocking();
    /// Called around the creation of the frame for a view, and before and after that view becomes its active one. They
    /// do nothing.
    /// @{
    virtual void PreLoadFrame(CView* view);
    virtual void PostLoadFrame(CView* view);
    virtual void PreSetActiveView(CView* view);
    virtual void PostSetActiveView(CView* view);
    /// @}
    /// Shows a text in a pane of the status bar at once, and makes the pane as wide as the text and 2 pixels.
    virtual void SetStatusPaneText(int pane, const CString& text);
    /// For derived frames; does nothing.
    virtual void CustomizeGuiElement();

    /// What close buttons of all such frames do; CloseAction::Close at first.
    /// @{
    static void SetCloseAction(CloseAction action);
    static CloseAction GetCloseAction();
    /// @}
    /// All such frames that have a window, in the order in which they were made.
    static const std::vector<Gui_ExternFrame*>& GetAll();
    /// Whether a frame is one of them still.
    static bool IsLiving(const Gui_ExternFrame* frame);

    BOOL OnCmdMsg(UINT id, int code, void* extra, AFX_CMDHANDLERINFO* info) override;

    /// Handlers.
    /// @{
    afx_msg int OnCreate(CREATESTRUCT* cs);
    afx_msg void OnDestroy();
    afx_msg void OnClose();
    afx_msg void OnActivate(UINT state, CWnd* other, BOOL minimized);
    afx_msg void OnSysCommand(UINT command, LPARAM parameter);
    afx_msg void OnInitMenuPopup(CMenu* popup, UINT index, BOOL systemMenu);
    afx_msg BOOL OnHelpInfo(HELPINFO* info);
    afx_msg void OnWindowNew();
    /// The command that docks the view (GUI_ID_FLOAT_VIEW), and whether it would.
    afx_msg void OnFloatView();
    afx_msg void OnUpdateFloatView(CCmdUI* item);
    /// @}

protected:
    BOOL OnCommand(WPARAM wParam, LPARAM lParam) override;

    CToolBar m_toolBar;
    Gui_StatusBar m_statusBar;

    DECLARE_MESSAGE_MAP()

private:
    HWND m_formerRouting = nullptr; ///< the frame that commands went through before this one became active
};
