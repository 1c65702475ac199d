#include "s/FloatHelp.h"

#include "res/resource.h"
#include "s/ExternFrame.h"
#include "s/FloatChildFrame.h"
#include "s/FloatMainFrame.h"
#include "s/FloatPlaces.h"

#include <exception>
#include <memory>

// How a view gets a window of its own, and how it comes back.

namespace {

/// The control that has the keyboard within a view: it keeps it while the view moves.
HWND focusWithin(const CView& view) {
    const HWND focus = ::GetFocus();
    return focus && (focus == view.m_hWnd || ::IsChild(view.m_hWnd, focus)) ? focus : nullptr;
}

void giveFocusBack(HWND focus, HWND view) {
    if (focus && ::IsWindow(view) && (focus == view || ::IsChild(view, focus))) {
        ::SetFocus(focus);
    }
}

/// Ends a frame that got no view, whatever a hook of it threw.
struct EndFrame {
    void operator()(CFrameWnd* frame) const {
        if (frame->m_hWnd) {
            frame->DestroyWindow();
        } else {
            delete frame;
        }
    }
};
using NewFrame = std::unique_ptr<CFrameWnd, EndFrame>;

/// What a host's code throws while a view is between two frames: it waits until the move is complete.
class Thrown {
public:
    template <class Step>
    void from(const Step& step) {
        try {
            step();
        } catch (...) {
            m_first = m_first ? m_first : std::current_exception();
        }
    }
    void pass() const {
        if (m_first) {
            std::rethrow_exception(m_first);
        }
    }

private:
    std::exception_ptr m_first;
};

/// Puts a view into a frame directly from the one that has it: without a window in between that stands alone.
/// @return the window of the new frame, which holds itself from now on
HWND give(CView& view, CFrameWnd& from, NewFrame to, Thrown& thrown) {
    thrown.from([&] { from.SetActiveView(nullptr); });
    view.SetParent(to.get());
    CFrameWnd* frame = to.release();
    thrown.from([&] { frame->SetActiveView(&view); });
    return frame->m_hWnd;
}

void copyIcons(const CFrameWnd& from, CFrameWnd& to) {
    for (const BOOL big : {TRUE, FALSE}) {
        if (const HICON icon = from.GetIcon(big)) {
            to.SetIcon(icon, big);
        }
    }
}

/// Shows the window that has got the view in place of its former frame.
void takePlace(CFrameWnd& frame, const CFrameWnd& former, unsigned int resourceId) {
    CString title;
    former.GetWindowText(title);
    frame.SetWindowText(title);
    copyIcons(former, frame);
    if (auto* main = DYNAMIC_DOWNCAST(CFrameWnd, AfxGetMainWnd())) {
        main->SetActiveView(nullptr);
    }
    CRect place;
    former.GetWindowRect(&place);
    FloatPlaces::show(frame, resourceId, place);
    frame.RecalcLayout();
}

/// Ends a frame whose view has gone elsewhere.
void end(HWND frame) {
    if (CWnd* window = CWnd::FromHandlePermanent(frame)) {
        window->DestroyWindow();
    }
}

/// Lays out the frame that has got the view, and brings the main window to the user's eyes: it may be an icon.
void present(HWND frame) {
    auto* window = DYNAMIC_DOWNCAST(CFrameWnd, CWnd::FromHandlePermanent(frame));
    if (!window) {
        return;
    }
    window->RecalcLayout();
    if (CFrameWnd* top = window->GetTopLevelFrame()) {
        top->ActivateFrame();
        top->SetForegroundWindow();
    }
}

} // namespace

/// While windows are being activated, their frames must not go: the move is asked for again when that is done.
bool Gui_FloatHelp::isPutOff() {
    if (!AfxIsActivating()) {
        return false;
    }
    m_owner->PostMessage(WM_SYSCOMMAND, m_isRipOut ? GUI_ID_FLOAT_WINDOW : GUI_ID_DOCK_WINDOW);
    return true;
}

