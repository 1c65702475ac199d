#pragma once

/// @file
/// Windows that draw their caption themselves, and the acts of a user on it.

#include "afxwin.h"
#include "platform/afx/core/detail/Window.h"

#include <QApplication>
#include <QScreen>
#include <QTest>
#include <QWindow>

#include <functional>
#include <map>
#include <utility>
#include <vector>

namespace captiontest {

/// Writes down the messages that a test is about, and answers them as the test wants.
template <class Base>
class Probe : public Base {
public:
    using Answer = std::function<bool(LPARAM, LRESULT&)>;
    std::map<UINT, Answer> on; ///< true: what is behind does not hear of the message
    std::vector<std::pair<UINT, WPARAM>> seen;

    QWidget& widget() const {
        return *this->GetState()->widget();
    }
    std::vector<WPARAM> of(UINT message) const {
        std::vector<WPARAM> values;
        for (const auto& [each, value] : seen) {
            if (each == message) {
                values.push_back(value);
            }
        }
        return values;
    }

protected:
    LRESULT WindowProc(UINT message, WPARAM wParam, LPARAM lParam) override {
        const bool isOfFrame = message >= WM_NCMOUSEMOVE && message <= WM_NCMBUTTONDOWN;
        const auto answer = on.find(message);
        if (isOfFrame || answer != on.end() || message == WM_SYSCOMMAND) {
            seen.emplace_back(message, wParam);
        }
        LRESULT result = 0;
        const bool isTaken = answer != on.end() && answer->second && answer->second(lParam, result);
        return isTaken ? result : Base::WindowProc(message, wParam, lParam);
    }
};

inline void settle() {
    for (int i = 0; i < 3; ++i) {
        QCoreApplication::sendPostedEvents();
        QCoreApplication::processEvents();
    }
    for (QWidget* top : QApplication::topLevelWidgets()) {
        QEvent update(QEvent::UpdateRequest);
        QApplication::sendEvent(top, &update);
    }
}

/// The part at a point of the window's widget.
inline int partAt(const CWnd& window, QPoint point) {
    const QPoint screen = window.GetState()->widget()->mapToGlobal(point);
    return static_cast<int>(window.SendMessage(WM_NCHITTEST, 0, MAKELPARAM(screen.x(), screen.y())));
}
/// The parts along a line of the widget, each once for each time that it begins.
inline std::vector<int> partsAlong(const CWnd& window, QPoint from, QPoint step) {
    std::vector<int> parts;
    const QRect rect = window.GetState()->widget()->rect();
    for (QPoint at = from; rect.contains(at); at += step) {
        if (const int part = partAt(window, at); parts.empty() || parts.back() != part) {
            parts.push_back(part);
        }
    }
    return parts;
}
/// The middle of a part.
inline QPoint middleOf(const CWnd& window, int part) {
    QRegion region;
    const QRect rect = window.GetState()->widget()->rect();
    for (int y = 0; y < std::min(rect.height(), 60); ++y) {
        for (int x = 0; x < rect.width(); ++x) {
            if (partAt(window, QPoint(x, y)) == part) {
                region += QRect(x, y, 1, 1);
            }
        }
    }
    return region.boundingRect().center();
}

enum class Act { Move, Press, Release, DoubleClick };
/// Does with the mouse what a user does; `at` counts in the widget's coordinates and may be outside.
inline void mouse(const QWidget& widget, Act act, QPoint at, Qt::MouseButton button = Qt::LeftButton) {
    QWindow* window = widget.window()->windowHandle();
    const QPoint place = widget.mapTo(widget.window(), at);
    switch (act) {
    case Act::Move:
        QTest::mouseMove(window, place);
        break;
    case Act::Press:
        QTest::mouseMove(window, place);
        QTest::mousePress(window, button, {}, place);
        break;
    case Act::Release:
        QTest::mouseRelease(window, button, {}, place);
        break;
    case Act::DoubleClick:
        QTest::mouseDClick(window, button, {}, place);
        break;
    }
    settle();
}

/// What the screen shows of a window's widget.
inline QImage shown(const QWidget& widget) {
    settle();
    QWidget* top = widget.window();
    const QImage image = top->screen()->grabWindow(top->winId()).toImage();
    const double ratio = image.devicePixelRatio();
    return image.copy(QRect(widget.mapTo(top, QPoint()) * ratio, widget.size() * ratio));
}

} // namespace captiontest
