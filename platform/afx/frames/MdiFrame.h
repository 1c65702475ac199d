#pragma once

/// @file
/// Frames with child frames: CMDIFrameWnd is the main window, CMDIChildWnd a document's frame inside it.

#include "platform/afx/frames/Frame.h"

class CMDIChildWnd;

// WM_MDITILE
#define MDITILE_VERTICAL 0x0000
#define MDITILE_HORIZONTAL 0x0001
#define MDITILE_SKIPDISABLED 0x0002

/// The main window of an application with several documents. Its client area holds the child frames; while one is
/// active, its menu and accelerators replace the frame's own. The popup with the Window commands (ID_WINDOW_...) also
/// lists the child frames. Commands go to the active child first.
class TVX_PLATFORM_API CMDIFrameWnd : public CFrameWnd {
    DECLARE_DYNCREATE(CMDIFrameWnd)

public:
    CMDIFrameWnd() = default;

    /// The window that holds the child frames.
    HWND m_hWndMDIClient = nullptr;

    /// The active child frame, null when there is none.
    /// @param maximized receives whether it is maximised; may be null
    CMDIChildWnd* MDIGetActive(BOOL* maximized = nullptr) const;
    /// Makes a child frame the active one.
    void MDIActivate(CWnd* child);
    /// Activates the next or the previous of the child frames that are seen, in order of creation and around.
    /// @{
    void MDINext();
    void MDIPrev();
    /// @}
    /// Maximises a child frame, or gives it back its size.
    /// @{
    void MDIMaximize(CWnd* child);
    void MDIRestore(CWnd* child);
    /// @}
    /// Lays the child frames one over the other, each a step further. `type` changes nothing here.
    /// @{
    void MDICascade();
    void MDICascade(int type);
    /// @}
    /// Lays the child frames one above the other.
    void MDITile();
    /// @param type MDITILE_VERTICAL (side by side) or MDITILE_HORIZONTAL (one above the other)
    void MDITile(int type);
    /// Asks the client window to put the minimised child frames in rows (WM_MDIICONARRANGE). The toolkit's client has
    /// no such order: they stay where they are.
    void MDIIconArrange();
    /// Shows another menu and answers the one shown before; null leaves it.
    /// @param windowMenu the popup that lists the child frames, null finds it
    CMenu* MDISetMenu(CMenu* frameMenu, CMenu* windowMenu);

    /// Creates the client window. Called from OnCreateClient.
    virtual BOOL CreateClient(CREATESTRUCT* cs, CMenu* windowMenu);
    /// Makes a new child frame without a document, shows it and makes it active.
    /// @param childClass a class derived from CMDIChildWnd, made with DECLARE_DYNCREATE
    /// @param id of its resources, as for LoadFrame
    /// @param menu,accelerators in force while it is active; they stay the caller's. Null menu: that of the resources
    /// @return the frame, which deletes itself as frames do; null when the class is another one or creation was refused
    CMDIChildWnd* CreateNewChild(CRuntimeClass* childClass, UINT id, HMENU menu = nullptr,
                                 HACCEL accelerators = nullptr);
    /// The popup that lists the child frames, null when `menuBar` has none.
    virtual HMENU GetWindowMenuPopup(HMENU menuBar);
    /// Lists the windows of the application at the end of a popup, in place of the list that is there. A choice from it
    /// is a command from AFX_IDM_FIRST_MDICHILD up, for this frame.
    void ListWindows(CMenu& popup) const;

    BOOL OnCreateClient(CREATESTRUCT* cs, CCreateContext* context) override;
    BOOL PreTranslateMessage(MSG* message) override;
    BOOL OnCmdMsg(UINT id, int code, void* extra, AFX_CMDHANDLERINFO* info) override;
    CFrameWnd* GetActiveFrame() override;
    void OnUpdateFrameTitle(BOOL addToTitle) override;
    void OnUpdateFrameMenu(HMENU alternative) override;
    HACCEL GetDefaultAccelerator() override;