void Gui_FloatHelp::RipOutView() {
    if (!m_owner || !m_isEnabled || isPutOff()) {
        return;
    }
    CFrameWnd* from = source();
    CView* view = GetFramesView(from);
    // Those of a child frame, for the main window: copied, because the child frame goes.
    const Gui_FloatHelp by(settings());
    if (view && by.m_isEnabled && IsValidResourceId(by.m_resourceId)) {
        by.floatView(*from, *view);
    }
}

/// By the settings of this object; whose owner plays no part.
void Gui_FloatHelp::floatView(CFrameWnd& from, CView& view) const {
    CObject* made = m_ripOutFrame ? m_ripOutFrame->CreateObject() : nullptr;
    auto* frame = DYNAMIC_DOWNCAST(Gui_ExternFrame, made);
    if (!frame) {
        delete made;
        return;
    }
    frame->SetRipResourceId(m_resourceId);
    NewFrame owner(frame);
    frame->PreLoadFrame(&view);
    constexpr DWORD style = WS_OVERLAPPEDWINDOW | FWS_ADDTOTITLE;
    if (!owner.release()->LoadFrame(m_resourceId, style)) {
        return; // it has deleted itself
    }
    owner.reset(frame);
    frame->PostLoadFrame(&view);
    frame->PreSetActiveView(&view);
    const HWND focus = focusWithin(view);
    const HWND former = from.m_hWnd;
    Thrown thrown;
    const HWND fresh = give(view, from, std::move(owner), thrown);
    const HWND moved = view.m_hWnd;
    thrown.from([&] { frame->PostSetActiveView(&view); });
    if (::IsWindow(fresh) && ::IsWindow(former)) {
        takePlace(*frame, from, m_resourceId);
    }
    end(former);
    giveFocusBack(focus, moved);
    ::PostMessage(fresh, WM_ACTIVATE, WA_ACTIVE, 0);
    thrown.pass();
}

void Gui_FloatHelp::UnripView() {
    if (!m_owner || !m_isEnabled || isPutOff()) {
        return;
    }
    if (CView* view = GetFramesView(m_owner)) {
        const Gui_FloatHelp by(*this); // this object goes with its frame
        by.dockView(*view);
    }
}

void Gui_FloatHelp::dockView(CView& view) const {
    const HWND focus = focusWithin(view); // before the new frame comes up
    CDocument* document = view.GetDocument();
    CDocTemplate* kind = document ? document->GetDocTemplate() : nullptr;
    CFrameWnd* frame = kind ? kind->CreateNewFrame(document, nullptr) : nullptr;
    if (!frame) {
        return;
    }
    NewFrame owner(frame);
    copyIcons(*m_owner, *frame);
    auto* child = DYNAMIC_DOWNCAST(Gui_FloatChildFrame, frame);
    if (child) {
        if (auto* book = DYNAMIC_DOWNCAST(Gui_FloatMainFrame, child->GetMDIFrame())) {
            book->SetSheetIcon(child, m_owner->GetIcon(FALSE), TRUE);
        }
        child->SetRipResourceId(m_resourceId);
    }
    kind->InitialUpdateFrame(frame, nullptr, TRUE);
    if (CWnd* templates = frame->GetDescendantWindow(AFX_IDW_PANE_FIRST, TRUE)) {
        templates->DestroyWindow();
    }
    if (child) {
        child->PreSetActiveView(&view);
    }
    const HWND former = m_owner->m_hWnd;
    Thrown thrown;
    const HWND fresh = give(view, *m_owner, std::move(owner), thrown);
    const HWND moved = view.m_hWnd;
    if (child) {
        thrown.from([&] { child->PostSetActiveView(&view); });
    }
    end(former);
    present(fresh);
    document->UpdateFrameCounts();
    giveFocusBack(focus, moved);
    thrown.pass();
}
