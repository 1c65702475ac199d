#include "platform/afx/core/detail/Accessible.h"

#include "platform/afx/core/detail/FrameButton.h"
#include "platform/afx/core/detail/Window.h"

#include <QAbstractButton>
#include <QAccessibleObject>
#include <QAccessibleWidget>
#include <QMainWindow>
#include <QMdiSubWindow>
#include <QMenu>
#include <QMenuBar>
#include <QRegularExpression>
#include <QStatusBar>
#include <QToolBar>

#include <algorithm>
#include <array>

namespace tvx::afx {

namespace {

class AccessibleWindow : public QAccessibleWidget {
public:
    AccessibleWindow(QWidget* widget, QAccessible::Role role) : QAccessibleWidget(widget, role) {}

    QString text(QAccessible::Text kind) const override {
        const QString own = QAccessibleWidget::text(kind);
        const Window* window = Window::of(widget());
        return kind == QAccessible::Name && own.isEmpty() && window ? withoutMarks(window->text()) : own;
    }
    QAccessible::State state() const override {
        QAccessible::State state = QAccessibleWidget::state();
        if (const QAbstractButton* button = this->button()) {
            state.checkable = true;
            state.checked = button->isChecked();
        }
        return state;
    }

    int childCount() const override {
        return static_cast<int>(childWidgets().size());
    }
    QAccessibleInterface* child(int index) const override {
        return QAccessible::queryAccessibleInterface(childWidgets().value(index));
    }
    int indexOfChild(const QAccessibleInterface* child) const override {
        return static_cast<int>(childWidgets().indexOf(qobject_cast<QWidget*>(child->object())));
    }

    QStringList actionNames() const override {
        return button() ? QStringList(pressAction()) : QAccessibleWidget::actionNames();
    }
    void doAction(const QString& name) override {
        if (QAbstractButton* pressed = name == pressAction() ? button() : nullptr) {
            pressed->click();
        } else {
            QAccessibleWidget::doAction(name);
        }
    }

private:
    QAbstractButton* button() const {
        return qobject_cast<QAbstractButton*>(widget());
    }
    /// The toolkit has them in the order in which they cover each other.
    QWidgetList childWidgets() const {
        QWidgetList widgets;
        if (const Window* window = Window::of(widget())) {
            std::ranges::transform(window->children(), std::back_inserter(widgets), &Window::widget);
        }
        return widgets;
    }
};

/// A top-level frame or a child frame: its widgets, and behind them the button that its host draws into it.
class AccessibleFrame : public QAccessibleWidget {
public:
    explicit AccessibleFrame(QWidget* frame) : QAccessibleWidget(frame, QAccessible::Window) {}

    /// The toolkit calls only top-level widgets by their captions.
    QString text(QAccessible::Text kind) const override {
        const QString own = QAccessibleWidget::text(kind);
        return kind == QAccessible::Name && own.isEmpty() ? widget()->windowTitle() : own;
    }

    int childCount() const override {
        return QAccessibleWidget::childCount() + (button() ? 1 : 0);
    }
    QAccessibleInterface* child(int index) const override {
        const bool isWidget = index < QAccessibleWidget::childCount();
        return isWidget ? QAccessibleWidget::child(index) : QAccessible::queryAccessibleInterface(button());
    }
    int indexOfChild(const QAccessibleInterface* child) const override {
        const bool isButton = child && child->object() && child->object() == button();
        return isButton ? QAccessibleWidget::childCount() : QAccessibleWidget::indexOfChild(child);
    }
    /// In a menu bar the button stands on the bar.
    QAccessibleInterface* childAt(int x, int y) const override {
        const bool isButton = button() && button()->screenPlace().contains(x, y);
        return isButton ? QAccessible::queryAccessibleInterface(button()) : QAccessibleWidget::childAt(x, y);
    }

private:
    FrameButton* button() const {
        const Window* window = Window::of(widget());
        return window ? window->frameButton() : nullptr;
    }
};

class AccessibleFrameButton : public QAccessibleObject, public QAccessibleActionInterface {
public:
    explicit AccessibleFrameButton(FrameButton& button) : QAccessibleObject(&button) {}

