#include "platform/afx/frames/MdiFrame.h"

#include "platform/afx/core/App.h"
#include "platform/afx/core/detail/Keys.h"
#include "platform/afx/core/detail/MenuWidgets.h"
#include "platform/afx/core/detail/Window.h"
#include "platform/afx/frames/DocTemplate.h"
#include "platform/afx/frames/Document.h"
#include "platform/afx/frames/View.h"
#include "platform/afx/frames/detail/RoutingFrame.h"
#include "platform/win/ExtensionModule.h"

#include <algorithm>

using namespace tvx::afx;

IMPLEMENT_DYNCREATE(CMDIFrameWnd, CFrameWnd)

// clang-format off
BEGIN_MESSAGE_MAP(CMDIFrameWnd, CFrameWnd)
    ON_WM_DESTROY()
    ON_WM_ACTIVATE()
    ON_MESSAGE(WM_COMMANDHELP, &CMDIFrameWnd::OnCommandHelp)
    ON_WM_INITMENUPOPUP()
    ON_UPDATE_COMMAND_UI(ID_WINDOW_ARRANGE, &CMDIFrameWnd::OnUpdateMDIWindowCmd)
    ON_UPDATE_COMMAND_UI(ID_WINDOW_CASCADE, &CMDIFrameWnd::OnUpdateMDIWindowCmd)
    ON_UPDATE_COMMAND_UI(ID_WINDOW_TILE_HORZ, &CMDIFrameWnd::OnUpdateMDIWindowCmd)
    ON_UPDATE_COMMAND_UI(ID_WINDOW_TILE_VERT, &CMDIFrameWnd::OnUpdateMDIWindowCmd)
    ON_UPDATE_COMMAND_UI(ID_WINDOW_NEW, &CMDIFrameWnd::OnUpdateMDIWindowCmd)
    ON_COMMAND_EX(ID_WINDOW_ARRANGE, &CMDIFrameWnd::OnMDIWindowCmd)
    ON_COMMAND_EX(ID_WINDOW_CASCADE, &CMDIFrameWnd::OnMDIWindowCmd)
    ON_COMMAND_EX(ID_WINDOW_TILE_HORZ, &CMDIFrameWnd::OnMDIWindowCmd)
    ON_COMMAND_EX(ID_WINDOW_TILE_VERT, &CMDIFrameWnd::OnMDIWindowCmd)
    ON_COMMAND(ID_WINDOW_NEW, &CMDIFrameWnd::OnWindowNew)
END_MESSAGE_MAP()
// clang-format on

BOOL CMDIFrameWnd::OnCreateClient(CREATESTRUCT* cs, CCreateContext*) {
    const CMenu* menu = GetMenu();
    CMenu* windowMenu = menu ? CMenu::FromHandle(GetWindowMenuPopup(menu->m_hMenu)) : nullptr;
    return CreateClient(cs, windowMenu);
}

BOOL CMDIFrameWnd::CreateClient(CREATESTRUCT*, CMenu*) {
    CREATESTRUCT cs{};
    cs.lpszClass = "MDICLIENT";
    cs.style = WS_CHILD | WS_VISIBLE;
    cs.hwndParent = m_hWnd;
    cs.hMenu = reinterpret_cast<HMENU>(static_cast<UINT_PTR>(AFX_IDW_PANE_FIRST));
    cs.hInstance = AfxGetInstanceHandle();
    m_hWndMDIClient = createWindow(cs, nullptr);
    return m_hWndMDIClient ? TRUE : FALSE;
}

void CMDIFrameWnd::OnDestroy() {
    CFrameWnd::OnDestroy();
    m_hWndMDIClient = nullptr;
}

void CMDIFrameWnd::OnActivate(UINT state, CWnd* other, BOOL minimized) {
    CFrameWnd::OnActivate(state, other, minimized);
    if (CMDIChildWnd* child = MDIGetActive()) {
        child->SendMessage(WM_NCACTIVATE, state != WA_INACTIVE ? TRUE : FALSE);
    }
}

