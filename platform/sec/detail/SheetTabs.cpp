#include "platform/sec/detail/SheetTabs.h"

#include "platform/afx/core/detail/Connect.h"
#include "platform/afx/frames/detail/MdiWindow.h"

#include <QChildEvent>
#include <QMdiArea>
#include <QMdiSubWindow>

#include <utility>

using namespace tvx::afx;

namespace tvx::sec {

SheetTabs::SheetTabs(MdiClientWindow& client) : QTabBar(client.area()), m_client(client.handle()) {
    setShape(QTabBar::RoundedSouth);
    setDocumentMode(true);
    setExpanding(false);
    setElideMode(Qt::ElideMiddle);
    setUsesScrollButtons(true);
    setFocusPolicy(Qt::NoFocus); // a click leaves the keyboard with the view
    setAutoHide(false);
    hide();
    m_later.setSingleShot(true);
    connectStoring(&m_later, &QTimer::timeout, this, [this] { follow(); });
    connectStoring(this, &QTabBar::currentChanged, this, [this](int index) { choose(index); });
    connectStoring(client.area(), &QMdiArea::subWindowActivated, this, [this](QMdiSubWindow*) { m_later.start(0); });
    client.area()->viewport()->installEventFilter(this);
}

QSize SheetTabs::minimumSizeHint() const {
    return {0, QTabBar::minimumSizeHint().height()};
}

void SheetTabs::setIcon(const QMdiSubWindow& sheet, const QIcon& icon, bool atOnce) {
    if (icon.isNull()) {
        m_icons.remove(&sheet);
    } else {
        m_icons.insert(&sheet, icon);
    }
    if (atOnce) {
        follow();
    } else {
        m_later.start(0);
    }
}

bool SheetTabs::eventFilter(QObject* watched, QEvent* event) {
    switch (event->type()) {
    case QEvent::ChildAdded:
        static_cast<QChildEvent*>(event)->child()->installEventFilter(this);
        m_later.start(0);
        break;
    case QEvent::ChildRemoved:
        m_icons.remove(static_cast<QChildEvent*>(event)->child());
        m_later.start(0);
        break;
    case QEvent::ShowToParent:
    case QEvent::HideToParent:
    case QEvent::WindowTitleChange:
    case QEvent::WindowIconChange:
        m_later.start(0);
        break;
    default:
        break;
    }
    return QTabBar::eventFilter(watched, event);
}

MdiClientWindow* SheetTabs::client() const {
    auto* window = dynamic_cast<MdiClientWindow*>(Window::from(m_client));
    return window && !window->isDestroyed() ? window : nullptr;
}

void SheetTabs::follow() {
    MdiClientWindow* window = client();
    if (!window) {
        return;
    }
    QList<QMdiSubWindow*> sheets = window->area()->subWindowList(QMdiArea::CreationOrder);
    sheets.removeIf([](const QMdiSubWindow* sheet) { return sheet->isHidden(); });
    const bool outer = std::exchange(m_following, true);
    fill(sheets);
    const MdiChildWindow* active = window->active();
    const auto current = active ? sheets.indexOf(active->subWindow()) : -1;
    setCurrentIndex(static_cast<int>(current));
    m_following = outer;
    if (isHidden() != sheets.isEmpty()) {
        setVisible(!sheets.isEmpty());
        window->placeFoot();
    }
}

void SheetTabs::fill(const QList<QMdiSubWindow*>& sheets) {
    while (count() > sheets.size()) {
        removeTab(count() - 1);
    }
    while (count() < sheets.size()) {
        addTab(QString());
    }
    for (int i = 0; i < count(); ++i) {
        show(i, *sheets[i]);
    }
}

void SheetTabs::show(int index, QMdiSubWindow& sheet) {
    QString title = sheet.windowTitle();
    setTabToolTip(index, title);
    title.replace(QLatin1Char('&'), QStringLiteral("&&"));
    if (tabText(index) != title) {
        setTabText(index, title);
    }
    const QIcon icon = m_icons.value(&sheet, sheet.windowIcon());
    if (tabIcon(index).cacheKey() != icon.cacheKey()) {
        setTabIcon(index, icon);
    }
    setTabData(index, QVariant::fromValue<QObject*>(&sheet));
}

void SheetTabs::choose(int index) {
    if (m_following || index < 0) {
        return;
    }
    auto* sheet = qobject_cast<QMdiSubWindow*>(tabData(index).value<QObject*>());
    auto* child = sheet ? dynamic_cast<MdiChildWindow*>(Window::of(sheet)) : nullptr;
    if (!child) {
        return;
    }
    const HWND handle = child->handle();
    if (child->widget()->isMinimized()) {
        child->show(SW_RESTORE);
    }
    auto* still = dynamic_cast<MdiChildWindow*>(Window::from(handle));
    if (MdiClientWindow* window = client(); window && still) {
        window->activate(still);
    }
}

} // namespace tvx::sec
