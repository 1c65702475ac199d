#include "platform/afx/frames/detail/MdiWindow.h"

#include "platform/afx/core/WindowCalls.h"
#include "platform/afx/core/detail/Connect.h"
#include "platform/afx/core/detail/DesktopAnswers.h"
#include "platform/afx/core/detail/Dispatch.h"
#include "platform/afx/core/detail/Loop.h"
#include "platform/afx/core/detail/Placement.h"
#include "platform/afx/core/detail/PlainWindow.h"
#include "platform/afx/frames/MdiFrame.h"
#include "platform/afx/gdi/detail/ButtonImages.h"
#include "platform/afx/gdi/detail/GdiObjects.h"

#include <QApplication>
#include <QCloseEvent>
#include <QMainWindow>
#include <QMdiArea>
#include <QMdiSubWindow>

#include <algorithm>
#include <cmath>
#include <functional>

namespace tvx::afx {

namespace {

std::unique_ptr<Window> makeClient(const CREATESTRUCT& cs) {
    return std::make_unique<MdiClientWindow>(cs);
}

const WindowClassEntry clientEntry("MDICLIENT", &makeClient);

/// Asks its frame before it closes.
class SubWindow : public QMdiSubWindow {
protected:
    void closeEvent(QCloseEvent* event) override {
        event->ignore();
        if (const Window* window = Window::of(this)) {
            storing([window] {
                armIdle();
                PostMessageA(window->handle(), WM_SYSCOMMAND, SC_CLOSE, 0);
            });
        }
    }
};

} // namespace

namespace {

std::unique_ptr<Window> makeMdiChild(const CREATESTRUCT& cs) {
    if (!dynamic_cast<MdiClientWindow*>(Window::from(cs.hwndParent))) {
        return std::make_unique<PlainWindow>(cs);
    }
    return std::make_unique<MdiChildWindow>(cs);
}

struct ChildFrameEntry {
    ChildFrameEntry() {
        setChildFrameFactory(&makeMdiChild);
    }
} const childFrameEntry;

} // namespace

Window* MdiClientWindow::heldChildFrame() const {
    return m_active;
}

// --- the client ---

namespace {

/// Tells when it comes up, and keeps a widget at its foot.
class Area : public QMdiArea {
public:
    Area(QWidget* parent, std::function<void()> shown) : QMdiArea(parent), m_shown(std::move(shown)) {}

    void placeFoot() {
        const int height = m_foot && !m_foot->isHidden() ? m_foot->sizeHint().height() : 0;
        if (viewportMargins().bottom() != height) {
            setViewportMargins(0, 0, 0, height);
        }
        if (height > 0) {
            const QRect room = contentsRect();
            m_foot->setGeometry(room.left(), viewport()->geometry().bottom() + 1, room.width(), height);
        }
    }

    QPointer<QWidget> m_foot;

protected:
    void resizeEvent(QResizeEvent* event) override {
        QMdiArea::resizeEvent(event);
        placeFoot();
    }

