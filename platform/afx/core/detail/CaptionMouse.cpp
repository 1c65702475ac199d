#include "platform/afx/core/detail/CaptionMouse.h"

#include "platform/afx/core/WindowCalls.h"
#include "platform/afx/core/detail/Caption.h"
#include "platform/afx/core/detail/Capture.h"
#include "platform/afx/core/detail/Cursors.h"
#include "platform/afx/core/detail/Loop.h"
#include "platform/afx/core/detail/MenuWidgets.h"
#include "platform/afx/core/detail/Window.h"

#include <QApplication>
#include <QWidget>
#include <QWindow>

#include <algorithm>
#include <utility>

namespace tvx::afx {

namespace {

bool isButton(int part) {
    return part == HTCLOSE || part == HTMAXBUTTON || part == HTMINBUTTON;
}

Qt::Edges edgesOf(int part) {
    switch (part) {
    case HTLEFT:
        return Qt::LeftEdge;
    case HTRIGHT:
        return Qt::RightEdge;
    case HTTOP:
        return Qt::TopEdge;
    case HTBOTTOM:
        return Qt::BottomEdge;
    case HTTOPLEFT:
        return Qt::TopEdge | Qt::LeftEdge;
    case HTTOPRIGHT:
        return Qt::TopEdge | Qt::RightEdge;
    case HTBOTTOMLEFT:
        return Qt::BottomEdge | Qt::LeftEdge;
    case HTBOTTOMRIGHT:
        return Qt::BottomEdge | Qt::RightEdge;
    default:
        return {};
    }
}

Qt::CursorShape cursorOf(int part) {
    switch (part) {
    case HTLEFT:
    case HTRIGHT:
        return Qt::SizeHorCursor;
    case HTTOP:
    case HTBOTTOM:
        return Qt::SizeVerCursor;
    case HTTOPLEFT:
    case HTBOTTOMRIGHT:
        return Qt::SizeFDiagCursor;
    case HTTOPRIGHT:
    case HTBOTTOMLEFT:
        return Qt::SizeBDiagCursor;
    default:
        return Qt::ArrowCursor;
    }
}

QPoint pointOf(LPARAM parameter) {
    return {GET_X_LPARAM(parameter), GET_Y_LPARAM(parameter)};
}

} // namespace

namespace {

HWND handedOver = nullptr;

} // namespace

bool isHeldByDesktop(HWND window) {
    // The toolkit lets go of the button when the window manager does.
    return handedOver == window && QGuiApplication::mouseButtons().testFlag(Qt::LeftButton);
}

CaptionMouse::CaptionMouse(Window& window, Caption& caption) : m_window(window), m_caption(caption) {}

bool CaptionMouse::changesSize() const {
    return edgesOf(m_part) != Qt::Edges();
}

std::optional<LRESULT> CaptionMouse::proc(UINT message, WPARAM wParam, LPARAM lParam) {
    const auto part = static_cast<int>(wParam);
    if (part == HTMENU && message >= WM_NCMOUSEMOVE && message <= WM_NCMBUTTONDOWN) {
        hover(HTNOWHERE);
        return std::nullopt; // the menu bar's own
    }
    switch (message) {
    case WM_NCLBUTTONDOWN:
        return press(part, pointOf(lParam)) ? std::optional<LRESULT>(0) : std::nullopt;
    case WM_NCLBUTTONDBLCLK:
        doubleClick(part, pointOf(lParam));
        return 0;
    case WM_NCMOUSEMOVE:
        hover(part);
        return 0;
    case WM_SETCURSOR:
        return reinterpret_cast<HWND>(wParam) == m_window.handle() && showCursor(LOWORD(lParam))
                   ? std::optional<LRESULT>(TRUE)
                   : std::nullopt;
    case WM_NCRBUTTONUP:
        if (part == HTCAPTION || part == HTSYSMENU) {
            showSystemMenu(m_window, {GET_X_LPARAM(lParam), GET_Y_LPARAM(lParam)});
        }
        return 0;
    case WM_MOUSEMOVE:
    case WM_LBUTTONUP:
        if (m_part == 0) {
            return std::nullopt;
        }
        if (message == WM_MOUSEMOVE) {
            drag(m_window.clientToScreen(pointOf(lParam)));
        } else {
            release(m_window.clientToScreen(pointOf(lParam)));
        }
        return 0;
    case WM_NCMOUSELEAVE:
        hover(HTNOWHERE);
        return std::nullopt;
    case WM_CANCELMODE:
        if (std::exchange(m_began, false)) {
            m_window.setWindowRect(m_place);
        }
        return std::nullopt;
    case WM_CAPTURECHANGED:
        if (std::exchange(m_part, 0) != 0 && std::exchange(m_caption.pressed, 0) != 0) {
            m_caption.update();
        }
        return 0;
    default:
        return std::nullopt;
    }
}

bool CaptionMouse::showCursor(int part) {
    if (cursorOf(part) == Qt::ArrowCursor) {
        return false;
    }
    showEdgeCursor(m_window.handle(), cursorOf(part));
    return true;
}

bool CaptionMouse::press(int part, QPoint at) {
    handedOver = nullptr;
    if (part == HTSYSMENU) {
        QWidget& widget = *m_window.widget();
        const QPoint below = widget.mapToGlobal(m_caption.systemMenuRect().bottomLeft() + QPoint(0, 1));
        showSystemMenu(m_window, {below.x(), below.y()});
        return true;
    }
    m_part = part;
    const bool isHeld = isButton(part) || part == HTCAPTION || changesSize();
    if (!isHeld) {
        m_part = 0;
        return false;
    }
    m_from = at;
    m_place = m_window.windowRect();
    m_began = false;
    SetCapture(m_window.handle());
    if (isButton(part)) {
        m_caption.pressed = part;
        m_caption.hovered = part;
        m_caption.update();
    } else if (changesSize()) {
        begin();
    }
    return true;
}

/// Hands a move or a change of size to the window manager. By hand only where there is none that does it.
void CaptionMouse::begin() {
    QWindow* native = m_window.widget()->windowHandle();
    const Qt::Edges edges = edgesOf(m_part);
    bool taken = false;
    guarded([&] { taken = native && (changesSize() ? native->startSystemResize(edges) : native->startSystemMove()); });
    if (taken) {
        handedOver = m_window.handle();
        ReleaseCapture(); // the release of the button is the window manager's
    } else {
        m_began = true;
    }
}

void CaptionMouse::drag(QPoint at) {
    if (isButton(m_part)) {
        const int over = m_caption.hitTest(m_window.widget()->mapFromGlobal(at));
        if (std::exchange(m_caption.hovered, over) != over) {
            m_caption.update();
        }
        return;
    }
    // A double click wobbles; it must not move the window.
    if (!m_began && (at - m_from).manhattanLength() >= QApplication::startDragDistance()) {
        begin();
    }
    if (m_began) {
        moveByHand(at);
    }
}

namespace {

/// Moves one end of a stretch by as much as its length may change.
int movedEnd(int by, int length, int least, int most, bool isFirst) {
    const int wanted = isFirst ? length - by : length + by;
    const int possible = std::clamp(wanted, std::min(least, most), most);
    return isFirst ? length - possible : possible - length;
}

} // namespace

void CaptionMouse::moveByHand(QPoint at) {
    const QWidget& widget = *m_window.widget();
    if (widget.isMaximized()) {
        return;
    }
    const QPoint by = at - m_from;
    if (!changesSize()) {
        QRect place = m_place.translated(by);
        if (m_window.isChild()) {
            place.moveTop(std::max(place.top(), 0)); // the caption stays within reach
        }
        m_window.setWindowRect(place);
        return;
    }
    const Qt::Edges edges = edgesOf(m_part);
    const QSize least = widget.minimumSizeHint().expandedTo(widget.minimumSize());
    const QSize most = widget.maximumSize();
    QRect place = m_place;
    if ((edges & (Qt::LeftEdge | Qt::RightEdge)) != Qt::Edges()) {
        const bool isFirst = edges.testFlag(Qt::LeftEdge);
        const int moved = movedEnd(by.x(), place.width(), least.width(), most.width(), isFirst);
        place.adjust(isFirst ? moved : 0, 0, isFirst ? 0 : moved, 0);
    }
    if ((edges & (Qt::TopEdge | Qt::BottomEdge)) != Qt::Edges()) {
        const bool isFirst = edges.testFlag(Qt::TopEdge);
        const int moved = movedEnd(by.y(), place.height(), least.height(), most.height(), isFirst);
        place.adjust(0, isFirst ? moved : 0, 0, isFirst ? 0 : moved);
    }
    m_window.setWindowRect(place);
}

void CaptionMouse::release(QPoint at) {
    const int part = m_part;
    const int over = m_caption.hitTest(m_window.widget()->mapFromGlobal(at));
    ReleaseCapture(); // which ends the press
    if (!isButton(part) || over != part) {
        return;
    }
    PostMessageA(m_window.handle(), WM_SYSCOMMAND, commandOf(part), 0);
}

/// What a button stands for: one of those that change the size brings the window back from the state it is in.
WPARAM CaptionMouse::commandOf(int part) const {
    const QWidget& widget = *m_window.widget();
    const bool isMinimized = widget.isMinimized();
    if (part == HTCLOSE) {
        return SC_CLOSE;
    }
    if (part == HTMINBUTTON) {
        return isMinimized ? SC_RESTORE : SC_MINIMIZE;
    }
    return widget.isMaximized() && !isMinimized ? SC_RESTORE : SC_MAXIMIZE;
}

void CaptionMouse::doubleClick(int part, QPoint at) {
    const HWND handle = m_window.handle();
    if (part == HTSYSMENU) {
        PostMessageA(handle, WM_SYSCOMMAND, SC_CLOSE, 0);
    } else if (part != HTCAPTION) {
        press(part, at);
    } else if (m_window.widget()->isMinimized()) {
        PostMessageA(handle, WM_SYSCOMMAND, SC_RESTORE, 0);
    } else if ((m_window.style() & WS_MAXIMIZEBOX) != 0) {
        PostMessageA(handle, WM_SYSCOMMAND, commandOf(HTMAXBUTTON), 0);
    }
}

void CaptionMouse::hover(int part) {
    const int button = isButton(part) ? part : HTNOWHERE;
    if (m_part == 0 && std::exchange(m_caption.hovered, button) != button) {
        m_caption.update();
    }
}

} // namespace tvx::afx
