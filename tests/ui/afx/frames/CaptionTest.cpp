#include "tests/ui/afx/CaptionTesting.h"
#include "tests/ui/afx/frames/FrameTesting.h"

#include <QScreen>

using namespace captiontest;
using frametest::FrameTest;
using frametest::settle;

namespace {

class ProbeChild : public Probe<CMDIChildWnd> {
    DECLARE_DYNCREATE(ProbeChild)
};

IMPLEMENT_DYNCREATE(ProbeChild, CMDIChildWnd)

enum class Kind { TopLevel, Child };

/// A window of 300 by 200 that draws its caption itself; a child frame stands in front of another one.
class Caption : public FrameTest, public testing::WithParamInterface<Kind> {
protected:
    void SetUp() override {
        FrameTest::SetUp();
        if (isChild()) {
            frame = &openBoards();
            behind = frame->CreateNewChild(RUNTIME_CLASS(ProbeChild), IDR_TESTBOARD);
            behind->MoveWindow(0, 0, 300, 200);
            auto* child = static_cast<ProbeChild*>(frame->CreateNewChild(RUNTIME_CLASS(ProbeChild), IDR_TESTBOARD));
            child->MoveWindow(150, 10, 300, 200);
            use(*child, *child);
        } else {
            open(CRect(100, 80, 400, 280));
        }
    }
    [[nodiscard]] static bool isChild() {
        return GetParam() == Kind::Child;
    }
    void open(const CRect& place, DWORD style = WS_OVERLAPPEDWINDOW) {
        if (window) {
            AfxGetApp()->m_pMainWnd = nullptr; // its end is not the application's here
            window->DestroyWindow();
        }
        auto* top = new Probe<CFrameWnd>;
        top->Create(nullptr, "Caption", style, place, nullptr, nullptr, WS_EX_OWNCAPTION);
        CMenu bar;
        bar.CreateMenu();
        bar.AppendMenu(MF_STRING, 100, "&Do");
        top->SetMenu(&bar);
        bar.Detach();
        top->ShowWindow(SW_SHOW);
        EXPECT_TRUE(QTest::qWaitForWindowActive(&widgetOf(*top)));
        AfxGetApp()->m_pMainWnd = top;
        use(*top, *top);
    }
    void use(CFrameWnd& probe, Log& itsLog) {
        window = &probe;
        log = &itsLog;
        settle();
    }
    [[nodiscard]] QWidget& widget() const {
        return widgetOf(*window);
    }
    [[nodiscard]] QWindow* native() const {
        return widget().window()->windowHandle();
    }
    /// Points count in the widget's coordinates and may be outside of it.
    void moveTo(QPoint at) const {
        QTest::mouseMove(native(), widget().mapTo(widget().window(), at));
        settle();
    }
    void press(QPoint at, Qt::MouseButton button = Qt::LeftButton) const {
        moveTo(at);
        QTest::mousePress(native(), button, {}, widget().mapTo(widget().window(), at));
        settle();
    }
    void release(QPoint at, Qt::MouseButton button = Qt::LeftButton) const {
        QTest::mouseRelease(native(), button, {}, widget().mapTo(widget().window(), at));
        settle();
    }
    /// Drags to where that point of the window was before it moved; holds on there.
    void drag(QPoint from, QPoint by) const {
        const QPoint to = widget().mapToGlobal(from + by);
        press(from);
        moveTo(widget().mapFromGlobal(to));
    }
    /// What the screen shows of a window.
    static QImage shown(const CWnd& shownWindow) {
        settle();
        const QWidget& part = widgetOf(shownWindow);
        QWidget* top = part.window();
        QEvent update(QEvent::UpdateRequest);
        QApplication::sendEvent(top, &update);
        return top->screen()->grabWindow(top->winId()).toImage().copy(QRect(part.mapTo(top, QPoint()), part.size()));
    }
    static bool isRed(const CWnd& shownWindow, int x, int y) {
        return shown(shownWindow).pixel(x, y) == qRgb(255, 0, 0);
    }
    static void draw(CWnd& on, const CRect& rect) {
        CWindowDC dc(&on);
        dc.FillSolidRect(rect, RGB(255, 0, 0));
    }
    void expectSystemMenu(const char* by, const std::function<void()>& act) const {
        log->seen.clear();
        QTimer closer;
        std::string items;
        QObject::connect(&closer, &QTimer::timeout, &closer, [&] {
            if (QMenu* menu = frametest::openMenu()) {
                for (const QAction* action : menu->actions()) {
                    items += action->isSeparator() ? '-' : action->isEnabled() ? '1' : '0';
                }
                menu->close();
            }
        });
        closer.start(0);
        act();
        EXPECT_TRUE(QTest::qWaitFor([&] { return !items.empty() && !frametest::openMenu(); })) << by;
        EXPECT_EQ(items, window->IsZoomed() ? "10010-1" : "01111-1") << by;
        const std::vector<WPARAM> menus{reinterpret_cast<WPARAM>(window->GetSystemMenu(FALSE)->m_hMenu)};
        EXPECT_EQ(log->of(WM_INITMENU), menus) << by;
        EXPECT_EQ(log->of(WM_INITMENUPOPUP), menus) << by;
    }
    frametest::BoardsFrame* frame = nullptr;
    CFrameWnd* behind = nullptr;
    CFrameWnd* window = nullptr;
    Log* log = nullptr;
};

INSTANTIATE_TEST_SUITE_P(Of, Caption, testing::Values(Kind::TopLevel, Kind::Child));

const std::vector<int> row{HTTOPLEFT,   HTCAPTION, HTSYSMENU, HTCAPTION, HTMINBUTTON, HTCAPTION,
                           HTMAXBUTTON, HTCAPTION, HTCLOSE,   HTCAPTION, HTTOPRIGHT};

TEST_P(Caption, PartsAnswerTheirCodes) {
    const QRect rect = widget().rect();
    EXPECT_EQ(partsAlong(*window, QPoint(0, middleOf(*window, HTCLOSE).y()), QPoint(1, 0)), row);
    EXPECT_EQ(partsAlong(*window, rect.bottomLeft(), QPoint(1, 0)),
              (std::vector{HTBOTTOMLEFT, HTBOTTOM, HTBOTTOMRIGHT}));
    EXPECT_EQ(partsAlong(*window, QPoint(0, 0), QPoint(0, 1)), (std::vector{HTTOPLEFT, HTLEFT, HTBOTTOMLEFT}));
    std::vector<int> column{HTTOP, HTCAPTION, HTMENU, HTCLIENT, HTBOTTOM};
    if (isChild()) {
        std::erase(column, HTMENU);
    }
    EXPECT_EQ(partsAlong(*window, QPoint(150, 0), QPoint(0, 1)), column);
    window->ShowWindow(SW_SHOWMAXIMIZED);
    settle();
    EXPECT_EQ(partsAlong(*window, widget().rect().bottomLeft(), QPoint(1, 0)), std::vector{HTCLIENT});
    EXPECT_EQ(partAt(*window, QPoint(0, 0)), isChild() ? HTCLIENT : HTSYSMENU);
    EXPECT_EQ(partAt(*window, widget().rect().topRight()), isChild() ? HTCLIENT : HTCLOSE) << "a mouse that is thrown";
    window->ShowWindow(SW_RESTORE);
    if (isChild()) {
        window->ShowWindow(SW_MINIMIZE);
        settle();
        EXPECT_TRUE(middleOf(*window, HTMINBUTTON).x() > 0) << "which restores it";
        return;
    }
    widget().setLayoutDirection(Qt::RightToLeft);
    settle();
    EXPECT_LT(middleOf(*window, HTCLOSE).x(), middleOf(*window, HTSYSMENU).x());
    open(CRect(100, 80, 300, 200), WS_POPUP | WS_CAPTION);
    EXPECT_EQ(partsAlong(*window, QPoint(0, 10), QPoint(1, 0)), (std::vector{HTBORDER, HTCAPTION, HTBORDER}));
    open(CRect(100, 80, 101, 81));
    std::vector<int> crowded = row;
    crowded.erase(crowded.begin() + 3); // no title
    EXPECT_EQ(partsAlong(*window, QPoint(0, 12), QPoint(1, 0)), crowded) << "no button lies on another";
}

TEST_P(Caption, IsDrawnOnAtOnceAndWhenItIsPainted) {
    draw(*window, CRect(100, 6, 110, 14));
    EXPECT_TRUE(isRed(*window, 100, 6) && isRed(*window, 109, 13));
    EXPECT_FALSE(isRed(*window, 110, 13) || isRed(*window, 109, 14));
    window->SetWindowText("Other");
    EXPECT_FALSE(isRed(*window, 105, 8)) << "painted anew";
    log->on[WM_NCPAINT] = [this](LPARAM, LRESULT& result) {
        result = window->DefWindowProc(WM_NCPAINT, 1, 0);
        draw(*window, CRect(120, 6, 130, 14));
        draw(*window, CRect(160, 30, 168, 38)); // the menu bar of the one, the client area of the other
        return true;
    };
    for (const auto& ask : std::initializer_list<std::function<void()>>{
             [this] { window->SendMessage(WM_NCPAINT, 1); }, [this] { window->SetWindowText("Third"); },
             [this] { window->SendMessage(WM_NCACTIVATE, FALSE); }, [this] { widget().resize(320, 200); },
             [this] { window->SetIcon(::LoadIcon(nullptr, IDI_HAND), FALSE); }}) {
        ask();
        EXPECT_TRUE(isRed(*window, 125, 8));
        EXPECT_EQ(isRed(*window, 164, 34), !isChild());
    }
}

TEST_P(Caption, KeepsPixelsThatAreNotItsOwn) {
    if (!isChild()) {
        return;
    }
    draw(*behind, CRect(0, 0, 300, 200));
    EXPECT_TRUE(isRed(*behind, 100, 10));
    EXPECT_FALSE(isRed(*window, 5, 10)) << "the child frame in front";
    EXPECT_FALSE(isRed(*behind, 0, 0)) << "corners are round";
    EXPECT_FALSE(isRed(*behind, 50, 150)) << "what is inside";
    window->ShowWindow(SW_SHOWMAXIMIZED);
    settle();
    auto* bar = qobject_cast<QMenuBar*>(frametest::widgetOf(*frame)->menuWidget());
    const QRect buttons = bar->cornerWidget()->geometry().translated(bar->pos());
    const QPoint corner = frametest::widgetOf(*frame)->mapToGlobal(QPoint()) - placeOf(*frame).topLeft();
    const QRect drawn = buttons.adjusted(-40, 4, 0, -4).translated(corner);
    draw(*frame, CRect(drawn.left(), drawn.top(), drawn.right(), drawn.bottom()));
    EXPECT_TRUE(isRed(*frame, buttons.left() - 20, buttons.center().y()));
    EXPECT_FALSE(isRed(*frame, buttons.center().x(), buttons.center().y())) << "the child's buttons in the bar";
}

TEST_P(Caption, IsDrawnActiveAsTold) {
    const QPoint at(200, 8);
    const QRgb active = shown(*window).pixel(at);
    window->SendMessage(WM_NCACTIVATE, FALSE);
    const QRgb inactive = shown(*window).pixel(at);
    EXPECT_NE(active, inactive);
    window->DefWindowProc(WM_NCACTIVATE, TRUE, 0);
    log->on[WM_NCACTIVATE] = [](LPARAM, LRESULT&) { return true; };
    if (isChild()) {
        frame->MDIActivate(behind);
        EXPECT_EQ(shown(*behind).pixel(at), active);
    }
    CWnd other;
    other.CreateEx(0, AfxRegisterWndClass(0), "other", WS_OVERLAPPEDWINDOW | WS_VISIBLE, 600, 80, 100, 100, nullptr,
                   nullptr);
    EXPECT_TRUE(QTest::qWaitForWindowActive(&widgetOf(other)));
    EXPECT_EQ(log->of(WM_NCACTIVATE), std::vector<WPARAM>{FALSE});
    EXPECT_EQ(shown(*window).pixel(at), active) << "the host has refused";
    if (isChild()) {
        EXPECT_EQ(shown(*behind).pixel(at), inactive) << "the main frame is not active";
    }
}

TEST_P(Caption, ButtonsActWhereTheyAreReleased) {
    log->on[WM_SYSCOMMAND] = [](LPARAM, LRESULT&) { return true; };
    log->on[WM_CLOSE] = log->on[WM_SYSCOMMAND];
    moveTo(QPoint(150, 100));
    const QImage plain = shown(*window);
    for (const int part : {HTMINBUTTON, HTMAXBUTTON, HTCLOSE}) {
        const QPoint at = middleOf(*window, part);
        moveTo(at);
        EXPECT_NE(shown(*window), plain) << part << ": hovered";
        press(at);
        const QImage pressed = shown(*window);
        moveTo(QPoint(150, 100));
        EXPECT_NE(shown(*window), pressed) << part;
        release(QPoint(150, 100));
        EXPECT_EQ(log->of(WM_SYSCOMMAND), std::vector<WPARAM>{}) << part;
        moveTo(QPoint(150, 101));
        EXPECT_EQ(shown(*window), plain) << part;
    }
    if (!isChild()) {
        const auto* bar = qobject_cast<QMenuBar*>(frametest::widgetOf(*window)->menuWidget());
        moveTo(bar->geometry().topLeft() + bar->actionGeometry(bar->actions().front()).center());
        EXPECT_EQ(bar->activeAction(), bar->actions().front()) << "moves over it are the menu bar's";
    }
    press(middleOf(*window, HTCLOSE));
    release(middleOf(*window, HTCLOSE));
    EXPECT_EQ(log->of(WM_SYSCOMMAND), std::vector<WPARAM>{SC_CLOSE});
    log->on.clear();
    for (const bool zoomed : {true, false}) {
        QTest::mouseDClick(native(), Qt::LeftButton, {}, widget().mapTo(widget().window(), QPoint(120, 10)));
        settle();
        EXPECT_EQ(window->IsZoomed() != FALSE, zoomed);
        if (isChild()) {
            break; // its caption is not there to be clicked again
        }
    }
}

TEST_P(Caption, PressesAreTheHostsFirst) {
    const QRect before = placeOf(*window);
    QPoint released;
    log->on[WM_NCLBUTTONDOWN] = [this](LPARAM, LRESULT&) { return window->SetCapture() == nullptr; };
    log->on[WM_LBUTTONUP] = [&](LPARAM at, LRESULT&) {
        released = window->GetState()->clientToScreen(pointOf(at));
        return ReleaseCapture() != FALSE;
    };
    const QPoint outside = widget().mapToGlobal(QPoint(-80, -40));
    drag(QPoint(120, 10), QPoint(-200, -50));
    release(QPoint(-80, -40));
    EXPECT_EQ(released, outside);
    EXPECT_EQ(placeOf(*window), before);
    log->on.clear();
    // Where the host says so, the client area moves the window as the caption does; Esc takes it back.
    log->on[WM_NCHITTEST] = [this](LPARAM at, LRESULT& result) {
        const int part = window->GetState()->hitTest(pointOf(at));
        result = part == HTCLIENT ? HTCAPTION : part;
        return true;
    };
    for (const QPoint from : {QPoint(120, 10), QPoint(120, 100)}) {
        drag(from, QPoint(-30, 20));
        EXPECT_EQ(placeOf(*window), before.translated(-30, 20));
        release(from);
        EXPECT_EQ(CWnd::GetCapture(), nullptr);
        drag(from, QPoint(30, -20));
        release(from);
        EXPECT_EQ(placeOf(*window), before);
    }
    drag(QPoint(120, 100), QPoint(2, 2));
    EXPECT_EQ(placeOf(*window), before) << "a click that wobbles";
    drag(QPoint(120, 100), QPoint(40, 30));
    EXPECT_EQ(placeOf(*window), before.translated(40, 30));
    QTest::keyClick(native(), Qt::Key_Escape);
    settle();
    EXPECT_EQ(placeOf(*window), before);
    EXPECT_EQ(CWnd::GetCapture(), nullptr);
}

TEST_P(Caption, KeepsToItsLimitsWhenItIsSized) {
    window->ShowWindow(SW_HIDE);
    log->on[WM_GETMINMAXINFO] = [](LPARAM info, LRESULT&) {
        auto& limits = *reinterpret_cast<MINMAXINFO*>(info);
        limits.ptMinTrackSize = {250, 150};
        limits.ptMaxTrackSize = {350, 250};
        return true;
    };
    window->ShowWindow(SW_SHOW);
    settle();
    const QRect before = placeOf(*window);
    const QRect home = widget().geometry();
    struct Drag {
        QPoint from;
        QPoint by;
        QRect after;
    };
    const Drag drags[] = {{{0, 100}, {30, 90}, before.adjusted(30, 0, 0, 0)},
                          {{0, 100}, {300, 0}, before.adjusted(50, 0, 0, 0)},
                          {{0, 100}, {-90, 0}, before.adjusted(-50, 0, 0, 0)},
                          {{299, 199}, {-20, -30}, before.adjusted(0, 0, -20, -30)},
                          {{299, 199}, {-200, -200}, before.adjusted(0, 0, -50, -50)},
                          {{6, 1}, {250, 150}, before.adjusted(50, 50, 0, 0)}};
    for (const Drag& each : drags) {
        drag(each.from, each.by);
        EXPECT_EQ(placeOf(*window), each.after) << each.from.x() << " by " << each.by.x();
        release(each.from);
        window->MoveWindow(home.x(), home.y(), home.width(), home.height());
        settle();
    }
}

TEST_P(Caption, OpensTheSystemMenu) {
    log->on = {{WM_INITMENU, nullptr}, {WM_INITMENUPOPUP, nullptr}};
    window->GetSystemMenu(FALSE)->AppendMenu(MF_STRING, 0x9000, "&More");
    window->GetSystemMenu(TRUE);
    const Qt::Key letter = isChild() ? Qt::Key_Minus : Qt::Key_Space;
    for (const UINT command : {SC_RESTORE, SC_MAXIMIZE}) {
        window->SendMessage(WM_SYSCOMMAND, command);
        settle();
        expectSystemMenu("keys", [&] { QTest::keyClick(native(), letter, Qt::AltModifier); });
        if (isChild() && window->IsZoomed()) {
            continue;
        }
        expectSystemMenu("icon", [&] { press(middleOf(*window, HTSYSMENU)); });
        expectSystemMenu("right button", [&] {
            press(QPoint(120, 12), Qt::RightButton);
            release(QPoint(120, 12), Qt::RightButton);
        });
    }
}

} // namespace