CMDIChildWnd* CMDIFrameWnd::CreateNewChild(CRuntimeClass* childClass, UINT id, HMENU menu, HACCEL accelerators) {
    CObject* made = childClass->CreateObject();
    auto* child = DYNAMIC_DOWNCAST(CMDIChildWnd, made);
    if (!child) {
        delete made;
        return nullptr;
    }
    child->SetHandles(menu, accelerators);
    CCreateContext context;
    context.m_pCurrentFrame = this;
    if (!child->LoadFrame(id, WS_OVERLAPPEDWINDOW | FWS_ADDTOTITLE, this, &context)) {
        return nullptr;
    }
    child->InitialUpdateFrame(nullptr, TRUE);
    return child;
}

// --- child frames ---

CMDIChildWnd* CMDIFrameWnd::MDIGetActive(BOOL* maximized) const {
    const auto handle = reinterpret_cast<HWND>(
        ::SendMessageA(m_hWndMDIClient, WM_MDIGETACTIVE, 0, reinterpret_cast<LPARAM>(maximized)));
    if (!handle && maximized) {
        *maximized = FALSE;
    }
    return DYNAMIC_DOWNCAST(CMDIChildWnd, CWnd::FromHandlePermanent(handle));
}

void CMDIFrameWnd::MDIActivate(CWnd* child) {
    ::SendMessageA(m_hWndMDIClient, WM_MDIACTIVATE, reinterpret_cast<WPARAM>(child->m_hWnd), 0);
}

void CMDIFrameWnd::MDINext() {
    ::SendMessageA(m_hWndMDIClient, WM_MDINEXT, 0, 0);
}

void CMDIFrameWnd::MDIPrev() {
    ::SendMessageA(m_hWndMDIClient, WM_MDINEXT, 0, 1);
}

void CMDIFrameWnd::MDIMaximize(CWnd* child) {
    ::SendMessageA(m_hWndMDIClient, WM_MDIMAXIMIZE, reinterpret_cast<WPARAM>(child->m_hWnd), 0);
}

void CMDIFrameWnd::MDIRestore(CWnd* child) {
    ::SendMessageA(m_hWndMDIClient, WM_MDIRESTORE, reinterpret_cast<WPARAM>(child->m_hWnd), 0);
}

void CMDIFrameWnd::MDICascade() {
    MDICascade(0);
}

void CMDIFrameWnd::MDICascade(int type) {
    ::SendMessageA(m_hWndMDIClient, WM_MDICASCADE, static_cast<WPARAM>(type), 0);
}

void CMDIFrameWnd::MDITile() {
    MDITile(MDITILE_HORIZONTAL);
}

void CMDIFrameWnd::MDITile(int type) {
    ::SendMessageA(m_hWndMDIClient, WM_MDITILE, static_cast<WPARAM>(type), 0);
}

void CMDIFrameWnd::MDIIconArrange() {
    ::SendMessageA(m_hWndMDIClient, WM_MDIICONARRANGE, 0, 0);
}

CMenu* CMDIFrameWnd::MDISetMenu(CMenu* frameMenu, CMenu*) {
    CMenu* before = GetMenu();
    if (frameMenu && (!before || frameMenu->m_hMenu != before->m_hMenu)) {
        SetMenu(frameMenu);
    }
    return before;
}

CFrameWnd* CMDIFrameWnd::GetActiveFrame() {
    CMDIChildWnd* child = MDIGetActive();
    return child ? static_cast<CFrameWnd*>(child) : this;
}

void CMDIFrameWnd::OnUpdateFrameTitle(BOOL addToTitle) {
    if ((GetStyle() & FWS_ADDTOTITLE) == 0) {
        return;
    }
    BOOL maximized = FALSE;
    CMDIChildWnd* child = MDIGetActive(&maximized);
    if (maximized && child) {
        CString childTitle;
        child->GetWindowText(childTitle);
        const CString text = m_strTitle + " - [" + childTitle + "]";
        CString before;
        GetWindowText(before);
        if (before != text) {
            SetWindowText(text);
        }
        return;
    }
    const CDocument* document = child ? child->GetActiveDocument() : nullptr;
    if (addToTitle && document) {
        m_nWindow = child->m_nWindow;
        UpdateFrameTitleForDocument(document->GetTitle());
    } else {
        UpdateFrameTitleForDocument(nullptr);
    }
}

