#include "tests/ui/afx/CaptionTesting.h"

#include <QMenu>
#include <QMenuBar>

#include <gtest/gtest.h>

using namespace captiontest;

namespace {

constexpr COLORREF plainRed = RGB(255, 0, 0);
const QRgb red = qRgb(255, 0, 0);

class Caption : public testing::Test {
protected:
    Caption() {
        open(CRect(100, 80, 500, 380));
    }
    ~Caption() override {
        window.DestroyWindow();
        settle();
    }
    void open(const CRect& place, DWORD style = WS_OVERLAPPEDWINDOW) {
        window.DestroyWindow();
        window.CreateEx(WS_EX_OWNCAPTION, AfxRegisterWndClass(CS_DBLCLKS), "Caption", style, place, nullptr, 0);
        window.ShowWindow(SW_SHOW);
        EXPECT_TRUE(QTest::qWaitForWindowActive(&window.widget()));
        settle();
        window.seen.clear();
    }
    [[nodiscard]] QRect place() const {
        CRect rect;
        window.GetWindowRect(rect);
        return QRect(rect.left, rect.top, rect.Width(), rect.Height());
    }
    Probe<CWnd> window;
};

TEST_F(Caption, PartsAnswerTheirCodes) {
    const QRect rect = window.widget().rect();
    const int line = middleOf(window, HTCLOSE).y();
    const std::vector<int> row{HTTOPLEFT,   HTCAPTION, HTSYSMENU, HTCAPTION, HTMINBUTTON, HTCAPTION,
                               HTMAXBUTTON, HTCAPTION, HTCLOSE,   HTCAPTION, HTTOPRIGHT};
    EXPECT_EQ(partsAlong(window, QPoint(0, line), QPoint(1, 0)), row);
    EXPECT_EQ(partsAlong(window, QPoint(0, 0), QPoint(1, 0)), (std::vector{HTTOPLEFT, HTTOP, HTTOPRIGHT}));
    EXPECT_EQ(partsAlong(window, rect.bottomLeft(), QPoint(1, 0)),
              (std::vector{HTBOTTOMLEFT, HTBOTTOM, HTBOTTOMRIGHT}));
    EXPECT_EQ(partsAlong(window, QPoint(0, 0), QPoint(0, 1)), (std::vector{HTTOPLEFT, HTLEFT, HTBOTTOMLEFT}));
    EXPECT_EQ(partsAlong(window, rect.center(), QPoint(1, 0)), (std::vector{HTCLIENT, HTRIGHT}));
    CMenu bar;
    bar.CreateMenu();
    bar.AppendMenu(MF_STRING, 100, "&Do");
    window.SetMenu(&bar);
    bar.Detach();
    settle();
    EXPECT_EQ(partsAlong(window, QPoint(200, 0), QPoint(0, 1)),
              (std::vector{HTTOP, HTCAPTION, HTMENU, HTCLIENT, HTBOTTOM}));
    window.ShowWindow(SW_SHOWMAXIMIZED);
    settle();
    EXPECT_EQ(partAt(window, QPoint(0, 0)), HTSYSMENU);
    EXPECT_EQ(partAt(window, window.widget().rect().topRight()), HTCLOSE) << "where a mouse ends up that is thrown";
    EXPECT_EQ(partsAlong(window, window.widget().rect().bottomLeft(), QPoint(1, 0)), std::vector{HTCLIENT});
    window.ShowWindow(SW_RESTORE);
    window.widget().setLayoutDirection(Qt::RightToLeft);
    settle();
    EXPECT_EQ(partsAlong(window, QPoint(rect.right(), line), QPoint(-1, 0)).size(), row.size());
    EXPECT_LT(middleOf(window, HTCLOSE).x(), middleOf(window, HTSYSMENU).x());
    open(CRect(100, 80, 300, 200), WS_POPUP | WS_CAPTION);
    EXPECT_EQ(partsAlong(window, QPoint(0, line), QPoint(1, 0)), (std::vector{HTBORDER, HTCAPTION, HTBORDER}));
    open(CRect(100, 80, 101, 81));
    EXPECT_EQ(partsAlong(window, QPoint(0, line), QPoint(1, 0)),
              (std::vector{HTTOPLEFT, HTCAPTION, HTSYSMENU, HTMINBUTTON, HTCAPTION, HTMAXBUTTON, HTCAPTION, HTCLOSE,
                           HTCAPTION, HTTOPRIGHT}))
        << "no button lies on another";
}

TEST_F(Caption, IsDrawnOnAtOnceAndWhenItIsPainted) {
    const auto draw = [this](int x) {
        CWindowDC dc(&window);
        dc.FillSolidRect(x, 2, 10, 12, plainRed);
    };
    CMenu bar;
    bar.CreateMenu();
    bar.AppendMenu(MF_STRING, 100, "&Do");
    window.SetMenu(&bar);
    bar.Detach();
    settle();
    draw(200);
    const auto isRed = [this](int x, int y) { return shown(window.widget()).pixel(x, y) == red; };
    EXPECT_TRUE(isRed(200, 2) && isRed(209, 13));
    EXPECT_FALSE(isRed(210, 13) || isRed(209, 14));
    window.SetWindowText("Other");
    EXPECT_FALSE(isRed(205, 8)) << "painted anew";
    window.on[WM_NCPAINT] = [&](LPARAM, LRESULT& result) {
        result = window.DefWindowProc(WM_NCPAINT, 1, 0);
        draw(220);
        const QRect menu = qobject_cast<QMainWindow*>(&window.widget())->menuWidget()->geometry();
        CWindowDC dc(&window);
        dc.FillSolidRect(300, menu.top() + 3, 8, 8, plainRed);
        return true;
    };
    const int menuLine = qobject_cast<QMainWindow*>(&window.widget())->menuWidget()->geometry().top() + 5;
    for (const auto& ask : std::initializer_list<std::function<void()>>{
             [&] { window.SendMessage(WM_NCPAINT, 1); }, [&] { window.SetWindowText("Third"); },
             [&] { window.SendMessage(WM_NCACTIVATE, FALSE); }, [&] { window.widget().resize(420, 300); },
             [&] { window.SetIcon(::LoadIcon(nullptr, IDI_HAND), FALSE); },
             [&] { qobject_cast<QMainWindow*>(&window.widget())->menuWidget()->update(); }}) {
        ask();
        EXPECT_TRUE(isRed(225, 8) && isRed(304, menuLine));
    }
    // Nothing is left where the window's own parts end.
    window.on.clear();
    window.RedrawWindow();
    window.widget().update();
    EXPECT_FALSE(isRed(225, 8));
}

TEST_F(Caption, IsDrawnActiveAsTold) {
    const QPoint at(150, 10);
    const QRgb active = shown(window.widget()).pixel(at);
    window.SendMessage(WM_NCACTIVATE, FALSE);
    const QRgb inactive = shown(window.widget()).pixel(at);
    EXPECT_NE(active, inactive);
    window.DefWindowProc(WM_NCACTIVATE, TRUE, 0);
    window.on[WM_NCACTIVATE] = [](LPARAM, LRESULT& result) {
        result = FALSE;
        return true;
    };
    CWnd other;
    other.CreateEx(0, AfxRegisterWndClass(0), "other", WS_OVERLAPPEDWINDOW | WS_VISIBLE, 600, 80, 100, 100, nullptr,
                   nullptr);
    EXPECT_TRUE(QTest::qWaitForWindowActive(other.GetState()->widget()));
    EXPECT_EQ(window.of(WM_NCACTIVATE), std::vector<WPARAM>{FALSE});
    EXPECT_EQ(shown(window.widget()).pixel(at), active) << "the host has refused";
}

TEST_F(Caption, ButtonsActWhereTheyAreReleased) {
    window.on[WM_SYSCOMMAND] = [](LPARAM, LRESULT&) { return true; };
    const std::pair<int, WPARAM> buttons[] = {
        {HTMINBUTTON, SC_MINIMIZE}, {HTMAXBUTTON, SC_MAXIMIZE}, {HTCLOSE, SC_CLOSE}};
    for (const auto& [part, command] : buttons) {
        const QPoint at = middleOf(window, part);
        mouse(window.widget(), Act::Move, QPoint(200, 200));
        const QImage plain = shown(window.widget());
        mouse(window.widget(), Act::Move, at);
        EXPECT_NE(shown(window.widget()), plain) << part << ": hovered";
        mouse(window.widget(), Act::Press, at);
        const QImage pressed = shown(window.widget());
        mouse(window.widget(), Act::Move, QPoint(200, -50));
        EXPECT_NE(shown(window.widget()), pressed) << part;
        mouse(window.widget(), Act::Release, QPoint(200, -50));
        EXPECT_EQ(window.of(WM_SYSCOMMAND), std::vector<WPARAM>{}) << part;
        mouse(window.widget(), Act::Press, at);
        mouse(window.widget(), Act::Release, at);
        EXPECT_EQ(window.of(WM_SYSCOMMAND), std::vector<WPARAM>{command});
        window.seen.clear();
        CWnd child;
        child.Create(nullptr, nullptr, WS_CHILD | WS_VISIBLE, CRect(0, 0, 300, 200), &window, 1);
        mouse(window.widget(), Act::Move, QPoint(200, 200));
        child.DestroyWindow();
        EXPECT_EQ(shown(window.widget()), plain) << part << ": the mouse went straight into a child window";
    }
    mouse(window.widget(), Act::DoubleClick, QPoint(200, 12));
    EXPECT_EQ(window.of(WM_SYSCOMMAND), std::vector<WPARAM>{SC_MAXIMIZE});
    EXPECT_EQ(window.of(WM_NCLBUTTONDBLCLK), std::vector<WPARAM>{HTCAPTION});
}

TEST_F(Caption, APressThatAHandlerTakesKeepsTheMouse) {
    QPoint released;
    window.on[WM_NCLBUTTONDOWN] = [&](LPARAM, LRESULT&) {
        window.SetCapture();
        return true;
    };
    window.on[WM_LBUTTONUP] = [&](LPARAM at, LRESULT&) {
        released = QPoint(GET_X_LPARAM(at), GET_Y_LPARAM(at));
        ReleaseCapture();
        return true;
    };
    const QRect before = place();
    mouse(window.widget(), Act::Press, QPoint(200, 12));
    mouse(window.widget(), Act::Move, QPoint(-60, -70));
    EXPECT_EQ(CWnd::GetCapture(), &window);
    mouse(window.widget(), Act::Release, QPoint(-60, -70));
    const QPoint corner = window.GetState()->clientRect().topLeft();
    EXPECT_EQ(released, QPoint(-60, -70) - corner);
    EXPECT_EQ(place(), before);
}

TEST_F(Caption, IsMovedAndSizedByHand) {
    window.on[WM_GETMINMAXINFO] = [](LPARAM info, LRESULT&) {
        auto& limits = *reinterpret_cast<MINMAXINFO*>(info);
        limits.ptMinTrackSize = {250, 200};
        limits.ptMaxTrackSize = {450, 350};
        return true;
    };
    open(CRect(100, 80, 500, 380));
    const QRect before(100, 80, 400, 300);
    struct Drag {
        QPoint from;
        QPoint by;
        QRect after;
    };
    const Drag drags[] = {{{200, 12}, {3, 3}, before},
                          {{200, 12}, {60, 40}, before.translated(60, 40)},
                          {{0, 150}, {30, 90}, before.adjusted(30, 0, 0, 0)},
                          {{0, 150}, {300, 0}, before.adjusted(150, 0, 0, 0)},
                          {{0, 150}, {-90, 0}, before.adjusted(-50, 0, 0, 0)},
                          {{399, 299}, {-20, -30}, before.adjusted(0, 0, -20, -30)},
                          {{1, 1}, {500, 500}, before.adjusted(150, 100, 0, 0)},
                          {{200, 0}, {0, -90}, before.adjusted(0, -50, 0, 0)}};
    for (const Drag& drag : drags) {
        mouse(window.widget(), Act::Press, drag.from);
        const QPoint to = window.widget().mapToGlobal(drag.from + drag.by);
        mouse(window.widget(), Act::Move, window.widget().mapFromGlobal(to));
        EXPECT_EQ(place(), drag.after) << drag.from.x() << " " << drag.from.y();
        mouse(window.widget(), Act::Release, window.widget().mapFromGlobal(to));
        EXPECT_EQ(place(), drag.after);
        EXPECT_EQ(CWnd::GetCapture(), nullptr);
        window.MoveWindow(before.x(), before.y(), before.width(), before.height());
        settle();
    }
    // Esc takes it back; a host may let the window be moved by its client area.
    window.on[WM_NCHITTEST] = [&](LPARAM, LRESULT& result) {
        result = HTCAPTION;
        return true;
    };
    mouse(window.widget(), Act::Press, QPoint(200, 200));
    mouse(window.widget(), Act::Move, QPoint(230, 220));
    EXPECT_EQ(place(), before.translated(30, 20));
    QTest::keyClick(window.widget().windowHandle(), Qt::Key_Escape);
    settle();
    EXPECT_EQ(place(), before);
    EXPECT_EQ(CWnd::GetCapture(), nullptr);
    mouse(window.widget(), Act::Release, QPoint(200, 200));
}

TEST_F(Caption, OpensTheSystemMenu) {
    window.on[WM_INITMENU] = nullptr;
    window.on[WM_INITMENUPOPUP] = nullptr;
    const auto expectMenu = [&](const char* by, const std::function<void()>& act) {
        window.seen.clear();
        bool isSeen = false;
        QTimer closer;
        QObject::connect(&closer, &QTimer::timeout, &closer, [&] {
            auto* menu = qobject_cast<QMenu*>(QApplication::activePopupWidget());
            if (!menu) {
                return;
            }
            isSeen = true;
            std::string states;
            for (const QAction* action : menu->actions()) {
                states += action->isSeparator() ? '-' : action->isEnabled() ? '1' : '0';
            }
            EXPECT_EQ(states, window.IsZoomed() ? "10010-1" : "01111-1") << by;
            menu->close();
        });
        closer.start(0);
        act();
        settle();
        EXPECT_TRUE(QTest::qWaitFor([&] { return isSeen && !QApplication::activePopupWidget(); })) << by;
        const auto menu = reinterpret_cast<WPARAM>(window.GetSystemMenu(FALSE)->m_hMenu);
        EXPECT_EQ(window.of(WM_INITMENU), std::vector<WPARAM>{menu}) << by;
        EXPECT_EQ(window.of(WM_INITMENUPOPUP), std::vector<WPARAM>{menu}) << by;
    };
    for (const UINT command : {SC_RESTORE, SC_MAXIMIZE}) {
        window.SendMessage(WM_SYSCOMMAND, command);
        settle();
        expectMenu("icon", [&] { mouse(window.widget(), Act::Press, middleOf(window, HTSYSMENU)); });
        expectMenu("right button", [&] {
            mouse(window.widget(), Act::Press, QPoint(200, 12), Qt::RightButton);
            mouse(window.widget(), Act::Release, QPoint(200, 12), Qt::RightButton);
        });
        expectMenu("keys", [&] { QTest::keyClick(window.widget().windowHandle(), Qt::Key_Space, Qt::AltModifier); });
    }
}

} // namespace