    void showEvent(QShowEvent* event) override {
        QMdiArea::showEvent(event);
        storing(m_shown);
    }

private:
    std::function<void()> m_shown;
};

} // namespace

QWidget* MdiClientWindow::makeWidget(QWidget* parent) {
    auto* area = new Area(parent, [this] { placeAgain(); });
    area->setHorizontalScrollBarPolicy(Qt::ScrollBarAsNeeded);
    area->setVerticalScrollBarPolicy(Qt::ScrollBarAsNeeded);
    area->setActivationOrder(QMdiArea::ActivationHistoryOrder);
    connectStoring(area, &QMdiArea::subWindowActivated, area, [this](const QMdiSubWindow* sub) { follow(sub); });
    m_told.setSingleShot(true);
    connectStoring(&m_told, &QTimer::timeout, area, [this] { roomTold(); });
    return area;
}

QMdiArea* MdiClientWindow::area() const {
    return static_cast<QMdiArea*>(widget());
}

void MdiClientWindow::setFoot(QWidget* foot) {
    static_cast<Area*>(widget())->m_foot = foot;
    placeFoot();
}

void MdiClientWindow::placeFoot() {
    guarded([this] { static_cast<Area*>(widget())->placeFoot(); });
}

QWidget* MdiClientWindow::clientWidget() const {
    return widget() ? area()->viewport() : nullptr;
}

void MdiClientWindow::follow(const QMdiSubWindow* sub) {
    // Without a sub-window the main frame has only been deactivated; its active child stays that.
    if (sub && !m_activating && !isDestroyed()) {
        activate(dynamic_cast<MdiChildWindow*>(Window::of(sub)));
    }
}

void MdiClientWindow::activate(MdiChildWindow* child) {
    if (child && child->isDestroyed()) {
        return;
    }
    MdiChildWindow* old = std::exchange(m_active, child);
    if (child) {
        std::erase(m_history, child);
        m_history.push_back(child);
        // The toolkit answers with the signal that ends in follow().
        m_activating = true;
        guarded([&] { area()->setActiveSubWindow(child->subWindow()); });
        m_activating = false;
    }
    if (old == child) {
        return;
    }
    const HWND oldHandle = old ? old->handle() : nullptr;
    const HWND newHandle = child ? child->handle() : nullptr;
    for (const HWND told : {oldHandle, newHandle}) {
        if (from(told)) {
            const bool isActive = told == newHandle && topLevel()->widget()->isActiveWindow();
            SendMessageA(told, WM_NCACTIVATE, isActive ? TRUE : FALSE, 0);
            SendMessageA(told, WM_MDIACTIVATE, reinterpret_cast<WPARAM>(oldHandle),
                         reinterpret_cast<LPARAM>(newHandle));
        }
    }
}

void MdiClientWindow::forget(const MdiChildWindow& child) {
    std::erase(m_history, &child);
    if (m_active != &child) {
        return;
    }
    if (isDestroyed() || topLevel()->isDestroyed()) {
        m_active = nullptr;
        return;
    }
    const bool maximized = child.widget()->isMaximized();
    MdiChildWindow* next = m_history.empty() ? nullptr : m_history.back();
    const HWND handle = next ? next->handle() : nullptr;
    activate(next);
    // Who works with maximised frames goes on with them when one closes.
    Window* still = maximized ? from(handle) : nullptr;
    if (still && still == m_active && !still->widget()->isHidden()) {
        still->show(SW_SHOWMAXIMIZED);
    }
}

std::vector<MdiChildWindow*> MdiClientWindow::shownChildren() const {
    std::vector<MdiChildWindow*> shown;
    for (Window* window : children()) {
        auto* child = dynamic_cast<MdiChildWindow*>(window);
        if (child && !child->isDestroyed() && !child->widget()->isHidden()) {
            shown.push_back(child);
        }
    }
    return shown;
}

void MdiClientWindow::step(int direction) {
    const auto shown = shownChildren();
    const auto at = std::find(shown.begin(), shown.end(), m_active);
    if (shown.size() < 2 || at == shown.end()) {
        return;
    }
    const auto count = static_cast<std::ptrdiff_t>(shown.size());
    activate(shown[static_cast<std::size_t>((at - shown.begin() + direction + count) % count)]);
}

// --- places of child frames ---

QSize MdiClientWindow::room() {
    const QSize own = area()->maximumViewportSize();
    // Before the main frame is shown the area still has the toolkit's size for new widgets.
    return area()->isVisible() ? own : own.expandedTo(topLevel()->clientRect().size());
}

QRect MdiClientWindow::cascadePlace(int number) {
    // Far enough that the caption of the frame below can be read.
    constexpr int offset = 26;
    constexpr int steps = 8;
    const int shift = (number % steps) * offset;
    return {QPoint(shift, shift), room() * 2 / 3};
}

QRect MdiClientWindow::nextPlace(const MdiChildWindow& child) {
    const int number = m_placed++;
    const QRect place = cascadePlace(number);
    if (!m_roomKnown) {
        m_early.push_back({child.handle(), number, place});
    }
    return place;
}

/// A main frame that comes up maximised, or where it was left, has its size only when the desktop has told it. Child
/// frames that were placed earlier, and that nobody has moved since, get the places that fit.
void MdiClientWindow::placeAgain() {
    if (m_roomKnown || isDestroyed() || !area()->isVisible()) {
        return;
    }
    // What moves may have a handler that opens another child frame.
    const std::vector<Early> former = m_early;
    for (Early& early : m_early) {
        early.place = cascadePlace(early.number);
    }
    for (const Early& early : former) {
        auto* child = dynamic_cast<MdiChildWindow*>(from(early.child));
        const QRect place = cascadePlace(early.number);
        Placement* own = child ? child->placement() : nullptr;
        if (own && child->widget()->isMaximized() && own->restored() == early.place) {
            own->setRestored(place);
        } else if (child && child->widget()->geometry() == early.place) {
            child->setWindowRect(place);
        }
    }
    if (!m_told.isActive()) {
        static_cast<void>(startWhenDesktopHasAnswered(m_told));
    }
}

void MdiClientWindow::roomTold() {
    const Placement* main = topLevel()->placement();
    if (main && main->isUnsettled()) {
        static_cast<void>(startWhenDesktopHasAnswered(m_told));
        return;
    }
    m_roomKnown = true;
    m_early.clear();
}

void MdiClientWindow::cascade() {
    auto shown = shownChildren();
    std::erase_if(shown, [](const MdiChildWindow* child) { return child->widget()->isMinimized(); });
    m_placed = 0;
    for (const MdiChildWindow* child : shown) {
        guarded([&] {
            child->subWindow()->showNormal();
            child->subWindow()->setGeometry(cascadePlace(m_placed++));
            child->subWindow()->raise();
        });
    }
}

/// A grid: as many columns (or rows, where they are to stand side by side) as give cells the shape of the room, one
/// for up to three frames. The last ones hold one frame more where the grid does not come out even.
void MdiClientWindow::tile(UINT type) {
    auto shown = shownChildren();
    std::erase_if(shown, [](const MdiChildWindow* child) { return child->widget()->isMinimized(); });
    const auto count = static_cast<int>(shown.size());
    const auto lines = static_cast<int>(std::sqrt(count));
    const QSize size = room();
    int next = 0;
    for (int line = 0; line < lines; ++line) {
        const int held = count / lines + (line >= lines - count % lines ? 1 : 0);
        for (int i = 0; i < held; ++i) {
            const auto cell = [&](int width, int height, int column, int columns, int row, int rows) {
                return QRect(QPoint(width * column / columns, height * row / rows),
                             QPoint(width * (column + 1) / columns - 1, height * (row + 1) / rows - 1));
            };
            const QRect place = (type & MDITILE_HORIZONTAL) != 0
                                    ? cell(size.width(), size.height(), line, lines, i, held)
                                    : cell(size.width(), size.height(), i, held, line, lines);
            guarded([&] {
                shown[static_cast<std::size_t>(next)]->subWindow()->showNormal();
                shown[static_cast<std::size_t>(next)]->subWindow()->setGeometry(place);
            });
            ++next;
        }
    }
}

LRESULT MdiClientWindow::defaultProc(UINT message, WPARAM wParam, LPARAM lParam) {
    auto* child = dynamic_cast<MdiChildWindow*>(from(reinterpret_cast<HWND>(wParam)));
    switch (message) {
    case WM_MDIGETACTIVE:
        if (lParam != 0) {
            *reinterpret_cast<BOOL*>(lParam) = m_active && m_active->widget()->isMaximized() ? TRUE : FALSE;
        }
        return m_active ? reinterpret_cast<LRESULT>(m_active->handle()) : 0;
    case WM_MDIACTIVATE:
        activate(child);
        return 0;
    case WM_MDINEXT:
        step(lParam != 0 ? -1 : 1);
        return 0;
    case WM_MDIMAXIMIZE:
    case WM_MDIRESTORE:
        if (child) {
            child->show(message == WM_MDIMAXIMIZE ? SW_SHOWMAXIMIZED : SW_RESTORE);
        }
        return 0;
    case WM_MDIDESTROY:
        if (child) {
            child->destroy();
        }
        return 0;
    case WM_MDITILE:
        tile(static_cast<UINT>(wParam));
        return TRUE;
    case WM_MDICASCADE:
        cascade();
        return TRUE;
    case WM_SIZE:
        placeAgain();
        return Window::defaultProc(message, wParam, lParam);
    default:
        return Window::defaultProc(message, wParam, lParam);
    }
}

// --- child frames ---

MdiChildWindow::MdiChildWindow(const CREATESTRUCT& cs)
    : Window(cs), m_caption(*this), m_mouse(*this, m_caption), m_defaultPlace(cs.x == CW_USEDEFAULT) {}

QMdiSubWindow* MdiChildWindow::subWindow() const {
    return static_cast<QMdiSubWindow*>(widget());
}

Caption* MdiChildWindow::caption() const {
    return &m_caption;
}

int MdiChildWindow::hitTest(QPoint screen) const {
    return m_caption.hitTest(widget()->mapFromGlobal(screen));
}

void MdiChildWindow::updateFrame() {
    m_caption.update();
}

void MdiChildWindow::stateChanged() {
    m_caption.stateChanged();
}

bool MdiChildWindow::isHeldByCaption() const {
    return m_mouse.isHeld();
}

MdiClientWindow& MdiChildWindow::client() const {
    return static_cast<MdiClientWindow&>(*parent());
}

QWidget* MdiChildWindow::clientWidget() const {
    return m_main;
}

QWidget* MdiChildWindow::childHost() const {
    return m_main;
}

QWidget* MdiChildWindow::makeWidget(QWidget*) {
    auto* sub = new SubWindow;
    m_main = makeMainWidget(sub, Qt::Widget);
    // The toolkit's main window makes itself a top-level window whatever it is told at first.
    m_main->setWindowFlags(Qt::Widget);
    sub->setStyle(&m_caption.style());
    sub->setWidget(m_main);
    guarded([&] { client().area()->addSubWindow(sub); });
    sub->hide();
    return sub;
}

void MdiChildWindow::widgetMade() {
    subWindow()->setWindowTitle(text());
    iconChanged();
    m_systemMenu.owner = handle();
    m_systemMenu.systemMenu = true;
    m_systemMenu.choose = [self = handle()](UINT id) { postMenuCommand(self, id, true); };
    // The toolkit's own has items that frames do not have, and a shortcut.
    guarded([this] {
        subWindow()->setSystemMenu(new PopupMenu(GetSystemMenu(handle(), FALSE), 0, m_systemMenu, subWindow()));
    });
}

void MdiChildWindow::iconChanged() {
    // Without one of its own it would show the toolkit's logo.
    const HICON own = smallIcon ? smallIcon : bigIcon;
    widget()->setWindowIcon(windowIcon(own ? own : LoadIconA(nullptr, IDI_APPLICATION)));
}

void MdiChildWindow::setText(const QString& text) {
    Window::setText(text);
    if (widget()) {
        guarded([&] { widget()->setWindowTitle(text); });
    }
}

void MdiChildWindow::setWindowRect(const QRect& rect) {
    if (std::exchange(m_defaultPlace, false)) {
        Window::setWindowRect(client().nextPlace(*this));
        return;
    }
    Window::setWindowRect(rect);
}

void MdiChildWindow::beforeShow(bool visible) {
    if (visible) {
        applySizeLimits(*this, QSize(0, 0)); // tiled frames may be smaller than users can make them
    }
    forgetToldSize();
}

void MdiChildWindow::showWidget(int command) {
    switch (command) {
    case SW_HIDE:
        widget()->hide();
        break;
    case SW_SHOWMAXIMIZED:
        widget()->showMaximized();
        break;
    case SW_SHOWMINIMIZED:
    case SW_MINIMIZE:
    case SW_SHOWMINNOACTIVE:
        widget()->showMinimized();
        break;
    case SW_SHOWNORMAL:
    case SW_RESTORE:
        widget()->showNormal();
        break;
    default:
        widget()->show();
        break;
    }
}

/// A click on its frame brings the keyboard back into it.
void MdiChildWindow::takeKeyboard() const {
    const HWND focus = GetFocus();
    if (client().active() == this && focus != handle() && !IsChild(handle(), focus)) {
        SetFocus(handle());
    }
}

LRESULT MdiChildWindow::defaultProc(UINT message, WPARAM wParam, LPARAM lParam) {
    if (message == WM_NCLBUTTONDOWN) {
        takeKeyboard();
    }
    if (const auto answer = m_mouse.proc(message, wParam, lParam)) {
        return *answer;
    }
    // The toolkit, which knows captions too, does nothing with them.
    if (m_caption.proc(message, wParam) || (message >= WM_NCMOUSEMOVE && message <= WM_NCMBUTTONDOWN)) {
        return 0;
    }
    if (message == WM_DESTROY) {
        client().forget(*this);
    }
    if (message == WM_THEMECHANGED) {
        guarded([this] {
            subWindow()->setStyle(nullptr); // the one there is now goes
            m_caption.renewStyle();
            subWindow()->setStyle(&m_caption.style());
        });
        return 0;
    }
    if (message == WM_SYSCOMMAND) {
        switch (wParam & 0xFFF0U) {
        case SC_NEXTWINDOW:
        case SC_PREVWINDOW:
            return SendMessageA(client().handle(), WM_MDINEXT, 0, (wParam & 0xFFF0U) == SC_PREVWINDOW ? 1 : 0);
        default:
            break;
        }
    }
    return Window::defaultProc(message, wParam, lParam);
}

} // namespace tvx::afx
