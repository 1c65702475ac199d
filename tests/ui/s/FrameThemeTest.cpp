// The button that frames draw in the desktop's style: where it goes, what its pictures are made of, what turns it off.
#include "s/FrameTheme.h"

#include "platform/afx/core/detail/Caption.h"
#include "platform/afx/core/detail/Window.h"
#include "platform/afx/gdi/detail/GdiObjects.h"
#include "tests/ui/afx/TestApplication.h"
#include "tests/unit/SavedEnvironment.h"

#include <QApplication>
#include <QTest>

#include <gtest/gtest.h>

#include <algorithm>
#include <functional>
#include <memory>
#include <set>
#include <string>
#include <tuple>
#include <unistd.h>
#include <vector>

namespace {

/// A main frame; where it is told to, it answers where its minimise button is.
class MainFrame : public CMDIFrameWnd {
public:
    BOOL OnCreateClient(CREATESTRUCT* cs, CCreateContext*) override {
        return CreateClient(cs, nullptr);
    }
    LRESULT WindowProc(UINT message, WPARAM wParam, LPARAM lParam) override {
        if (message == WM_NCHITTEST && first >= 0) {
            lines.insert(GET_Y_LPARAM(lParam));
            const int x = GET_X_LPARAM(lParam);
            return x >= first && x <= last ? HTMINBUTTON : HTCAPTION;
        }
        told.emplace_back(message, wParam);
        return CMDIFrameWnd::WindowProc(message, wParam, lParam);
    }
    int first = -1; ///< on the screen
    int last = -1;
    std::set<int> lines; ///< where it was asked
    std::vector<std::pair<UINT, WPARAM>> told;
};

class ChildFrame : public CMDIChildWnd {
public:
    LRESULT WindowProc(UINT message, WPARAM wParam, LPARAM lParam) override {
        told.emplace_back(message, wParam);
        return CMDIChildWnd::WindowProc(message, wParam, lParam);
    }
    std::vector<std::pair<UINT, WPARAM>> told;
};

// --- a library of tests' own ---

using Call = std::tuple<int, int, int, int, COLORREF>; ///< part, state, size, and what was there before

struct {
    int asked = 0;
    int opened = 0;
    int closed = 0;
    std::vector<Call> calls;
    std::function<void(CDC&, CSize)> draw; ///< draws the part
} style;

constexpr COLORREF ofTheme(int index) {
    return RGB(index, 100, 100);
}

ThemeLibrary fake() {
    ThemeLibrary library;
    library.module = LoadLibraryA("uxtheme"); // any that can be given back
    library.isThemeActive = [] { return ++style.asked > 0 ? TRUE : FALSE; };
    library.isAppThemed = [] { return TRUE; };
    library.openThemeData = [](HWND window, LPCSTR classes) -> ThemeLibrary::Theme {
        EXPECT_EQ(window, testApplication.m_pMainWnd->m_hWnd);
        EXPECT_STREQ(classes, "WINDOW");
        ++style.opened;
        return &style;
    };
    library.closeThemeData = [](ThemeLibrary::Theme theme) {
        EXPECT_EQ(theme, &style);
        ++style.closed;
        return LONG(0);
    };
    library.getThemeSysColor = [](ThemeLibrary::Theme, int index) { return ofTheme(index); };
    library.getThemeSysSize = [](ThemeLibrary::Theme, int index) { return index == 31 ? 30 : index; };
    library.drawThemeBackground = [](ThemeLibrary::Theme, HDC handle, int part, int state, const RECT* place,
                                     const RECT* clip) {
        EXPECT_EQ(clip, nullptr);
        CDC& dc = *CDC::FromHandle(handle);
        const CSize size(place->right - place->left, place->bottom - place->top);
        style.calls.emplace_back(part, state, size.cx, size.cy, dc.GetPixel(size.cx - 1, size.cy - 1));
        if (style.draw) {
            style.draw(dc, size);
        }
        return LONG(0);
    };
    return library;
}

// --- frames ---

class FrameThemes : public testing::Test {
protected:
    FrameThemes() {
        style = {};
        frame = new MainFrame;
        frame->Create(nullptr, "Main", WS_OVERLAPPEDWINDOW, CRect(10, 20, 510, 320), nullptr, nullptr,
                      WS_EX_OWNCAPTION);
        testApplication.m_pMainWnd = frame;
        frame->ShowWindow(SW_SHOW);
        child = new ChildFrame;
        child->Create(nullptr, "Child", WS_CHILD | WS_VISIBLE | WS_OVERLAPPEDWINDOW, CRect(20, 20, 320, 200), frame);
        QCoreApplication::processEvents();
    }
    ~FrameThemes() override {
        testApplication.m_pMainWnd = nullptr;
        frame->DestroyWindow();
        QCoreApplication::processEvents();
    }
    void putMinimizeButton(int left, int right) const {
        frame->first = left;
        frame->last = right;
    }
    /// The button as it is drawn; null where it is not.
    static QImage picture(const Gui_FrameTheme& theme, const CFrameWnd& frame, bool pushed = false) {
        const CSize size = theme.buttonPlace(frame, false).Size();
        CClientDC screen(testApplication.m_pMainWnd);
        CDC dc;
        dc.CreateCompatibleDC(&screen);
        CBitmap bitmap;
        bitmap.CreateCompatibleBitmap(&screen, std::max<int>(size.cx, 1), std::max<int>(size.cy, 1));
        dc.SelectObject(&bitmap);
        const bool drawn = theme.drawButton(frame, dc, CPoint(0, 0), pushed);
        return drawn ? tvx::afx::bitmapImage(static_cast<HBITMAP>(bitmap.m_hObject)).copy() : QImage();
    }
    MainFrame* frame;
    ChildFrame* child;
};

/// What a process's switch is after something was done in it.
bool staysOn(const std::function<void()>& act) {
    const pid_t process = fork();
    if (process == 0) {
        act();
        _exit(Gui_FrameTheme::isSwitchedOn() ? 1 : 0);
    }
    int status = 0;
    waitpid(process, &status, 0);
    EXPECT_TRUE(WIFEXITED(status));
    return WEXITSTATUS(status) == 1;
}

COLORREF signOf(const Gui_FrameTheme& theme, const CFrameWnd& frame) {
    COLORREF color = 0;
    EXPECT_TRUE(theme.signColor(frame, color));
    return color;
}

} // namespace

