#include "platform/afx/controls/detail/TabWindow.h"

#include "platform/afx/core/detail/Connect.h"
#include "platform/afx/core/detail/Dispatch.h"
#include "platform/afx/core/detail/Loop.h"

#include <QSignalBlocker>
#include <QStyleOptionTabWidgetFrame>
#include <QStylePainter>
#include <QTabBar>
#include <QWheelEvent>

#include <algorithm>

namespace tvx::afx {

namespace {

/// A row of tabs in which the wheel changes nothing: who scrolls a page must not leave it at its edge.
class Tabs : public QTabBar {
public:
    explicit Tabs(QWidget* parent) : QTabBar(parent) {
        setDrawBase(false); // the frame below is its base
        setUsesScrollButtons(true);
    }

protected:
    void wheelEvent(QWheelEvent* event) override {
        event->ignore();
    }
};

/// The row of tabs with the frame of the page below it.
class TabFace : public QWidget {
public:
    explicit TabFace(QWidget* parent) : QWidget(parent), m_tabs(new Tabs(this)) {}
    QTabBar& tabs() const {
        return *m_tabs;
    }
    /// The frame around the page, of which the row of tabs covers the upper edge.
    QRect frame() const {
        return rect().adjusted(0, m_tabs->sizeHint().height() - overlap(), 0, 0);
    }
    int overlap() const {
        return style()->pixelMetric(QStyle::PM_TabBarBaseOverlap, nullptr, this);
    }
    int frameWidth() const {
        return std::max(2, style()->pixelMetric(QStyle::PM_DefaultFrameWidth, nullptr, this));
    }
    void place() {
        const QSize wanted = m_tabs->sizeHint();
        m_tabs->setGeometry(0, 0, std::min(wanted.width(), width()), wanted.height());
        update();
    }

protected:
    void resizeEvent(QResizeEvent*) override {
        place();
    }
    void changeEvent(QEvent* event) override {
        if (event->type() == QEvent::FontChange || event->type() == QEvent::StyleChange) {
            place();
        }
        QWidget::changeEvent(event);
    }
    void paintEvent(QPaintEvent*) override {
        QStylePainter painter(this);
        QStyleOptionTabWidgetFrame option;
        option.initFrom(this);
        option.rect = frame();
        option.lineWidth = frameWidth();
        option.shape = QTabBar::RoundedNorth;
        option.tabBarRect = m_tabs->geometry();
        option.tabBarSize = m_tabs->size();
        option.selectedTabRect = m_tabs->tabRect(m_tabs->currentIndex());
        painter.drawPrimitive(QStyle::PE_FrameTabWidget, option);
    }

private:
    Tabs* m_tabs;
};

std::unique_ptr<Window> makeTabs(const CREATESTRUCT& cs) {
    return std::make_unique<TabWindow>(cs);
}

const WindowClassEntry tabEntry(tabClass, &makeTabs);

TabFace& faceOf(const Window& window) {
    return *static_cast<TabFace*>(window.widget());
}

} // namespace

QWidget* TabWindow::makeWidget(QWidget* parent) {
    auto* face = new TabFace(parent);
    connectStoring(&face->tabs(), &QTabBar::currentChanged, face, [this] { tell(); });
    return face;
}

QTabBar& TabWindow::bar() const {
    return faceOf(*this).tabs();
}

QWidget* TabWindow::focusWidget() const {
    return &bar();
}

UINT TabWindow::dialogCode(const MSG*) const {
    return DLGC_WANTARROWS;
}

int TabWindow::current() const {
    return bar().currentIndex();
}

void TabWindow::select(int index) {
    const QSignalBlocker quiet(bar());
    guarded([&] {
        bar().setCurrentIndex(index);
        widget()->update();
    });
}

void TabWindow::insert(int index, const QString& caption) {
    const QSignalBlocker quiet(bar());
    guarded([&] {
        bar().insertTab(index, caption);
        faceOf(*this).place();
    });
}

void TabWindow::remove(int index) {
    const QSignalBlocker quiet(bar());
    guarded([&] {
        bar().removeTab(index);
        faceOf(*this).place();
    });
}

QRect TabWindow::pageArea() const {
    const int width = faceOf(*this).frameWidth();
    return faceOf(*this).frame().adjusted(width, width, -width, -width);
}

QSize TabWindow::sizeAround(QSize page) const {
    const int frame = 2 * faceOf(*this).frameWidth();
    return page + QSize(frame, frame + bar().sizeHint().height() - faceOf(*this).overlap());
}

int TabWindow::tabsWidth() const {
    return bar().sizeHint().width();
}

void TabWindow::tell() {
    widget()->update();
    armIdle();
    if (parent() && !isDestroyed()) {
        NMHDR header{handle(), static_cast<UINT_PTR>(id()), TCN_SELCHANGE};
        SendMessageA(parent()->handle(), WM_NOTIFY, header.idFrom, reinterpret_cast<LPARAM>(&header));
    }
}

} // namespace tvx::afx
