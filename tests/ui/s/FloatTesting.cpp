#include "tests/ui/s/FloatTesting.h"

#include "platform/afx/core/detail/Window.h"

namespace frametest {

std::string throwsIn;

namespace {

void mayThrow(const char* place) {
    if (throwsIn == place) {
        throwsIn.clear();
        throw std::runtime_error(place);
    }
}

/// Notes a hook that was called, and throws where it is told to.
void reach(const char* hook, const char* journalled) {
    note(journalled);
    mayThrow(hook);
}

} // namespace

// --- the view ---

IMPLEMENT_DYNCREATE(PadView, NoteView)

std::function<void()> PadView::whenActivated;

void PadView::OnInitialUpdate() {
    NoteView::OnInitialUpdate();
    edit.Create(WS_CHILD | WS_VISIBLE | ES_MULTILINE | WS_VSCROLL, CRect(0, 0, 150, 60), this, 7);
}

void PadView::OnActivateView(BOOL activate, CView* activated, CView* deactivated) {
    NoteView::OnActivateView(activate, activated, deactivated);
    mayThrow(activate ? "activated" : "deactivated");
    if (activate && whenActivated) {
        std::exchange(whenActivated, nullptr)();
    }
}

// --- the frames ---

IMPLEMENT_DYNCREATE(PadFrame, Gui_FloatChildFrame)
IMPLEMENT_DYNCREATE(PadWindow, Gui_ExternFrame)

PadFrame::PadFrame() {
    SetRipResourceId(IDR_TESTMAIN);
    SetRipOutFrame(RUNTIME_CLASS(PadWindow));
}

void PadFrame::PreSetActiveView(CView* view) {
    reach("child before", GetActiveView() ? "child before: has a view" : "child before");
}

void PadFrame::PostSetActiveView(CView* view) {
    reach("child after", GetActiveView() == view ? "child after" : "child after: no view");
}

bool PadWindow::failsStatusBar = false;

int PadWindow::CreateStatusBar() {
    return failsStatusBar ? 0 : Gui_ExternFrame::CreateStatusBar();
}

void PadWindow::PreLoadFrame(CView*) {
    reach("load before", m_hWnd ? "load before: has a window" : "load before");
}

void PadWindow::PostLoadFrame(CView*) {
    reach("load after", m_hWnd ? "load after" : "load after: no window");
}

void PadWindow::PreSetActiveView(CView* view) {
    reach("set before", view->GetParentFrame() == this ? "set before: has the view" : "set before");
}

void PadWindow::PostSetActiveView(CView* view) {
    reach("set after", view->GetParentFrame() == this && GetActiveView() == view ? "set after" : "set after: no view");
}

// clang-format off
BEGIN_MESSAGE_MAP(PadMain, Gui_FloatMainFrame)
    ON_COMMAND(ID_TEST_ORPHAN, &PadMain::OnOrphan)
END_MESSAGE_MAP()
// clang-format on

void PadMain::OnOrphan() {
    note("main");
}

// --- set-up ---

void FloatTest::SetUp() {
    FrameTest::SetUp();
    PadView::whenActivated = nullptr;
    throwsIn.clear();
    PadWindow::failsStatusBar = false;
    Gui_ExternFrame::SetCloseAction(Gui_ExternFrame::CloseAction::Close);
    CWinApp& app = *AfxGetApp();
    app.AddDocTemplate(
        new CMultiDocTemplate(IDR_TESTBOARD, RUNTIME_CLASS(Note), RUNTIME_CLASS(PadFrame), RUNTIME_CLASS(PadView)));
    main = new PadMain;
    ASSERT_TRUE(main->LoadFrame(IDR_TESTMAIN));
    app.m_pMainWnd = main;
    main->MoveWindow(0, 0, 700, 500);
    main->ShowWindow(SW_SHOW);
    ASSERT_TRUE(QTest::qWaitForWindowActive(widgetOf(*main)));
    settle();
}

PadFrame& FloatTest::open() {
    AfxGetApp()->OnFileNew();
    settle();
    idle();
    return *active();
}

PadFrame* FloatTest::active() const {
    return static_cast<PadFrame*>(main->MDIGetActive());
}

PadWindow& FloatTest::floated(PadFrame& frame) {
    frame.GetFloatHelp().RipOutView();
    auto& window = static_cast<PadWindow&>(*Gui_ExternFrame::GetAll().back());
    EXPECT_TRUE(QTest::qWaitForWindowActive(widgetOf(window)));
    settle();
    idle();
    return window;
}

namespace {

/// What of a frame lies at a point of the screen: its menu bar, for a button in that.
QWidget& under(const CWnd& frame, QPoint at) {
    QWidget* widget = frame.GetState()->widget();
    QWidget* child = widget->childAt(widget->mapFromGlobal(at));
    return qobject_cast<QMenuBar*>(child) ? *child : *widget;
}

} // namespace

void FloatTest::press(const CWnd& frame, CPoint at) {
    QWidget& widget = under(frame, QPoint(at.x, at.y));
    QTest::mousePress(&widget, Qt::LeftButton, Qt::NoModifier, widget.mapFromGlobal(QPoint(at.x, at.y)));
    settle();
}

void FloatTest::release(const CWnd& frame, CPoint at) {
    QWidget& widget = under(frame, QPoint(at.x, at.y));
    QTest::mouseRelease(&widget, Qt::LeftButton, Qt::NoModifier, widget.mapFromGlobal(QPoint(at.x, at.y)));
    settle();
}

} // namespace frametest
