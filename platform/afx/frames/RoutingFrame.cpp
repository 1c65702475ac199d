#include "platform/afx/frames/detail/RoutingFrame.h"

#include "platform/afx/core/App.h"
#include "platform/afx/core/detail/Window.h"
#include "platform/afx/frames/Frame.h"

#include <utility>

namespace tvx::afx {

namespace {

/// Its window rather than the frame, so that it is forgotten with that whatever handlers the frame has.
thread_local HWND routing = nullptr;

/// One question that the routing frame is being asked for the main frame. Handlers may run loops, in which it is asked
/// for other things.
struct Asking {
    const CFrameWnd* frame;
    UINT id;
    int code;
    const Asking* outer;
};
thread_local const Asking* asking = nullptr;

/// Bars of the main frame show at idle time what a click on them would do. It makes the main frame the active one, and
/// so ends what made another frame the routing one.
bool isIdleUpdate() {
    const MSG* message = CWnd::GetCurrentMessage();
    return message && message->message == WM_IDLEUPDATECMDUI;
}

} // namespace

bool isRouted(const CFrameWnd& frame) {
    const CFrameWnd* other = AfxGetRoutingFrame();
    const CWinApp* app = other ? AfxGetApp() : nullptr;
    return app && app->m_pMainWnd == &frame && other != &frame && !isIdleUpdate();
}

bool isAskedForMainFrame(const CFrameWnd& frame, UINT id, int code) {
    for (const Asking* each = asking; each; each = each->outer) {
        if (each->frame == &frame && each->id == id && each->code == code) {
            return true;
        }
    }
    return false;
}

BOOL offerToRoutingFrame(UINT id, int code, void* extra, AFX_CMDHANDLERINFO* info) {
    CFrameWnd* frame = AfxGetRoutingFrame();
    if (!frame || isAskedForMainFrame(*frame, id, code)) {
        return FALSE;
    }
    const Asking now{frame, id, code, asking};
    struct Restore {
        ~Restore() {
            asking = asking->outer;
        }
    } const restore;
    asking = &now;
    return frame->OnCmdMsg(id, code, extra, info);
}

} // namespace tvx::afx

using namespace tvx::afx;

CFrameWnd* AfxGetRoutingFrame() {
    const Window* window = Window::from(routing);
    return window && !window->isDestroyed() ? DYNAMIC_DOWNCAST(CFrameWnd, window->object()) : nullptr;
}

CFrameWnd* AfxSetRoutingFrame(CFrameWnd* frame) {
    CFrameWnd* before = AfxGetRoutingFrame();
    routing = frame ? frame->m_hWnd : nullptr;
    return before;
}