TEST_F(FrameThemes, PlaceTheButtonBesideTheMinimizeButton) {
    const int border = GetSystemMetrics(SM_CYFRAME);
    // The window reaches from 10 to 509; a button from 400 to 420 makes one of 20 that ends two pixels before it.
    for (const auto& [left, right, place] :
         {std::tuple(400, 420, CRect(369, 5 + border, 389, 25 + border)),
          std::tuple(509, 509, CRect(498, 15 + border, 498, 15 + border)),
          std::tuple(10, 12, CRect(-3, 14 + border, -1, 16 + border)), std::tuple(600, 620, CRect(500, 0, 500, 0))}) {
        putMinimizeButton(left, right);
        Gui_FrameTheme theme(&fake);
        theme.initialise();
        EXPECT_EQ(theme.buttonPlace(*frame, false), place) << left;
        EXPECT_EQ(theme.buttonPlace(*frame, true), place + CPoint(10, 20)) << left;
    }
    EXPECT_EQ(frame->lines, std::set<int>{20 + border + 15});
    EXPECT_EQ(style.opened, 4);
    EXPECT_EQ(style.closed, 4);
}

TEST_F(FrameThemes, PlaceTheButtonOfAFilledMainFrameInItsMenuBar) {
    putMinimizeButton(400, 420);
    Gui_FrameTheme theme(&fake);
    theme.initialise();
    const CRect inCaption = theme.buttonPlace(*frame, false);
    frame->MDIMaximize(child);
    const CPoint at(500 - 4 * 54 - GetSystemMetrics(SM_CXFRAME),
                    GetSystemMetrics(SM_CYFRAME) + GetSystemMetrics(SM_CYCAPTION));
    EXPECT_EQ(theme.buttonPlace(*frame, false), CRect(at, CSize(54, 55)));
    EXPECT_EQ(theme.buttonPlace(*child, false).Size(), inCaption.Size());
    frame->MDIRestore(child);
    EXPECT_EQ(theme.buttonPlace(*frame, false), inCaption);
}

// Main frames are measured as they come up, and what was measured holds for frames in other states.
TEST_F(FrameThemes, MeasureAMaximisedFrameAsAnyOther) {
    const auto measured = [this] {
        Gui_FrameTheme theme(&fake);
        theme.initialise();
        CRect window;
        frame->GetWindowRect(&window);
        const CRect place = theme.buttonPlace(*frame, false);
        return std::tuple(window.Width() - place.left, place.top, place.Width());
    };
    const auto normal = measured();
    EXPECT_GT(std::get<2>(normal), 0);
    frame->ShowWindow(SW_SHOWMAXIMIZED);
    QCoreApplication::processEvents();
    EXPECT_TRUE(frame->IsZoomed());
    EXPECT_EQ(measured(), normal);
}

