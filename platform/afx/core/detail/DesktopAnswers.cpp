#include "platform/afx/core/detail/DesktopAnswers.h"

#include "platform/afx/core/detail/Connect.h"
#include "platform/afx/core/detail/Placement.h"
#include "platform/afx/core/detail/Window.h"
#include "platform/win/detail/DesktopAnswers.h"

#include <QAbstractNativeEventFilter>
#include <QGuiApplication>
#include <QPointer>
#include <QTimer>

#include <chrono>
#include <cmath>
#include <deque>
#include <memory>
#include <utility>

namespace tvx::afx {

namespace {

/// After this time, in milliseconds, a window manager is taken for one that does not tell. It is far beyond what a busy
/// machine needs; nothing but a manager that hangs or has been replaced makes it elapse.
constexpr int longestWait = 10000;

/// The questions of this process that are not answered yet. Lives as long as the toolkit's application object.
class Questions : public QObject, public QAbstractNativeEventFilter {
public:
    explicit Questions(void* connection) : QObject(qApp), m_connection(connection) {
        begin();
        m_overdue.setSingleShot(true);
        m_overdue.setInterval(longestWait);
        connectStoring(&m_overdue, &QTimer::timeout, this, [this] { giveUp(); });
        qApp->installNativeEventFilter(this);
    }

    bool add(QTimer& timer) {
        if (!m_answers->ask()) {
            return false;
        }
        m_waiting.emplace_back(&timer);
        m_overdue.start();
        return true;
    }

    bool nativeEventFilter(const QByteArray&, void* event, qintptr*) override {
        const std::uint32_t window = m_answers->windowOf(event);
        if (m_answers->isAnswer(window)) {
            answer();
        } else if (window != 0) {
            tellBorders(window);
        }
        return false;
    }

private:
    void begin() {
        m_answers = std::make_unique<tvx::detail::DesktopAnswers>(m_connection);
    }
    void answer() {
        if (m_waiting.empty()) {
            return;
        }
        if (QTimer* timer = m_waiting.front()) {
            timer->start();
        }
        m_waiting.pop_front();
        if (m_waiting.empty()) {
            m_overdue.stop();
        }
    }
    /// A new window to ask with: answers to the old one may still come, and would be taken for those of later
    /// questions.
    void giveUp() {
        while (!m_waiting.empty()) {
            answer();
        }
        begin();
    }
    /// Borders that change nothing of a window's place and size come without an event of the toolkit.
    static void tellBorders(std::uint32_t window) {
        const QWidget* widget = QWidget::find(window);
        const Window* ours = widget ? Window::of(widget) : nullptr;
        if (ours && ours->placement()) {
            ours->placement()->bordersChanged();
        }
    }

    void* m_connection;
    std::unique_ptr<tvx::detail::DesktopAnswers> m_answers;
    std::deque<QPointer<QTimer>> m_waiting;
    QTimer m_overdue;
};

/// Null where the display is not an X server.
Questions* questions() {
    static QPointer<Questions> instance;
    const auto* x11 = instance ? nullptr : qApp->nativeInterface<QNativeInterface::QX11Application>();
    if (x11 && x11->connection()) {
        instance = new Questions(x11->connection());
    }
    return instance;
}

} // namespace

namespace {

QMargins askForBorders() {
    using namespace std::chrono_literals;
    const auto* x11 = qApp->nativeInterface<QNativeInterface::QX11Application>();
    if (!x11 || !x11->connection()) {
        return {};
    }
    // A window manager that is as busy as that is not waited for: the window is then told without its borders.
    const auto borders = tvx::detail::DesktopAnswers(x11->connection()).waitForBorders(500ms);
    const auto units = [](std::uint32_t pixels) {
        return static_cast<int>(std::lround(pixels / qApp->devicePixelRatio()));
    };
    return borders ? QMargins(units(borders->left), units(borders->top), units(borders->right), units(borders->bottom))
                   : QMargins();
}

} // namespace

QMargins expectedWindowBorders() {
    static const QMargins borders = askForBorders();
    return borders;
}

Told startWhenDesktopHasAnswered(QTimer& timer) {
    Questions* asked = questions();
    if (asked && asked->add(timer)) {
        return Told::ByManager;
    }
    timer.start();
    return Told::ByNobody;
}

} // namespace tvx::afx
