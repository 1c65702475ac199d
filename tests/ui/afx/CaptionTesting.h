#pragma once

/// @file
/// Windows that draw their caption themselves, and what a user does with it.

#include "afxwin.h"
#include "platform/afx/core/detail/Window.h"

#include <QApplication>
#include <QTest>
#include <QWindow>

#include <functional>
#include <map>
#include <vector>

namespace captiontest {

/// The messages that a test is about, and how it wants them answered.
struct Log {
    using Answer = std::function<bool(LPARAM, LRESULT&)>;
    std::map<UINT, Answer> on; ///< true: what is behind does not hear of the message
    std::vector<std::pair<UINT, WPARAM>> seen;

    std::vector<WPARAM> of(UINT message) const {
        std::vector<WPARAM> values;
        for (const auto& [each, value] : seen) {
            if (each == message) {
                values.push_back(value);
            }
        }
        return values;
    }
};

template <class Base>
class Probe : public Base, public Log {
protected:
    LRESULT WindowProc(UINT message, WPARAM wParam, LPARAM lParam) override {
        const auto answer = on.find(message);
        if (answer == on.end()) {
            return Base::WindowProc(message, wParam, lParam);
        }
        seen.emplace_back(message, wParam);
        LRESULT result = 0;
        return answer->second && answer->second(lParam, result) ? result : Base::WindowProc(message, wParam, lParam);
    }
};

inline QWidget& widgetOf(const CWnd& window) {
    return *window.GetState()->widget();
}
inline QRect placeOf(const CWnd& window) {
    CRect rect;
    window.GetWindowRect(rect);
    return {rect.left, rect.top, rect.Width(), rect.Height()};
}
inline QPoint pointOf(LPARAM parameter) {
    return {GET_X_LPARAM(parameter), GET_Y_LPARAM(parameter)};
}

/// The part at a point of the window's widget.
inline int partAt(const CWnd& window, QPoint point) {
    const QPoint screen = widgetOf(window).mapToGlobal(point);
    return static_cast<int>(window.SendMessage(WM_NCHITTEST, 0, MAKELPARAM(screen.x(), screen.y())));
}
/// The parts along a line of the widget, each once for each time that it begins; bare caption in the caption's line
/// left out.
inline std::vector<int> partsAlong(const CWnd& window, QPoint from, QPoint step) {
    std::vector<int> parts;
    for (QPoint at = from; widgetOf(window).rect().contains(at); at += step) {
        if (const int part = partAt(window, at); parts.empty() || parts.back() != part) {
            parts.push_back(part);
        }
    }
    return parts;
}
/// The middle of a part in the upper rows of the window.
inline QPoint middleOf(const CWnd& window, int part) {
    QRegion region;
    for (int y = 0; y < 40; ++y) {
        for (int x = 0; x < widgetOf(window).width(); ++x) {
            if (partAt(window, QPoint(x, y)) == part) {
                region += QRect(x, y, 1, 1);
            }
        }
    }
    return region.boundingRect().center();
}

} // namespace captiontest
