#include "platform/afx/core/detail/PlainWindow.h"

#include "platform/win/FrameworkIds.h"

#include "platform/afx/core/detail/CaptionedWindow.h"
#include "platform/afx/core/detail/Dispatch.h"
#include "platform/afx/core/detail/Loop.h"
#include "platform/afx/core/detail/MenuWidgets.h"
#include "platform/afx/core/detail/ScrollFrame.h"
#include "platform/afx/gdi/Dc.h"
#include "platform/afx/gdi/detail/GdiObjects.h"

#include <QMainWindow>
#include <QMenuBar>
#include <QScreen>
#include <QStatusTipEvent>
#include <QWindow>

namespace tvx::afx {

namespace {

/// Plain children until the room of the frames, which comes with the same library, has told of its kind.
constinit WindowFactory childFrameFactory = nullptr;

} // namespace

void setChildFrameFactory(WindowFactory factory) {
    childFrameFactory = factory;
}

std::unique_ptr<Window> makePlainWindow(const CREATESTRUCT& cs) {
    if ((static_cast<DWORD>(cs.style) & WS_CHILD) != 0) {
        const bool childFrame = childFrameFactory && (cs.dwExStyle & WS_EX_MDICHILD) != 0;
        return childFrame ? childFrameFactory(cs) : std::make_unique<PlainWindow>(cs);
    }
    if ((cs.dwExStyle & WS_EX_OWNCAPTION) != 0) {
        return std::make_unique<CaptionedWindow>(cs);
    }
    return std::make_unique<TopLevelWindow>(cs);
}

bool eraseBackground(Window& window, HDC dc) {
    if (!window.classBrush) {
        return false;
    }
    const QRect area = window.clientRect();
    const RECT rect{0, 0, area.width(), area.height()};
    FillRect(dc, &rect, window.classBrush);
    return true;
}

// --- children ---

QWidget* PlainWindow::makeWidget(QWidget* parent) {
    m_frame = new ScrollFrame(*this, parent, ScrollFrame::Background::Windows);
    return m_frame;
}

QWidget* PlainWindow::clientWidget() const {
    return widget() ? m_frame->viewport() : nullptr;
}

void PlainWindow::styleChanged(DWORD oldStyle, DWORD oldExStyle) {
    guarded([this] { m_frame->followStyle(); });
    tellGeometry();
}

LRESULT PlainWindow::defaultProc(UINT message, WPARAM wParam, LPARAM lParam) {
    switch (message) {
    case WM_ERASEBKGND:
        return eraseBackground(*this, reinterpret_cast<HDC>(wParam)) ? TRUE : FALSE;
    case WM_PAINT: {
        PAINTSTRUCT paint;
        BeginPaint(handle(), &paint);
        EndPaint(handle(), &paint);
        return 0;
    }
    default:
        return Window::defaultProc(message, wParam, lParam);
    }
}

// --- top-level windows ---

Qt::WindowFlags windowFlags(DWORD style, DWORD exStyle) {
    Qt::WindowFlags flags = (exStyle & WS_EX_TOOLWINDOW) != 0 ? Qt::Tool : Qt::Window;
    if ((exStyle & WS_EX_TOPMOST) != 0) {
        flags |= Qt::WindowStaysOnTopHint;
    }
    if ((style & WS_CAPTION) != WS_CAPTION) {
        return flags | Qt::FramelessWindowHint;
    }
    // Of a caption that the window draws itself the desktop must not hear. Else the toolkit adds all buttons of a
    // caption by itself without the first of the hints.
    flags |=
        (exStyle & WS_EX_OWNCAPTION) != 0 ? Qt::FramelessWindowHint : Qt::CustomizeWindowHint | Qt::WindowTitleHint;
    if ((style & WS_SYSMENU) != 0) {
        flags |= Qt::WindowSystemMenuHint | Qt::WindowCloseButtonHint;
    }
    if ((style & WS_MINIMIZEBOX) != 0) {
        flags |= Qt::WindowMinimizeButtonHint;
    }
    if ((style & WS_MAXIMIZEBOX) != 0) {
        flags |= Qt::WindowMaximizeButtonHint;
    }
    return flags;
}

namespace {

class MainWidget : public QMainWindow {
public:
    using QMainWindow::QMainWindow;

protected:
    bool event(QEvent* event) override {
        if (event->type() == QEvent::StatusTip) {
            showTip(static_cast<QStatusTipEvent*>(event)->tip());
            return true;
        }
        return QMainWindow::event(event);
    }

private:
    /// Menus tell of their items by WM_MENUSELECT.
    void showTip(const QString& tip) {
        const Window* window = Window::of(this);
        if (!window || menuHasKeyboard()) {
            return;
        }
        const std::string text = fromQt(tip);
        SendMessageA(window->handle(), WM_SETMESSAGESTRING, text.empty() ? AFX_IDS_IDLEMESSAGE : 0,
                     reinterpret_cast<LPARAM>(text.empty() ? nullptr : text.c_str()));
    }
};

} // namespace

QMainWindow* makeMainWidget(QWidget* parent, Qt::WindowFlags flags) {
    auto* frame = new MainWidget(parent, flags);
    frame->setContextMenuPolicy(Qt::PreventContextMenu); // the toolkit's list of tool bars
    frame->setMouseTracking(true);
    frame->setAnimated(false);
    return frame;
}

QMainWindow* mainWindowOf(const Window& window) {
    return qobject_cast<QMainWindow*>(window.clientWidget());
}

TopLevelWindow::TopLevelWindow(const CREATESTRUCT& cs) : Window(cs), m_menu(cs.hMenu) {}

TopLevelWindow::~TopLevelWindow() {
    DestroyMenu(m_menu);
}

QWidget* TopLevelWindow::makeWidget(QWidget*) {
    QWidget* over = owner() ? owner()->widget() : nullptr;
    QMainWindow* frame = makeMainWidget(over, windowFlags(style(), exStyle()));
    frame->setAcceptDrops((exStyle() & WS_EX_ACCEPTFILES) != 0);
    if ((style() & WS_OVERLAPPEDWINDOW) == WS_OVERLAPPEDWINDOW) {
        frame->resize(frame->screen()->availableSize() * 3 / 4);
    }
    return frame;
}

void TopLevelWindow::widgetMade() {
    widget()->setWindowTitle(Window::text());
    iconChanged();
    if (m_menu) {
        setMenu(m_menu);
    }
}

QString TopLevelWindow::text() const {
    return widget() ? widget()->windowTitle() : Window::text();
}

void TopLevelWindow::iconChanged() {
    widget()->setWindowIcon(windowIcon(bigIcon ? bigIcon : smallIcon)); // without one: the application's
}

void TopLevelWindow::setMenu(HMENU menu) {
    m_menu = menu;
    auto* bar = dynamic_cast<FrameMenuBar*>(mainWindow()->menuWidget());
    guarded([&] {
        if (!bar && menu) {
            bar = new FrameMenuBar(handle(), mainWindow());
            mainWindow()->setMenuBar(bar);
        }
        if (bar) {
            bar->setMenu(menu);
            bar->setVisible(menu != nullptr);
        }
    });
    tellGeometry();
}

QMainWindow* TopLevelWindow::mainWindow() const {
    return static_cast<QMainWindow*>(widget());
}

int TopLevelWindow::hitTest(QPoint screen) const {
    const QWidget* bar = mainWindow()->menuWidget();
    const bool inBar = bar && bar->isVisible() && bar->rect().contains(bar->mapFromGlobal(screen));
    return inBar ? HTMENU : HTCLIENT;
}

void TopLevelWindow::updateFrame() {
    if (QWidget* bar = widget() ? mainWindow()->menuWidget() : nullptr) {
        bar->update();
    }
}

QRect frameClientRect(const QMainWindow& main) {
    QRect area = main.contentsRect();
    const QWidget* bar = main.menuWidget();
    if (bar && !bar->isHidden()) {
        const int height = bar->hasHeightForWidth() ? bar->heightForWidth(area.width()) : bar->sizeHint().height();
        area.setTop(area.top() + height);
    }
    return area;
}

void TopLevelWindow::setWindowRect(const QRect& rect) {
    if (placement()) {
        placement()->moveFrame(rect, Measured::Frame);
    } else {
        Window::setWindowRect(rect);
    }
}

QRect TopLevelWindow::clientRect() const {
    return widget() ? frameClientRect(*mainWindow()) : QRect();
}

void TopLevelWindow::styleChanged(DWORD oldStyle, DWORD oldExStyle) {
    const Qt::WindowFlags flags = windowFlags(style(), exStyle());
    widget()->setAcceptDrops((exStyle() & WS_EX_ACCEPTFILES) != 0);
    if (flags != windowFlags(oldStyle, oldExStyle)) {
        changeWindowFlags(*widget(), flags);
    }
}

void changeWindowFlags(QWidget& widget, Qt::WindowFlags flags) {
    // Told by the widget, the toolkit would make the desktop's window anew: handles would no longer name it.
    guarded([&] {
        widget.overrideWindowFlags(flags);
        if (QWindow* native = widget.windowHandle()) {
            native->setFlags(flags);
        }
    });
}

void applySizeLimits(Window& window, QSize least) {
    constexpr int unlimited = 32767;
    MINMAXINFO limits{};
    limits.ptMaxTrackSize = {unlimited, unlimited};
    window.call(WM_GETMINMAXINFO, 0, reinterpret_cast<LPARAM>(&limits));
    QWidget& widget = *window.widget();
    // The host's limits count the frame, the toolkit's do not.
    const QSize frame = widget.isWindow() ? widget.frameGeometry().size() - widget.geometry().size() : QSize(0, 0);
    const QSize wanted = toQt(limits.ptMinTrackSize).isNull()
                             ? QSize(0, 0)
                             : QSize(limits.ptMinTrackSize.x, limits.ptMinTrackSize.y) - frame;
    widget.setMinimumSize(wanted.expandedTo(least));
    if (limits.ptMaxTrackSize.x < unlimited || limits.ptMaxTrackSize.y < unlimited) {
        widget.setMaximumSize(QSize(limits.ptMaxTrackSize.x, limits.ptMaxTrackSize.y) - frame);
    }
}

void showTopLevel(Window& window, int command) {
    QWidget& widget = *window.widget();
    const bool activate = command != SW_SHOWNOACTIVATE && command != SW_SHOWNA && command != SW_SHOWMINNOACTIVE;
    if (command != SW_HIDE && window.placement()) {
        window.placement()->aboutToShow(activate ? Placement::Keyboard::Taken : Placement::Keyboard::Left);
    }
    widget.setAttribute(Qt::WA_ShowWithoutActivating, !activate);
    switch (command) {
    case SW_HIDE:
        widget.hide();
        return;
    case SW_SHOWMINIMIZED:
    case SW_MINIMIZE:
    case SW_SHOWMINNOACTIVE:
        widget.showMinimized();
        return;
    case SW_SHOWMAXIMIZED:
        widget.showMaximized();
        break;
    case SW_SHOWNORMAL:
    case SW_RESTORE:
    case SW_SHOWNOACTIVATE:
        if (widget.isMinimized() && widget.isMaximized()) {
            widget.setWindowState(widget.windowState() & ~Qt::WindowMinimized);
            widget.show();
        } else {
            widget.showNormal();
        }
        break;
    default:
        widget.show();
        break;
    }
    if (activate) {
        widget.raise();
        widget.activateWindow();
    }
}

void TopLevelWindow::beforeShow(bool visible) {
    if (visible) {
        applySizeLimits(*this, leastSize());
        forgetToldSize();
    }
}

namespace {

/// Shrinks a window that was never shown to its screen: hosts choose sizes for the screens that they were written on.
void fitScreen(Window& window) {
    const QRect area = window.widget()->screen()->availableGeometry();
    QRect place = window.windowRect();
    if (place.width() <= area.width() && place.height() <= area.height()) {
        return;
    }
    place.setSize(place.size().boundedTo(area.size()));
    place.moveCenter(area.center());
    window.setWindowRect(place);
}

} // namespace

void TopLevelWindow::showWidget(int command) {
    if (command != SW_HIDE && !widget()->testAttribute(Qt::WA_WState_ExplicitShowHide)) {
        fitScreen(*this);
    }
    showTopLevel(*this, command);
}

LRESULT TopLevelWindow::defaultProc(UINT message, WPARAM wParam, LPARAM lParam) {
    switch (message) {
    case WM_SYSCOMMAND:
        if ((wParam & 0xFFF0U) == SC_KEYMENU) {
            openMenuByKey(*this, static_cast<char32_t>(lParam));
            return 0;
        }
        return Window::defaultProc(message, wParam, lParam);
    case WM_ERASEBKGND:
        return eraseBackground(*this, reinterpret_cast<HDC>(wParam)) ? TRUE : FALSE;
    case WM_PAINT:
        if (!classBrush) {
            passEvent(*this, message);
        } else {
            PAINTSTRUCT paint;
            BeginPaint(handle(), &paint);
            EndPaint(handle(), &paint);
        }
        return 0;
    default:
        return Window::defaultProc(message, wParam, lParam);
    }
}

} // namespace tvx::afx