void CMDIFrameWnd::OnUpdateFrameMenu(HMENU alternative) {
    if (CMDIChildWnd* child = MDIGetActive()) {
        child->OnUpdateFrameMenu(TRUE, child, alternative);
    } else {
        CFrameWnd::OnUpdateFrameMenu(alternative);
    }
}

HACCEL CMDIFrameWnd::GetDefaultAccelerator() {
    CMDIChildWnd* child = MDIGetActive();
    const HACCEL childs = child ? child->GetDefaultAccelerator() : nullptr;
    return childs ? childs : m_hAccelTable;
}

// --- messages and commands ---

namespace {

/// The keys of child frames: Ctrl+F4 closes, Ctrl+F6 and Ctrl+Tab go on to the next one, with Shift backwards.
bool translateChildKeys(const CMDIFrameWnd& frame, const MSG& message) {
    const CMDIChildWnd* child = frame.MDIGetActive();
    if (!child || message.message != WM_KEYDOWN || !isKeyDown(VK_CONTROL) || isKeyDown(VK_MENU)) {
        return false;
    }
    switch (message.wParam) {
    case VK_F4:
        child->SendMessage(WM_SYSCOMMAND, SC_CLOSE);
        return true;
    case VK_F6:
    case VK_TAB:
        child->SendMessage(WM_SYSCOMMAND, isKeyDown(VK_SHIFT) ? SC_PREVWINDOW : SC_NEXTWINDOW);
        return true;
    default:
        return false;
    }
}

} // namespace

BOOL CMDIFrameWnd::PreTranslateMessage(MSG* message) {
    if (message->message < WM_KEYFIRST || message->message > WM_KEYLAST) {
        return CFrameWnd::PreTranslateMessage(message);
    }
    // Keys of the child frames are not meant while another frame has their place.
    const bool routed = isRouted(*this);
    CMDIChildWnd* child = routed ? nullptr : MDIGetActive();
    if (child && child->PreTranslateMessage(message)) {
        return TRUE;
    }
    if (menuHasKeyboard()) {
        return FALSE;
    }
    if (m_hAccelTable && ::TranslateAcceleratorA(m_hWnd, m_hAccelTable, message)) {
        return TRUE;
    }
    return !routed && translateChildKeys(*this, *message) ? TRUE : FALSE;
}

BOOL CMDIFrameWnd::OnCommand(WPARAM wParam, LPARAM lParam) {
    if (lParam == 0 && explains(LOWORD(wParam))) {
        return TRUE;
    }
    // A child frame may handle the command in an OnCommand of its own; it also comes along by the routing.
    CMDIChildWnd* child = isRouted(*this) ? nullptr : MDIGetActive();
    if (child && child->SendMessage(WM_COMMAND, wParam, lParam) != 0) {
        return TRUE;
    }
    if (CFrameWnd::OnCommand(wParam, lParam)) {
        return TRUE;
    }
    const UINT id = LOWORD(wParam);
    if (lParam != 0 || id < AFX_IDM_FIRST_MDICHILD) {
        return FALSE;
    }
    showListed(id - AFX_IDM_FIRST_MDICHILD);
    return TRUE;
}

BOOL CMDIFrameWnd::OnCmdMsg(UINT id, int code, void* extra, AFX_CMDHANDLERINFO* info) {
    CMDIChildWnd* child = isRouted(*this) ? nullptr : MDIGetActive();
    if (child && child->OnCmdMsg(id, code, extra, info)) {
        return TRUE;
    }
    return CFrameWnd::OnCmdMsg(id, code, extra, info);
}

void CMDIFrameWnd::OnUpdateMDIWindowCmd(CCmdUI* item) {
    item->Enable(MDIGetActive() != nullptr);
}

BOOL CMDIFrameWnd::OnMDIWindowCmd(UINT id) {
    switch (id) {
    case ID_WINDOW_ARRANGE:
        MDIIconArrange();
        return TRUE;
    case ID_WINDOW_CASCADE:
        MDICascade();
        return TRUE;
    case ID_WINDOW_TILE_HORZ:
        MDITile(MDITILE_HORIZONTAL);
        return TRUE;
    case ID_WINDOW_TILE_VERT:
        MDITile(MDITILE_VERTICAL);
        return TRUE;
    default:
        return FALSE;
    }
}