TEST_F(FrameThemes, MakeSixPicturesAndAgainForANewStyle) {
    putMinimizeButton(400, 420);
    Gui_FrameTheme theme(&fake);
    theme.initialise();
    const std::vector<Call> expected{{15, 1, 20, 20, ofTheme(2)},  {15, 5, 20, 20, ofTheme(3)},
                                     {15, 3, 20, 20, ofTheme(2)},  {16, 1, 54, 55, ofTheme(15)},
                                     {16, 4, 54, 55, ofTheme(15)}, {16, 3, 54, 55, ofTheme(15)}};
    EXPECT_EQ(style.calls, expected);
    theme.initialise(); // which has nothing left to do
    EXPECT_EQ(style.calls, expected);
    EXPECT_EQ(signOf(theme, *frame), ofTheme(9));
    frame->MDIMaximize(child);
    EXPECT_EQ(signOf(theme, *frame), ofTheme(18)) << "these pictures have no sign to read its colour from";
    frame->MDIRestore(child);
    QCoreApplication::processEvents();
    frame->told.clear();
    putMinimizeButton(300, 310);
    theme.changed(*frame);
    EXPECT_EQ(theme.buttonPlace(*frame, false).Width(), 10);
    EXPECT_EQ(std::tuple(style.asked, style.opened, style.closed, style.calls.size()), std::tuple(1, 2, 1, 12U));
    QCoreApplication::processEvents();
    EXPECT_EQ(std::ranges::count(frame->told, std::pair<UINT, WPARAM>(WM_NCPAINT, 1)), 1);
}

// Rows of their own colours with a sign: what is above it runs down over it, in the lower half and within the edges.
TEST_F(FrameThemes, TakeTheSignOutOfPictures) {
    putMinimizeButton(400, 420);
    const auto row = [](int y) { return RGB(10 + y, 0, 0); };
    style.draw = [&](CDC& dc, CSize size) {
        const bool inCaption = std::get<0>(style.calls.back()) == 15;
        const COLORREF sign = inCaption ? ofTheme(9) : RGB(0, 0, 7);
        for (int y = 0; y < size.cy; ++y) {
            dc.FillSolidRect(0, y, size.cx, 1, inCaption || y <= size.cy / 2 ? row(y) : row(size.cy / 2));
        }
        const CPoint middle(size.cx / 2, size.cy / 2);
        for (const CPoint at :
             {middle + CPoint(-2, 3), middle + CPoint(1, 4), CPoint(0, size.cy - 3), CPoint(size.cx - 1, size.cy - 3),
              CPoint(3, size.cy - 1), CPoint(3, middle.y), middle + CPoint(0, 3)}) {
            dc.SetPixel(at, sign);
        }
    };
    Gui_FrameTheme theme(&fake);
    theme.initialise();
    const QImage picture = FrameThemes::picture(theme, *frame);
    const auto at = [&](int x, int y) {
        return COLORREF(RGB(qRed(picture.pixel(x, y)), qGreen(picture.pixel(x, y)), qBlue(picture.pixel(x, y))));
    };
    for (int x = 8; x <= 11; ++x) {
        EXPECT_EQ(at(x, 13), row(12)) << x;
        EXPECT_EQ(at(x, 14), row(12)) << x; // over what has just come down
    }
    EXPECT_EQ(at(7, 13), row(13));
    EXPECT_EQ(at(12, 14), row(14));
    for (const auto& [x, y] : {std::pair(0, 17), std::pair(19, 17), std::pair(3, 19), std::pair(3, 10)}) {
        EXPECT_EQ(at(x, y), ofTheme(9)) << x << ", " << y; // out of reach
    }
    // The other pictures of a caption lose the same rectangle; in menu bars the colour is read from the picture.
    frame->MDIMaximize(child);
    EXPECT_EQ(signOf(theme, *frame), RGB(0, 0, 7));
    const QImage menu = FrameThemes::picture(theme, *frame, true);
    EXPECT_EQ(qRed(menu.pixel(27, 30)), 10 + 27);
    EXPECT_EQ(qRed(menu.pixel(28, 31)), 10 + 27);
}

