#include "platform/afx/dialogs/Dialog.h"

#include "platform/afx/core/App.h"
#include "platform/afx/core/ControlMessages.h"
#include "platform/afx/core/detail/Loop.h"
#include "platform/afx/dialogs/DataExchange.h"
#include "platform/afx/dialogs/detail/DialogKeys.h"
#include "platform/afx/dialogs/detail/DialogWindow.h"
#include "platform/afx/toolkit/detail/Gui.h"
#include "platform/win/ExtensionModule.h"
#include "platform/win/FrameworkIds.h"
#include "platform/win/Resource.h"

#include <QCursor>

#include <cstdio>
#include <optional>

using namespace tvx::afx;

IMPLEMENT_DYNAMIC(CDialog, CWnd)

// clang-format off
BEGIN_MESSAGE_MAP(CDialog, CWnd)
    ON_COMMAND(IDOK, &CDialog::OnOK)
    ON_COMMAND(IDCANCEL, &CDialog::OnCancel)
    ON_MESSAGE(WM_COMMANDHELP, &CDialog::OnCommandHelp)
    ON_MESSAGE(WM_INITDIALOG, &CDialog::HandleInitDialog)
END_MESSAGE_MAP()
// clang-format on

namespace {

/// Takes the input from the window a modal dialog stands over, and gives it back with the activation. Its look does not
/// change: the toolkit keeps the user away, the style tells the program.
class OwnerLock {
public:
    explicit OwnerLock(Window* owner) : m_owner(owner && owner->isEnabled() ? owner->handle() : nullptr) {
        if (m_owner) {
            set(WS_DISABLED);
        }
    }
    ~OwnerLock() {
        release();
    }
    OwnerLock(const OwnerLock&) = delete;
    OwnerLock& operator=(const OwnerLock&) = delete;
    void release() {
        if (m_owner) {
            set(0);
            m_owner = nullptr;
        }
    }

private:
    void set(DWORD disabled) {
        if (Window* window = Window::from(m_owner)) {
            window->setStyle((window->style() & ~DWORD{WS_DISABLED}) | disabled, window->exStyle());
        }
    }
    HWND m_owner;
};

Window* topLevelOf(CWnd* window) {
    Window* state = window ? window->GetState() : nullptr;
    return state ? state->topLevel() : nullptr;
}

} // namespace

CDialog::CDialog(LPCSTR templateName, CWnd* parent) : m_lpszTemplateName(templateName), m_pParentWnd(parent) {
    if (IS_INTRESOURCE(templateName)) {
        m_nIDHelp = static_cast<UINT>(reinterpret_cast<std::uintptr_t>(templateName));
    }
}

CDialog::CDialog(UINT templateId, CWnd* parent) : CDialog(MAKEINTRESOURCE(templateId), parent) {}

CDialog::~CDialog() {
    if (m_hWnd) {
        try {
            DestroyWindow();
        } catch (...) {
            ExceptionCarrier::store(std::current_exception());
        }
    }
}

// --- making ---

BOOL CDialog::Create(UINT templateId, CWnd* parent) {
    return Create(MAKEINTRESOURCE(templateId), parent);
}

BOOL CDialog::Create(LPCSTR templateName, CWnd* parent) {
    m_lpszTemplateName = templateName;
    if (IS_INTRESOURCE(templateName) && m_nIDHelp == 0) {
        m_nIDHelp = static_cast<UINT>(reinterpret_cast<std::uintptr_t>(templateName));
    }
    m_pParentWnd = parent ? parent : AfxGetMainWnd();
    if (!ensureGui()) {
        tellMissingDisplay();
        return FALSE;
    }
    const auto description = describe();
    return description && createFrom(*description, m_pParentWnd, false) ? TRUE : FALSE;
}

std::optional<tvx::DialogTemplate> CDialog::describe() const {
    return loadDialogTemplate(m_lpszTemplateName);
}