    QAccessibleInterface* parent() const override {
        const Window* window = button().window();
        return window ? QAccessible::queryAccessibleInterface(window->widget()) : nullptr;
    }
    int childCount() const override {
        return 0;
    }
    QAccessibleInterface* child(int) const override {
        return nullptr;
    }
    int indexOfChild(const QAccessibleInterface*) const override {
        return -1;
    }
    QAccessible::Role role() const override {
        return QAccessible::PushButton;
    }
    QRect rect() const override {
        return button().screenPlace();
    }
    QString text(QAccessible::Text kind) const override {
        return kind == QAccessible::Name ? button().name() : QString();
    }
    QAccessible::State state() const override {
        QAccessible::State state;
        state.invisible = button().screenPlace().isEmpty();
        return state;
    }
    void* interface_cast(QAccessible::InterfaceType type) override {
        return type == QAccessible::ActionInterface ? static_cast<QAccessibleActionInterface*>(this) : nullptr;
    }
    QStringList actionNames() const override {
        return {pressAction()};
    }
    void doAction(const QString& name) override {
        if (name == pressAction()) {
            button().press();
        }
    }
    QStringList keyBindingsForAction(const QString&) const override {
        return {};
    }

private:
    FrameButton& button() const {
        return *static_cast<FrameButton*>(object());
    }
};

/// A tool bar or status bar. The toolkit leaves docked ones without a name.
class AccessibleBar : public QAccessibleWidget {
public:
    AccessibleBar(QWidget* bar, QAccessible::Role role) : QAccessibleWidget(bar, role) {}

    QString text(QAccessible::Text kind) const override {
        const QString own = QAccessibleWidget::text(kind);
        const Window* window = Window::of(widget());
        return kind == QAccessible::Name && own.isEmpty() && window ? window->text() : own;
    }
};

/// An entry of a menu or a menu bar.
class AccessibleEntry : public QAccessibleObject, public QAccessibleActionInterface {
public:
    AccessibleEntry(QAction& action, QWidget& menu) : QAccessibleObject(&action), m_menu(&menu) {}

    QAccessibleInterface* parent() const override {
        return QAccessible::queryAccessibleInterface(m_menu);
    }
    int childCount() const override {
        return action().menu() ? 1 : 0;
    }
    QAccessibleInterface* child(int index) const override {
        return index == 0 ? QAccessible::queryAccessibleInterface(action().menu()) : nullptr;
    }
    int indexOfChild(const QAccessibleInterface* child) const override {
        return child->object() == action().menu() ? 0 : -1;
    }
    QAccessible::Role role() const override {
        return action().isSeparator() ? QAccessible::Separator : QAccessible::MenuItem;
    }
    QRect rect() const override {
        return place().translated(m_menu ? m_menu->mapToGlobal(QPoint()) : QPoint());
    }
    QString text(QAccessible::Text kind) const override {
        const QString all = action().text();
        const qsizetype tab = all.indexOf(QLatin1Char('\t'));
        switch (kind) {
        case QAccessible::Name:
            return withoutMarks(all.left(tab));
        case QAccessible::Accelerator:
            return tab < 0 ? QString() : all.mid(tab + 1);
        default:
            return {};
        }
    }
    QAccessible::State state() const override {
        QAccessible::State state;
        state.disabled = !action().isEnabled();
        state.invisible = !m_menu || !m_menu->isVisible();
        state.focusable = state.selectable = true;
        state.focused = isChosen();
        state.checkable = action().isCheckable();
        state.checked = action().isChecked();
        state.hasPopup = action().menu() ? 1 : 0;
        return state;
    }

