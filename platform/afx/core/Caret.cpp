#include "platform/afx/core/WindowCalls.h"
#include "platform/afx/core/Wnd.h"
#include "platform/afx/core/detail/Loop.h"
#include "platform/afx/core/detail/Window.h"
#include "platform/afx/gdi/Gdi.h"

#include <QApplication>
#include <QBasicTimer>
#include <QPainter>
#include <QPointer>
#include <QStyleHints>
#include <QTimerEvent>

// The caret is a small widget over the client area. Contexts draw around child widgets, so nothing that a host draws
// has to take it away first.

using namespace tvx::afx;

namespace {

class Caret : public QWidget {
public:
    Caret(QWidget* over, HWND window, const QSize& size) : QWidget(over), m_window(window) {
        setAttribute(Qt::WA_TransparentForMouseEvents);
        setFocusPolicy(Qt::NoFocus);
        resize(size);
        QWidget::hide();
    }

    [[nodiscard]] HWND window() const {
        return m_window;
    }
    /// A caret that comes or moves is to be seen at once, whatever its blinking was about to do.
    void begin() {
        m_timer.stop();
        setVisible(m_hidden == 0);
        raise();
        const int period = QApplication::styleHints()->cursorFlashTime();
        if (m_hidden == 0 && period > 0) {
            m_timer.start(period / 2, this);
        }
    }
    void count(int step) {
        m_hidden = std::max(m_hidden + step, 0);
        begin();
    }

protected:
    void paintEvent(QPaintEvent*) override {
        QPainter(this).fillRect(rect(), palette().color(QPalette::WindowText));
    }
    void timerEvent(QTimerEvent* event) override {
        if (event->timerId() == m_timer.timerId()) {
            setVisible(isHidden());
        }
    }

private:
    HWND m_window;
    QBasicTimer m_timer;
    int m_hidden = 1;
};

/// The one caret; its widget ends with the window's.
QPointer<Caret>& caret() {
    static QPointer<Caret> current;
    return current;
}

/// Does something with the caret if it is that window's (null: any), else answers FALSE.
template <class Call>
BOOL withCaret(HWND window, Call&& call) {
    Caret* current = caret();
    if (!current || (window && current->window() != window)) {
        return FALSE;
    }
    guarded([&] { call(*current); });
    return TRUE;
}

QPoint clientOrigin(HWND handle) {
    const Window* window = Window::from(handle);
    return window ? window->clientRect().topLeft() : QPoint();
}

} // namespace

BOOL CreateCaret(HWND handle, HBITMAP bitmap, int width, int height) {
    const Window* window = Window::from(handle);
    if (!window || !window->clientWidget()) {
        return FALSE;
    }
    BITMAP picture{};
    if (reinterpret_cast<UINT_PTR>(bitmap) > 1 && GetObjectA(bitmap, sizeof(picture), &picture) != 0) {
        width = picture.bmWidth;
        height = picture.bmHeight;
    }
    const QSize size(width > 0 ? width : GetSystemMetrics(SM_CXBORDER), height > 0 ? height : 1);
    guarded([&] {
        delete caret();
        caret() = new Caret(window->clientWidget(), handle, size);
        caret()->move(clientOrigin(handle));
    });
    return TRUE;
}

BOOL DestroyCaret() {
    return withCaret(nullptr, [](const Caret& current) { delete &current; });
}

BOOL SetCaretPos(int x, int y) {
    return withCaret(nullptr, [&](Caret& current) {
        current.move(clientOrigin(current.window()) + QPoint(x, y));
        current.begin();
    });
}

BOOL GetCaretPos(POINT* point) {
    *point = {};
    return withCaret(nullptr,
                     [&](const Caret& current) { *point = fromQt(current.pos() - clientOrigin(current.window())); });
}

BOOL ShowCaret(HWND window) {
    return withCaret(window, [](Caret& current) { current.count(-1); });
}

BOOL HideCaret(HWND window) {
    return withCaret(window, [](Caret& current) { current.count(1); });
}

void CWnd::CreateCaret(CBitmap* bitmap) {
    ::CreateCaret(m_hWnd, bitmap ? static_cast<HBITMAP>(*bitmap) : nullptr, 0, 0);
}

CPoint CWnd::GetCaretPos() {
    CPoint point;
    ::GetCaretPos(&point);
    return point;
}