BOOL CDialog::createFrom(const tvx::DialogTemplate& description, CWnd* parent, bool modal) {
    CREATESTRUCT cs{};
    // A page's template says WS_CHILD; run by DoModal it is a window of its own all the same.
    const bool child = (description.style & WS_CHILD) != 0 && !modal;
    cs.lpszClass = dialogClass;
    cs.lpszName = description.title.c_str();
    cs.style = static_cast<LONG>(description.style & ~(DWORD{WS_VISIBLE} | (child ? 0U : DWORD{WS_CHILD})));
    cs.dwExStyle = description.extendedStyle;
    cs.hwndParent = parent ? (child ? parent->m_hWnd : parent->GetTopLevelParent()->m_hWnd) : nullptr;
    cs.hInstance = AfxGetInstanceHandle();
    cs.cx = cs.cy = 1; // known once the font is
    m_ended = false;
    m_modal = modal;
    const HWND handle = createWindow(cs, this);
    if (!handle) {
        return FALSE;
    }
    initialise(description, parent);
    if (!::IsWindow(handle)) {
        return FALSE;
    }
    if (!modal && !m_ended && (description.style & WS_VISIBLE) != 0) {
        ShowWindow(SW_SHOW);
    }
    return ::IsWindow(handle);
}

namespace {

/// Gives a dialog the place and size of its template. The answer is whether it was centred instead.
bool place(DialogWindow& dialog, const tvx::DialogTemplate& description, CWnd& object) {
    const QRect rect = dialog.map(description.rect);
    Window* over = dialog.isChild() ? nullptr : dialog.owner();
    QPoint corner = rect.topLeft();
    if (over && (description.style & DS_ABSALIGN) == 0) {
        corner = over->clientToScreen(corner);
    }
    if ((description.style & DS_CENTERMOUSE) != 0) {
        corner = QCursor::pos() - QPoint(rect.width() / 2, rect.height() / 2);
    }
    guarded([&] { dialog.setClientSize(corner, rect.size()); });
    // Templates that leave the place to the framework stand at 0, 0.
    const bool noPlace = rect.topLeft().isNull() && (description.style & (DS_ABSALIGN | DS_CENTERMOUSE)) == 0;
    const bool centred = !dialog.isChild() && ((description.style & DS_CENTER) != 0 || noPlace || !over);
    if (centred) {
        object.CenterWindow();
    }
    return centred;
}

} // namespace

/// Sizes the window, makes its controls, and lets the derived class fill them.
void CDialog::initialise(const tvx::DialogTemplate& description, CWnd*) {
    auto& dialog = static_cast<DialogWindow&>(*GetState());
    const HWND handle = m_hWnd;
    dialog.useFont(description);
    OnSetFont(GetFont());
    const bool centred = place(dialog, description, *this);
    const QRect placed = dialog.windowRect();
    if (!makeControls(dialog, description)) {
        std::fprintf(stderr, "A control of the dialog %s could not be made.\n",
                     resourceNameOf(m_lpszTemplateName).c_str());
    }
    Window* first = nextTabItem(dialog, nullptr, Direction::Forward);
    const auto firstHandle = reinterpret_cast<WPARAM>(first ? first->handle() : nullptr);
    const bool setsFocus = SendMessage(WM_INITDIALOG, firstHandle, 0) != 0;
    if (!::IsWindow(handle) || m_ended) {
        return;
    }
    const QRect now = dialog.windowRect();
    if (centred && now.topLeft() == placed.topLeft() && now.size() != placed.size()) {
        CenterWindow(); // laid out anew, it is centred with its new size
    }
    if (setsFocus && !dialog.isChild()) {
        // Controls may have been shown, hidden or disabled meanwhile.
        if (Window* chosen = nextTabItem(dialog, nullptr, Direction::Forward)) {
            dialog.lastFocus = chosen->handle();
            focusControl(*chosen);
            dialog.showDefault(chosen);
        }
    }
}

LRESULT CDialog::HandleInitDialog(WPARAM, LPARAM) {
    if (m_lpszTemplateName) {
        fillControls(static_cast<DialogWindow&>(*GetState()), m_lpszTemplateName);
    }
    return OnInitDialog();
}

BOOL CDialog::OnInitDialog() {
    if (!UpdateData(FALSE)) {
        std::fprintf(stderr, "The dialog %s could not be filled.\n", resourceNameOf(m_lpszTemplateName).c_str());
        EndDialog(-1);
        return FALSE;
    }
    return TRUE;
}

// --- modal life ---