TEST_F(FrameThemes, DoWithoutWhatTheLibraryLacks) {
    putMinimizeButton(400, 420);
    const auto without = [&](const std::function<void(ThemeLibrary&)>& take) {
        auto theme = std::make_unique<Gui_FrameTheme>([&] {
            ThemeLibrary library = fake();
            take(library);
            return library;
        });
        theme->initialise();
        theme->changed(*frame);
        return theme;
    };
    const std::pair<bool, std::function<void(ThemeLibrary&)>> rows[] = {
        {false, [](ThemeLibrary& library) { library.openThemeData = nullptr; }},
        {false,
         [](ThemeLibrary& library) { library.openThemeData = [](HWND, LPCSTR) { return ThemeLibrary::Theme(); }; }},
        {false, [](ThemeLibrary& library) { library.drawThemeBackground = nullptr; }},
        {true, [](ThemeLibrary& library) { library.closeThemeData = nullptr; }},
        {true, [](ThemeLibrary& library) { library.getThemeSysSize = nullptr; }},
        {true, [](ThemeLibrary& library) { library.getThemeSysColor = nullptr; }}};
    for (const auto& row : rows) {
        const auto theme = without(row.second);
        COLORREF color = 0;
        EXPECT_EQ(!picture(*theme, *frame).isNull(), row.first) << &row - rows;
        EXPECT_EQ(theme->signColor(*frame, color), row.first) << &row - rows;
    }
    EXPECT_EQ(signOf(*without(rows[5].second), *frame), GetSysColor(9));
    const auto sizeless = without(rows[4].second);
    EXPECT_EQ(sizeless->buttonPlace(*frame, false).top, (GetSystemMetrics(31) - 20) / 2 + GetSystemMetrics(33));
    putMinimizeButton(600, 600);
    EXPECT_TRUE(picture(*without([](ThemeLibrary&) {}), *frame).isNull());
    EXPECT_TRUE(Gui_FrameTheme::isSwitchedOn());
}

TEST_F(FrameThemes, AreToldOfEachChangeOnce) {
    const QPalette palette = QApplication::palette();
    const auto counts = [&] {
        std::vector<std::ptrdiff_t> found;
        for (int i = 0; i < 5; ++i) {
            QCoreApplication::processEvents(); // what a change leads to must come to an end
        }
        for (auto* told : {&frame->told, &child->told}) {
            for (const UINT message : {WM_SYSCOLORCHANGE, WM_THEMECHANGED}) {
                found.push_back(std::ranges::count(*told, message, &std::pair<UINT, WPARAM>::first));
            }
            told->clear();
        }
        return found;
    };
    counts();
    QApplication::setPalette(QPalette(QColor(50, 50, 50)));
    EXPECT_EQ(counts(), (std::vector<std::ptrdiff_t>{1, 1, 1, 1}));
    QApplication::setPalette(palette);
    EXPECT_EQ(counts(), (std::vector<std::ptrdiff_t>{1, 1, 1, 1}));
    QApplication::setStyle("Windows");
    const auto ofStyle = counts();
    EXPECT_EQ(std::pair(ofStyle[1], ofStyle[3]), (std::pair<std::ptrdiff_t, std::ptrdiff_t>(1, 1)));
    QApplication::setStyle("Fusion");
    counts();
}

TEST_F(FrameThemes, AreTurnedOffForGood) {
    SavedEnvironment environment;
    for (const char* wish : {"0", "0x", "01"}) {
        setenv("TVX_GUI_USETHEMES", wish, 1);
        EXPECT_FALSE(staysOn([] { Gui_FrameTheme(&fake).initialise(); })) << wish;
    }
    for (const char* wish : {"", "1", "no", " 0"}) {
        setenv("TVX_GUI_USETHEMES", wish, 1);
        EXPECT_TRUE(staysOn([] { Gui_FrameTheme(&fake).initialise(); })) << wish;
    }
    const std::function<void(ThemeLibrary&)> faults[] = {
        [](ThemeLibrary& library) { library = {}; }, [](ThemeLibrary& library) { library.isThemeActive = nullptr; },
        [](ThemeLibrary& library) { library.isThemeActive = [] { return FALSE; }; },
        [](ThemeLibrary& library) { library.isAppThemed = nullptr; },
        [](ThemeLibrary& library) { library.isAppThemed = [] { return FALSE; }; }};
    for (const auto& fault : faults) {
        EXPECT_FALSE(staysOn([&] {
            Gui_FrameTheme theme([&] {
                ThemeLibrary library = fake();
                fault(library);
                return library;
            });
            theme.initialise();
            Gui_FrameTheme(&fake).initialise();
        }));
    }
    EXPECT_FALSE(staysOn([] {
        Gui_FrameTheme::acquire();
        Gui_FrameTheme::acquire();
        Gui_FrameTheme::release();
        if (Gui_FrameTheme::current() && Gui_FrameTheme::isSwitchedOn()) {
            Gui_FrameTheme::release();
        }
        Gui_FrameTheme::acquire();
    }));
}

// --- the toolkit's styles ---