    afx_msg void OnDestroy();
    afx_msg void OnActivate(UINT state, CWnd* other, BOOL minimized);
    afx_msg void OnInitMenuPopup(CMenu* popup, UINT index, BOOL systemMenu);
    /// Greys the Window commands while there is no child frame.
    afx_msg void OnUpdateMDIWindowCmd(CCmdUI* item);
    /// Window Arrange, Cascade and Tile (ID_WINDOW_...). FALSE for another command, which goes on along its route.
    afx_msg BOOL OnMDIWindowCmd(UINT id);
    /// Window New: another frame with a view of the active document; without a document nothing happens.
    afx_msg void OnWindowNew();
    /// Asks the active child frame first.
    afx_msg LRESULT OnCommandHelp(WPARAM, LPARAM context);

protected:
    friend class CMDIChildWnd;
    BOOL OnCommand(WPARAM wParam, LPARAM lParam) override;
    /// What that list has, in its order: the child frames. Derived frames may add windows of their own.
    virtual std::vector<HWND> ListedWindows() const;

    DECLARE_MESSAGE_MAP()

private:
    void showListed(std::size_t index);
};

/// A document's frame inside a CMDIFrameWnd. It has no menu of its own: that of its document template stands in the
/// main frame while it is active.
class TVX_PLATFORM_API CMDIChildWnd : public CFrameWnd {
    DECLARE_DYNCREATE(CMDIChildWnd)

public:
    CMDIChildWnd() = default;

    /// Creates the window in a main frame.
    /// @param className null for the framework's own class
    virtual BOOL Create(LPCSTR className, LPCSTR title, DWORD style = WS_CHILD | WS_VISIBLE | WS_OVERLAPPEDWINDOW,
                        const RECT& rect = rectDefault, CMDIFrameWnd* parent = nullptr,
                        CCreateContext* context = nullptr);
    using CFrameWnd::Create;
    /// Creates the window from the resources with the number `id`. A menu given by SetHandles or the context's template
    /// is taken, otherwise loaded.
    BOOL LoadFrame(UINT id, DWORD style = WS_CHILD | WS_VISIBLE | WS_OVERLAPPEDWINDOW | FWS_ADDTOTITLE,
                   CWnd* parent = nullptr, CCreateContext* context = nullptr) override;
    /// The menu and accelerators in force while this frame is active; they stay the caller's.
    void SetHandles(HMENU menu, HACCEL accelerators);

    /// The main frame that holds this one, null while there is none.
    CMDIFrameWnd* GetMDIFrame() const;
    /// Closes without asking. The document is asked by WM_CLOSE.
    void MDIDestroy();
    /// Makes this the active child frame.
    void MDIActivate();
    /// Maximises this frame, or gives it back its size.
    /// @{
    void MDIMaximize();
    void MDIRestore();
    /// @}

    BOOL PreCreateWindow(CREATESTRUCT& cs) override;
    BOOL PreTranslateMessage(MSG* message) override;
    BOOL DestroyWindow() override;
    void ActivateFrame(int command = -1) override;
    void OnUpdateFrameMenu(HMENU alternative) override;
    /// Shows in the main frame the menu that belongs to this state.
    /// @param activate whether this frame becomes active
    /// @param activated the frame that becomes active; null when none does, which brings the main frame's own menu back
    /// @param alternative shown instead of this frame's menu; null for none
    virtual void OnUpdateFrameMenu(BOOL activate, CWnd* activated, HMENU alternative);
    void OnUpdateFrameTitle(BOOL addToTitle) override;
    HACCEL GetDefaultAccelerator() override;
    CWnd* GetMessageBar() override;

    afx_msg void OnMDIActivate(BOOL activate, CWnd* activated, CWnd* deactivated);
    afx_msg int OnMouseActivate(CWnd* desktop, UINT hitTest, UINT message);
    afx_msg void OnDestroy();
    afx_msg void OnSize(UINT type, int cx, int cy);

protected:
    DECLARE_MESSAGE_MAP()

private:
    HMENU m_hMenuShared = nullptr;
    bool m_ownMenu = false;
};
