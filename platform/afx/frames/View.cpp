#include "platform/afx/frames/View.h"

#include "platform/afx/core/App.h"
#include "platform/afx/core/detail/Window.h"
#include "platform/afx/frames/Document.h"
#include "platform/afx/gdi/Dc.h"
#include "platform/win/FrameworkIds.h"

#include <QWidget>

using namespace tvx::afx;

IMPLEMENT_DYNAMIC(CView, CWnd)

// clang-format off
BEGIN_MESSAGE_MAP(CView, CWnd)
    ON_WM_CREATE()
    ON_WM_DESTROY()
    ON_WM_PAINT()
    ON_WM_MOUSEACTIVATE()
    ON_MESSAGE(WM_INITIALUPDATE, &CView::OnInitialUpdateMessage)
END_MESSAGE_MAP()
// clang-format on

CView::~CView() {
    if (m_pDocument) {
        m_pDocument->RemoveView(this);
    }
}

BOOL CView::PreCreateWindow(CREATESTRUCT& cs) {
    if (!cs.lpszClass) {
        cs.lpszClass = AfxRegisterWndClass(CS_DBLCLKS, ::LoadCursorA(nullptr, IDC_ARROW),
                                           reinterpret_cast<HBRUSH>(static_cast<INT_PTR>(COLOR_WINDOW + 1)));
    }
    // Frames ask for a plain border; views wear it sunken.
    if ((cs.style & WS_BORDER) != 0) {
        cs.dwExStyle |= WS_EX_CLIENTEDGE;
        cs.style &= ~WS_BORDER;
    }
    return TRUE;
}

void CView::PostNcDestroy() {
    delete this;
}

int CView::OnCreate(CREATESTRUCT* cs) {
    if (CWnd::OnCreate(cs) == -1) {
        return -1;
    }
    const auto* context = static_cast<CCreateContext*>(cs->lpCreateParams);
    if (context && context->m_pCurrentDoc) {
        context->m_pCurrentDoc->AddView(this);
    }
    return 0;
}

void CView::OnDestroy() {
    CFrameWnd* frame = GetParentFrame();
    if (frame && frame->GetActiveView() == this) {
        frame->SetActiveView(nullptr);
    }
    CWnd::OnDestroy();
}

LRESULT CView::OnInitialUpdateMessage(WPARAM, LPARAM) {
    OnInitialUpdate();
    return 0;
}

void CView::OnInitialUpdate() {
    OnUpdate(nullptr, 0, nullptr);
}

void CView::OnUpdate(CView*, LPARAM, CObject*) {
    Invalidate(TRUE);
}

void CView::OnPrepareDC(CDC*, CPrintInfo*) {}

void CView::OnPaint() {
    CPaintDC dc(this);
    OnPrepareDC(&dc);
    OnDraw(&dc);
}

// --- printing ---

void CView::OnFilePrint() {
    CPrintInfo info;
    OnPreparePrinting(&info);
}

void CView::OnFilePrintPreview() {
    CPrintInfo info;
    OnPreparePrinting(&info);
}

BOOL CView::OnPreparePrinting(CPrintInfo* info) {
    return DoPreparePrinting(info);
}

BOOL CView::DoPreparePrinting(CPrintInfo*) {
    AfxMessageBox(TVX_IDS_NO_PRINTER, MB_OK | MB_ICONINFORMATION);
    return FALSE;
}

void CView::OnPrint(CDC* dc, CPrintInfo*) {
    OnDraw(dc);
}

CScrollBar* CView::GetScrollBarCtrl(int bar) const {
    return CWnd::GetScrollBarCtrl(bar);
}

// --- activation ---

void CView::OnActivateView(BOOL activate, CView* activated, CView* deactivated) {
    const Window* state = GetState();
    if (!activate || !state) {
        return;
    }
    // When its frame comes back, the keyboard goes where it was, be that a control in a bar.
    const QWidget* top = state->widget()->window();
    const Window* remembered = Window::of(top->focusWidget());
    if (activated == deactivated && remembered && remembered != Window::of(top)) {
        return;
    }
    SetFocus();
}

void CView::OnActivateFrame(UINT, CFrameWnd*) {}

int CView::OnMouseActivate(CWnd* desktop, UINT hitTest, UINT message) {
    const int answer = CWnd::OnMouseActivate(desktop, hitTest, message);
    if (answer == MA_NOACTIVATE || answer == MA_NOACTIVATEANDEAT) {
        return answer;
    }
    CFrameWnd* frame = GetParentFrame();
    if (!frame) {
        return answer;
    }
    const HWND focus = ::GetFocus();
    if (frame->GetActiveView() != this) {
        frame->SetActiveView(this);
    } else if (focus != m_hWnd && !::IsChild(m_hWnd, focus)) {
        OnActivateView(TRUE, this, nullptr);
    }
    return answer;
}

BOOL CView::OnCmdMsg(UINT id, int code, void* extra, AFX_CMDHANDLERINFO* info) {
    if (CWnd::OnCmdMsg(id, code, extra, info)) {
        return TRUE;
    }
    return m_pDocument ? m_pDocument->OnCmdMsg(id, code, extra, info) : FALSE;
}