namespace {

class StyledFrameThemes : public FrameThemes, public testing::WithParamInterface<std::tuple<std::string, QRgb>> {
protected:
    StyledFrameThemes() : m_palette(QApplication::palette()), m_style(QApplication::style()->name()) {
        QApplication::setStyle(QString::fromStdString(std::get<0>(GetParam())));
        QApplication::setPalette(QPalette(QColor(std::get<1>(GetParam()))));
        QCoreApplication::processEvents();
    }
    ~StyledFrameThemes() override {
        QApplication::setStyle(m_style);
        QApplication::setPalette(m_palette);
    }

private:
    QPalette m_palette;
    QString m_style;
};

} // namespace

// It is the minimise button, less the sign: as large, in the same row, with the same gap beside it.
TEST_P(StyledFrameThemes, LookLikeTheMinimizeButton) {
    Gui_FrameTheme theme;
    theme.initialise();
    EXPECT_TRUE(Gui_FrameTheme::isSwitchedOn());
    const CRect place = theme.buttonPlace(*frame, false);
    QWidget& widget = *frame->GetState()->widget();
    const auto test = [&](int x) {
        return frame->GetState()->hitTest(widget.mapToGlobal(QPoint(x, place.CenterPoint().y)));
    };
    const QImage window = widget.grab().toImage();
    const int step = place.Width() + 2;
    EXPECT_EQ(test(place.right), HTCAPTION);
    EXPECT_EQ(test(place.right + 1), HTMINBUTTON);
    EXPECT_EQ(test(place.right + step + 1), HTMAXBUTTON);
    for (const bool pushed : {false, true}) {
        const QImage button = picture(theme, *frame, pushed);
        ASSERT_EQ(button.size(), QSize(place.Width(), place.Height()));
        int signs = 0;
        int others = 0;
        for (int y = 0; y < button.height(); ++y) {
            for (int x = 0; x < button.width(); ++x) {
                const COLORREF sign = signOf(theme, *frame);
                signs += button.pixel(x, y) == qRgb(GetRValue(sign), GetGValue(sign), GetBValue(sign)) ? 1 : 0;
                others += button.pixel(x, y) != window.pixel(place.left + step + x, place.top + y) ? 1 : 0;
            }
        }
        EXPECT_EQ(signs, 0);
        if (!pushed) {
            EXPECT_LE(others, button.width() * button.height() / 5); // the sign, and the row that ran down
        }
    }
    frame->MDIMaximize(child);
    const QImage normal = picture(theme, *frame, false);
    const QImage pushed = picture(theme, *frame, true);
    ASSERT_FALSE(normal.isNull());
    EXPECT_NE(normal, pushed);
    EXPECT_EQ(normal.size(), QSize(GetSystemMetrics(SM_CXMENUSIZE), GetSystemMetrics(SM_CYMENUSIZE)));
    for (int y = normal.height() / 4; y < normal.height() / 2; ++y) {
        for (int x = normal.width() / 4; x < normal.width() * 3 / 4; ++x) {
            ASSERT_EQ(normal.pixel(x, y), normal.pixel(x + 1, y)) << "a sign at " << x << ", " << y;
        }
    }
}

TEST_P(StyledFrameThemes, AreDrawnWithinAClip) {
    ThemeLibrary library = ThemeLibrary::load();
    const ThemeLibrary::Theme theme = library.openThemeData(frame->m_hWnd, "WINDOW");
    CClientDC screen(frame);
    CDC dc;
    dc.CreateCompatibleDC(&screen);
    CBitmap bitmap;
    bitmap.CreateCompatibleBitmap(&screen, 20, 20);
    CBitmap* before = dc.SelectObject(&bitmap);
    const CRect whole(0, 0, 20, 20);
    dc.FillSolidRect(whole, RGB(1, 2, 3));
    const CRect left(0, 0, 10, 20);
    EXPECT_EQ(library.drawThemeBackground(theme, dc.m_hDC, 15, 1, whole, left), 0);
    EXPECT_NE(dc.GetPixel(9, 10), RGB(1, 2, 3));
    EXPECT_EQ(dc.GetPixel(10, 10), RGB(1, 2, 3));
    dc.SelectObject(before);
    EXPECT_EQ(library.closeThemeData(theme), 0);
    EXPECT_NE(library.closeThemeData(theme), 0) << "it is closed";
    FreeLibrary(library.module);
}

INSTANTIATE_TEST_SUITE_P(InLightAndDark, StyledFrameThemes,
                         testing::Combine(testing::Values(std::string("Fusion"), std::string("Windows")),
                                          testing::Values(0xFFEFEFEF, 0xFF353535)));