    void* interface_cast(QAccessible::InterfaceType type) override {
        return type == QAccessible::ActionInterface ? static_cast<QAccessibleActionInterface*>(this) : nullptr;
    }
    QStringList actionNames() const override {
        if (action().isSeparator()) {
            return {};
        }
        return {action().menu() ? showMenuAction() : pressAction()};
    }
    void doAction(const QString& name) override {
        if (!actionNames().contains(name) || !action().isEnabled()) {
            return;
        }
        if (auto* bar = qobject_cast<QMenuBar*>(m_menu); bar && action().menu()) {
            bar->setActiveAction(&action());
        } else if (auto* menu = qobject_cast<QMenu*>(m_menu); menu && action().menu()) {
            menu->setActiveAction(&action());
        } else {
            action().trigger();
        }
    }
    QStringList keyBindingsForAction(const QString&) const override {
        const QString key = text(QAccessible::Accelerator);
        return key.isEmpty() ? QStringList() : QStringList(key);
    }

private:
    QAction& action() const {
        return *static_cast<QAction*>(object());
    }
    bool isChosen() const {
        const auto* menu = qobject_cast<QMenu*>(m_menu);
        const auto* bar = qobject_cast<QMenuBar*>(m_menu);
        return &action() == (menu ? menu->activeAction() : bar ? bar->activeAction() : nullptr);
    }
    QRect place() const {
        const auto* menu = qobject_cast<QMenu*>(m_menu);
        const auto* bar = qobject_cast<QMenuBar*>(m_menu);
        return menu ? menu->actionGeometry(&action()) : bar ? bar->actionGeometry(&action()) : QRect();
    }

    QPointer<QWidget> m_menu;
};

QAccessibleInterface* answerForAction(QAction& action) {
    const QObjectList owners = action.associatedObjects();
    const auto menu = std::ranges::find_if(owners, [](const QObject* owner) {
        return qobject_cast<const QMenu*>(owner) || qobject_cast<const QMenuBar*>(owner);
    });
    return menu == owners.end() ? nullptr : new AccessibleEntry(action, *static_cast<QWidget*>(*menu));
}

QAccessibleInterface* answerForWidget(QWidget& widget) {
    const Window* window = Window::of(&widget);
    if (window && window->widget() == &widget && window->accessibleRole() != 0) {
        return new AccessibleWindow(&widget, static_cast<QAccessible::Role>(window->accessibleRole()));
    }
    if (window && qobject_cast<QMainWindow*>(&widget)) {
        // The inside of a child frame is a window for its parts only.
        const bool isFrame = window->widget() == &widget;
        return isFrame ? new AccessibleFrame(&widget) : new QAccessibleWidget(&widget, QAccessible::Client);
    }
    if (window && qobject_cast<QMdiSubWindow*>(&widget)) {
        return new AccessibleFrame(&widget);
    }
    if (qobject_cast<QToolBar*>(&widget)) {
        return new AccessibleBar(&widget, QAccessible::ToolBar);
    }
    return qobject_cast<QStatusBar*>(&widget) ? new AccessibleBar(&widget, QAccessible::StatusBar) : nullptr;
}

QAccessibleInterface* answer(const QString& className, QObject* object) {
    if (auto* action = qobject_cast<QAction*>(object)) {
        return answerForAction(*action);
    }
    if (auto* button = dynamic_cast<FrameButton*>(object)) {
        return new AccessibleFrameButton(*button);
    }
    auto* widget = qobject_cast<QWidget*>(object);
    if (widget && className == QLatin1String("QToolBarSeparator")) {
        return new QAccessibleWidget(widget, QAccessible::Separator);
    }
    return widget ? answerForWidget(*widget) : nullptr;
}

} // namespace

QString withoutMarks(const QString& text) {
    static const QRegularExpression keyBehind(QStringLiteral("\\(&.\\)")); // how texts without Latin letters have it
    QString marked = text;
    marked.remove(keyBehind);
    QString plain;
    for (qsizetype i = 0; i < marked.size(); ++i) {
        if (marked[i] == QLatin1Char('&') && i + 1 < marked.size()) {
            ++i; // of two the second is a character of the text
        }
        plain += marked[i];
    }
    return plain;
}

void answerAssistiveTools() {
    QAccessible::installFactory(&answer);
}

} // namespace tvx::afx