void CMDIFrameWnd::OnWindowNew() {
    CMDIChildWnd* child = MDIGetActive();
    CDocument* document = child ? child->GetActiveDocument() : nullptr;
    if (!document || !document->GetDocTemplate()) {
        return;
    }
    CDocTemplate* docTemplate = document->GetDocTemplate();
    if (CFrameWnd* frame = docTemplate->CreateNewFrame(document, child)) {
        docTemplate->InitialUpdateFrame(frame, document);
    }
}

// --- the list of windows ---

HMENU CMDIFrameWnd::GetWindowMenuPopup(HMENU menuBar) {
    const int count = ::GetMenuItemCount(menuBar);
    for (int i = count - 1; i >= 0; --i) {
        const HMENU popup = ::GetSubMenu(menuBar, i);
        const int items = ::GetMenuItemCount(popup);
        for (int j = 0; j < items; ++j) {
            const UINT id = ::GetMenuItemID(popup, j);
            if (id >= ID_WINDOW_NEW && id <= ID_WINDOW_TILE_VERT) {
                return popup;
            }
        }
    }
    return nullptr;
}

namespace {

/// Takes the list out of a popup, and the line before it.
void forgetListed(CMenu& popup) {
    for (int i = static_cast<int>(popup.GetMenuItemCount()) - 1; i >= 0; --i) {
        const UINT id = popup.GetMenuItemID(i);
        if (id >= AFX_IDM_FIRST_MDICHILD && id != static_cast<UINT>(-1)) {
            popup.DeleteMenu(static_cast<UINT>(i), MF_BYPOSITION);
            const bool first = i == 0 || popup.GetMenuItemID(i - 1) < AFX_IDM_FIRST_MDICHILD;
            if (first && i > 0 && popup.GetMenuItemID(i - 1) == 0) {
                popup.DeleteMenu(static_cast<UINT>(i - 1), MF_BYPOSITION);
                --i;
            }
        }
    }
}

} // namespace

std::vector<HWND> CMDIFrameWnd::ListedWindows() const {
    std::vector<HWND> windows;
    if (const Window* client = Window::from(m_hWndMDIClient)) {
        for (const Window* child : client->children()) {
            windows.push_back(child->handle());
        }
    }
    return windows;
}

void CMDIFrameWnd::ListWindows(CMenu& popup) const {
    forgetListed(popup);
    const std::vector<HWND> windows = ListedWindows();
    if (windows.empty()) {
        return;
    }
    // That of the frame that the user works in: a child frame stays its main frame's active one meanwhile.
    HWND active = ::GetActiveWindow();
    if (std::find(windows.begin(), windows.end(), active) == windows.end()) {
        const CMDIChildWnd* child = MDIGetActive();
        active = child ? child->m_hWnd : nullptr;
    }
    popup.AppendMenu(MF_SEPARATOR);
    UINT number = 0;
    for (const HWND window : windows) {
        CString title(fromQt(Window::from(window)->text()).c_str());
        title.Replace("&", "&&");
        CString text;
        text.Format(number < 9 ? "&%u %s" : "%u %s", number + 1, title.GetString());
        popup.AppendMenu(MF_STRING | (window == active ? MF_CHECKED : MF_UNCHECKED), AFX_IDM_FIRST_MDICHILD + number,
                         text);
        ++number;
    }
}

void CMDIFrameWnd::showListed(std::size_t index) {
    const std::vector<HWND> windows = ListedWindows();
    if (index >= windows.size()) {
        return;
    }
    const HWND chosen = windows[index];
    if (::IsIconic(chosen)) {
        ::ShowWindow(chosen, SW_RESTORE);
    }
    if (::GetParent(chosen) == m_hWndMDIClient) {
        ::SetForegroundWindow(m_hWnd);
        ::SendMessageA(m_hWndMDIClient, WM_MDIACTIVATE, reinterpret_cast<WPARAM>(chosen), 0);
    } else {
        ::SetForegroundWindow(chosen);
    }
}

void CMDIFrameWnd::OnInitMenuPopup(CMenu* popup, UINT index, BOOL systemMenu) {
    if (!systemMenu && popup && popup->m_hMenu == GetWindowMenuPopup(::GetMenu(m_hWnd))) {
        ListWindows(*popup);
    }
    CFrameWnd::OnInitMenuPopup(popup, index, systemMenu);
}
