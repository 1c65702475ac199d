#include "platform/afx/core/detail/KeyMove.h"

#include "platform/afx/core/WindowCalls.h"
#include "platform/afx/core/Wnd.h"
#include "platform/afx/core/detail/Dispatch.h"
#include "platform/afx/core/detail/Keys.h"
#include "platform/afx/gdi/detail/Geometry.h"

#include <QApplication>

namespace tvx::afx {

namespace {

/// Shows for as long as it lives that the keyboard moves something.
class MoveCursor {
public:
    explicit MoveCursor(KeyChange change) {
        QApplication::setOverrideCursor(change == KeyChange::Place ? Qt::SizeAllCursor : Qt::SizeFDiagCursor);
    }
    ~MoveCursor() {
        QApplication::restoreOverrideCursor();
    }
    MoveCursor(const MoveCursor&) = delete;
    MoveCursor& operator=(const MoveCursor&) = delete;
};

/// The place in the coordinates that SetWindowPos takes: the parent's for a child, else the screen's.
CRect placeOf(HWND window) {
    CRect place;
    GetWindowRect(window, &place);
    if ((GetWindowLong(window, GWL_STYLE) & WS_CHILD) != 0) {
        MapWindowPoints(nullptr, GetParent(window), reinterpret_cast<POINT*>(static_cast<RECT*>(&place)), 2);
    }
    return place;
}

void setPlace(HWND window, const CRect& place) {
    SetWindowPos(window, nullptr, place.left, place.top, place.Width(), place.Height(), SWP_NOZORDER | SWP_NOACTIVATE);
}

/// How far a key goes, 0 both ways for one that goes nowhere.
CSize stepOf(WPARAM key) {
    constexpr int grid = 8;
    const int step = isKeyDown(VK_CONTROL) ? 1 : grid;
    switch (key) {
    case VK_LEFT:
        return {-step, 0};
    case VK_RIGHT:
        return {step, 0};
    case VK_UP:
        return {0, -step};
    case VK_DOWN:
        return {0, step};
    default:
        return {0, 0};
    }
}

void changeBy(HWND window, KeyChange change, CSize step) {
    CRect place = placeOf(window);
    if (change == KeyChange::Place) {
        place.OffsetRect(step.cx, step.cy);
    } else {
        place.right += step.cx;
        place.bottom += step.cy;
    }
    setPlace(window, place);
}

bool isPress(UINT message) {
    return message == WM_LBUTTONDOWN || message == WM_RBUTTONDOWN || message == WM_MBUTTONDOWN;
}

} // namespace

void changeByKeys(HWND window, KeyChange change) {
    const CRect before = placeOf(window);
    const MoveCursor cursor(change);
    MSG msg;
    while (IsWindow(window) && GetMessageA(&msg, nullptr, 0, 0)) {
        const bool key = msg.message >= WM_KEYFIRST && msg.message <= WM_KEYLAST;
        if (!key) {
            DispatchMessageA(&msg);
            if (isPress(msg.message)) {
                return;
            }
            continue;
        }
        if (msg.message != WM_KEYDOWN) {
            continue;
        }
        if (msg.wParam == VK_RETURN) {
            return;
        }
        if (msg.wParam == VK_ESCAPE) {
            setPlace(window, before);
            return;
        }
        changeBy(window, change, stepOf(msg.wParam));
    }
}

} // namespace tvx::afx
