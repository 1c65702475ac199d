#include "s/FloatHelp.h"

#include "res/resource.h"
#include "s/ExternFrame.h"
#include "s/FloatChildFrame.h"
#include "s/FrameTheme.h"
#include "s/StringOf.h"

#include <algorithm>
#include <utility>

// What a Gui_FloatHelp is set up with, its button's place and what the mouse does to it. The moves are in
// FloatMove.cpp, the drawing is in FloatButton.cpp.

Gui_FloatHelp::Gui_FloatHelp() : m_ripOutFrame(RUNTIME_CLASS(Gui_ExternFrame)) {}

Gui_FloatHelp::~Gui_FloatHelp() = default;

void Gui_FloatHelp::SetIsRipOut(bool isRipOut) {
    m_isRipOut = isRipOut;
}

void Gui_FloatHelp::SetOwner(CFrameWnd* owner) {
    m_owner = owner;
}

void Gui_FloatHelp::SetRipOutFrame(CRuntimeClass* frameClass) {
    m_ripOutFrame = frameClass;
}

CRuntimeClass* Gui_FloatHelp::GetRipOutFrame() const {
    return m_ripOutFrame;
}

void Gui_FloatHelp::SetResourceId(unsigned int id) {
    m_resourceId = id;
}

unsigned int Gui_FloatHelp::GetResourceId() {
    return m_resourceId;
}

bool Gui_FloatHelp::HasValidResourceId() {
    return IsValidResourceId(m_resourceId);
}

bool Gui_FloatHelp::IsValidResourceId(unsigned int id) {
    return id != 0xFFFFFFFF;
}

void Gui_FloatHelp::SetEnabled(bool enabled) {
    m_isEnabled = enabled;
}

bool Gui_FloatHelp::IsEnabled() const {
    return m_isEnabled;
}

// --- whose view, by whose settings ---

bool Gui_FloatHelp::isMainWindow() const {
    return m_owner && m_owner == AfxGetMainWnd();
}

/// The frame that a view is taken from: the main window offers the button for its active child frame.
CFrameWnd* Gui_FloatHelp::source() const {
    if (!m_isRipOut || !isMainWindow()) {
        return m_owner;
    }
    const auto* main = DYNAMIC_DOWNCAST(CMDIFrameWnd, m_owner);
    return main ? main->MDIGetActive() : nullptr;
}

/// Of a view that the main window floats, the child frame knows the resources and the class.
const Gui_FloatHelp& Gui_FloatHelp::settings() const {
    const auto* child = DYNAMIC_DOWNCAST(Gui_FloatChildFrame, source());
    return child ? child->GetFloatHelp() : *this;
}

CView* Gui_FloatHelp::GetFramesView(CFrameWnd* frame) {
    CWnd* at = frame ? frame->GetActiveView() : nullptr;
    while (at && at->GetParent() != frame) {
        at = at->GetParent();
    }
    return DYNAMIC_DOWNCAST(CView, at);
}

bool Gui_FloatHelp::CanMove() {
    const Gui_FloatHelp& by = settings();
    return m_isEnabled && by.m_isEnabled && GetFramesView(source()) &&
           (!m_isRipOut || IsValidResourceId(by.m_resourceId));
}

void Gui_FloatHelp::Move() {
    if (m_isRipOut) {
        RipOutView();
    } else {
        UnripView();
    }
}

// --- the button ---

/// Not where nothing would move: no button without resources, and none in a caption that is not seen.
bool Gui_FloatHelp::isShown() const {
    if (!m_owner || !m_owner->m_hWnd) {
        return false;
    }
    if (!m_isRipOut) {
        return true;
    }
    const CFrameWnd* from = source();
    return from && from->IsZoomed() == (isMainWindow() ? TRUE : FALSE) && IsValidResourceId(settings().m_resourceId);
}

namespace {

/// A fourth button left of minimise, maximise and close, by the measures of captions alone. Menu bars may be lower than
/// captions: what is below them belongs to other windows.
CRect classicPlace(const CRect& window, bool inMenuBar) {
    const int width = ::GetSystemMetrics(SM_CXSIZE);
    const int height = ::GetSystemMetrics(SM_CYSIZE);
    const int caption = ::GetSystemMetrics(SM_CYCAPTION);
    const int right = window.right - 3 * width - 2 * ::GetSystemMetrics(SM_CXBORDER) - ::GetSystemMetrics(SM_CXFRAME);
    const int top = window.top + ::GetSystemMetrics(SM_CYFRAME) + (caption - height) / 2 + (inMenuBar ? caption : 0);
    const int barEnd = window.top + ::GetSystemMetrics(SM_CYFRAME) + caption + ::GetSystemMetrics(SM_CYMENU);
    return {right - width, top, right, inMenuBar ? std::min(top + height, barEnd) : top + height};
}

} // namespace

void Gui_FloatHelp::GetButtonRect(CRect& rect, bool onScreen) {
    const Gui_FrameTheme* theme = Gui_FrameTheme::current();
    if (theme && Gui_FrameTheme::isSwitchedOn() && AfxGetMainWnd()) {
        rect = theme->buttonPlace(*m_owner, onScreen);
        // Without a minimise button in the main window, the style has measured nothing.
        if (!rect.IsRectEmpty()) {
            return;
        }
    }
    CRect window;
    m_owner->GetWindowRect(&window);
    if (!onScreen) {
        window.OffsetRect(-window.left, -window.top);
    }
    rect = classicPlace(window, isMainWindow());
}

/// Tells assistive tools of the button, and keeps the caption's title clear of it.
void Gui_FloatHelp::announce() {
    CString name = StringOf(m_isRipOut ? GUI_IDS_FLOAT_WINDOW : GUI_IDS_DOCK_WINDOW);
    name.Remove('&');
    CRect place;
    const bool shown = isShown();
    if (shown) {
        GetButtonRect(place, false);
    }
    m_owner->SetFrameButton(name, shown ? &place : nullptr, m_isRipOut ? GUI_ID_FLOAT_WINDOW : GUI_ID_DOCK_WINDOW);
}

int Gui_FloatHelp::OnNcLButtonDown(unsigned int, CPoint point) {
    CRect place;
    if (!isShown()) {
        return 0;
    }
    GetButtonRect(place, true);
    if (!place.PtInRect(point)) {
        return 0;
    }
    m_isPushed = true;
    drawButton(m_isRipOut);
    m_owner->SetCapture();
    return 1;
}

int Gui_FloatHelp::OnNcLButtonUp(unsigned int, CPoint point) {
    const bool wasPushed = m_isPushed;
    m_isPushed = false;
    if (CWnd::GetCapture() == m_owner) {
        ::ReleaseCapture();
    }
    if (!m_owner || !isShown()) {
        return 0;
    }
    drawButton(m_isRipOut);
    CRect place;
    GetButtonRect(place, true);
    if (!wasPushed || !place.PtInRect(point)) {
        return 0;
    }
    Move();
    return 1;
}

void Gui_FloatHelp::CancelPress() {
    if (std::exchange(m_isPushed, false)) {
        drawButton(m_isRipOut);
    }
}