int CDialog::DoModal() {
    if (!ensureGui()) {
        tellMissingDisplay();
        return -1;
    }
    const auto description = describe();
    if (!description) {
        return -1;
    }
    CWnd* parent = m_pParentWnd && m_pParentWnd->m_hWnd ? m_pParentWnd : CWnd::FromHandle(defaultOwner());
    Window* owner = topLevelOf(parent);
    const HWND ownerHandle = owner ? owner->handle() : nullptr;
    OwnerLock lock(owner);
    m_modalResult = -1;
    const auto close = [&] {
        // The owner reacts again before the dialog goes, so that it and no other program's window is activated.
        lock.release();
        if (m_hWnd) {
            DestroyWindow();
        }
        m_modal = false;
        activateAgain(ownerHandle);
    };
    try {
        if (createFrom(*description, parent, true) && !m_ended) { // OnInitDialog may end it before it is seen
            GetState()->widget()->setWindowModality(Qt::ApplicationModal);
            ShowWindow(SW_SHOW);
            if (!m_ended && m_hWnd) {
                RunModalLoop();
            }
        }
    } catch (...) {
        close();
        throw;
    }
    close();
    return m_modalResult;
}

void CDialog::EndDialog(int result) {
    m_ended = true;
    m_modalResult = result;
    if (m_modal) {
        EndModalLoop(result);
    }
    if (m_hWnd) {
        ShowWindow(SW_HIDE);
    }
}

void CDialog::OnOK() {
    if (UpdateData(TRUE)) {
        EndDialog(IDOK);
    }
}

void CDialog::OnCancel() {
    EndDialog(IDCANCEL);
}

// --- messages ---

namespace {

/// Whether a dialog is a child of another one, or of a window that hands its controls on to another one.
bool isInDialog(const Window& window) {
    const Window* around = window.isChild() ? window.parent() : nullptr;
    while (around && around->isChild() && (around->exStyle() & WS_EX_CONTROLPARENT) != 0 &&
           !dynamic_cast<const DialogWindow*>(around)) {
        around = around->parent();
    }
    return dynamic_cast<const DialogWindow*>(around) != nullptr;
}

} // namespace

BOOL CDialog::PreTranslateMessage(MSG* message) {
    if (CWnd::PreTranslateMessage(message)) {
        return TRUE;
    }
    // The keys of a child dialog belong to the dialog around it.
    const Window* window = GetState();
    return window && isInDialog(*window) ? FALSE : PreTranslateInput(message);
}

BOOL CDialog::OnCmdMsg(UINT id, int code, void* extra, AFX_CMDHANDLERINFO* info) {
    if (CWnd::OnCmdMsg(id, code, extra, info)) {
        return TRUE;
    }
    // Controls' own numbers stay below 0x8000, the framework's system commands from 0xF000 up.
    const bool command = (code == CN_COMMAND || code == CN_UPDATE_COMMAND_UI) && (id & 0x8000) != 0 && id < 0xF000;
    if (!command) {
        return FALSE;
    }
    CWnd* owner = GetParent();
    if (owner && owner->OnCmdMsg(id, code, extra, info)) {
        return TRUE;
    }
    CWinThread* thread = AfxGetThread();
    return thread && thread->OnCmdMsg(id, code, extra, info) ? TRUE : FALSE;
}

LRESULT CDialog::OnCommandHelp(WPARAM, LPARAM context) {
    if (context == 0 && m_nIDHelp != 0) {
        context = LPARAM{HID_BASE_RESOURCE} + m_nIDHelp;
    }
    CWinApp* app = AfxGetApp();
    if (context == 0 || !app) {
        return FALSE;
    }
    app->WinHelpInternal(static_cast<DWORD_PTR>(context));
    return TRUE;
}

// --- controls ---

void CDialog::NextDlgCtrl() const {
    if (Window* next = nextTabItem(*GetState(), Window::from(::GetFocus()), Direction::Forward)) {
        focusControl(*next);
    }
}

void CDialog::PrevDlgCtrl() const {
    if (Window* next = nextTabItem(*GetState(), Window::from(::GetFocus()), Direction::Backward)) {
        focusControl(*next);
    }
}

void CDialog::GotoDlgCtrl(CWnd* control) {
    if (Window* window = control ? control->GetState() : nullptr) {
        focusControl(*window);
    }
}

DWORD CDialog::GetDefID() const {
    return static_cast<DWORD>(SendMessage(DM_GETDEFID));
}

void CDialog::SetDefID(UINT id) {
    SendMessage(DM_SETDEFID, id);
}

void CDialog::MapDialogRect(RECT* rect) const {
    if (const auto* dialog = dynamic_cast<const DialogWindow*>(GetState())) {
        const QRect low = dialog->map({rect->left, rect->top, rect->right, rect->bottom});
        *rect = {low.x(), low.y(), low.width(), low.height()};
    }
}
