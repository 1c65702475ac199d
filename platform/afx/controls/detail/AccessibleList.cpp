#include "platform/afx/controls/detail/AccessibleList.h"

#include "platform/afx/controls/detail/ListBoxWindow.h"
#include "platform/afx/core/detail/Loop.h"

#include <QAccessibleWidget>
#include <QPointer>

#include <unordered_map>

namespace tvx::afx {

namespace {

ListBoxWindow* listOf(const QWidget* widget) {
    Window* window = Window::of(widget);
    return window && window->widget() == widget ? dynamic_cast<ListBoxWindow*>(window) : nullptr;
}

/// A line of a list, known by its number: what stands there changes with the list.
class AccessibleRow : public QAccessibleInterface, public QAccessibleActionInterface {
public:
    AccessibleRow(QWidget& list, int index) : m_list(&list), m_index(index) {}

    bool isValid() const override {
        const ListBoxWindow* window = list();
        return window && m_index < window->items().count();
    }
    QObject* object() const override {
        return nullptr;
    }
    QWindow* window() const override {
        return m_list ? m_list->window()->windowHandle() : nullptr;
    }
    QAccessibleInterface* parent() const override {
        return QAccessible::queryAccessibleInterface(m_list.data());
    }
    QAccessibleInterface* child(int) const override {
        return nullptr;
    }
    QAccessibleInterface* childAt(int, int) const override {
        return nullptr;
    }
    int childCount() const override {
        return 0;
    }
    int indexOfChild(const QAccessibleInterface*) const override {
        return -1;
    }
    QAccessible::Role role() const override {
        return QAccessible::ListItem;
    }
    QString text(QAccessible::Text kind) const override {
        QString text;
        if (kind == QAccessible::Name && isValid()) {
            storing([&] { text = list()->accessibleText(m_index); });
        }
        return text;
    }
    void setText(QAccessible::Text, const QString&) override {}
    QRect rect() const override {
        if (!isValid()) {
            return {};
        }
        const QWidget& area = *list()->clientWidget();
        const QRect seen = list()->rowRect(m_index).intersected(area.rect());
        return {area.mapToGlobal(seen.topLeft()), seen.size()};
    }
    QAccessible::State state() const override {
        QAccessible::State state;
        const ListBoxWindow* window = list();
        if (!isValid()) {
            state.invalid = true;
            return state;
        }
        state.selectable = state.focusable = true;
        state.multiSelectable = state.extSelectable = window->isMultiple();
        state.selected = window->isSelected(m_index);
        state.focused = m_list->hasFocus() && window->caret() == m_index;
        state.active = window->caret() == m_index;
        state.disabled = !window->isEnabled();
        state.invisible = !m_list->isVisible();
        state.offscreen = rect().isEmpty();
        return state;
    }

    void* interface_cast(QAccessible::InterfaceType type) override {
        return type == QAccessible::ActionInterface ? static_cast<QAccessibleActionInterface*>(this) : nullptr;
    }
    QStringList actionNames() const override {
        return {pressAction()};
    }
    void doAction(const QString& name) override {
        if (name == pressAction() && isValid()) {
            storing([this] { list()->choose(m_index); });
        }
    }
    QStringList keyBindingsForAction(const QString&) const override {
        return {};
    }

    int index() const {
        return m_index;
    }

private:
    ListBoxWindow* list() const {
        return listOf(m_list);
    }
    QPointer<QWidget> m_list;
    int m_index;
};

/// A list. It makes what stands for a line when that is asked for, and keeps it as long as it lives.
class AccessibleList : public QAccessibleWidget {
public:
    explicit AccessibleList(QWidget* list) : QAccessibleWidget(list, QAccessible::List) {}
    ~AccessibleList() override {
        for (const auto& [index, id] : m_rows) {
            QAccessible::deleteAccessibleInterface(id);
        }
    }
    AccessibleList(const AccessibleList&) = delete;
    AccessibleList& operator=(const AccessibleList&) = delete;

    int childCount() const override {
        const ListBoxWindow* list = listOf(widget());
        return list ? list->items().count() : 0;
    }
    QAccessibleInterface* child(int index) const override {
        if (index < 0 || index >= childCount()) {
            return nullptr;
        }
        const auto [place, isNew] = m_rows.try_emplace(index, 0);
        if (isNew) {
            place->second = QAccessible::registerAccessibleInterface(new AccessibleRow(*widget(), index));
        }
        return QAccessible::accessibleInterface(place->second);
    }
    int indexOfChild(const QAccessibleInterface* child) const override {
        const auto* row = dynamic_cast<const AccessibleRow*>(child);
        return row ? row->index() : -1;
    }
    QAccessibleInterface* childAt(int x, int y) const override {
        const ListBoxWindow* list = listOf(widget());
        return list ? child(list->rowUnder(list->clientWidget()->mapFromGlobal(QPoint(x, y)))) : nullptr;
    }
    QAccessibleInterface* focusChild() const override {
        const ListBoxWindow* list = listOf(widget());
        return list && widget()->hasFocus() ? child(list->caret()) : nullptr;
    }
    QAccessible::State state() const override {
        QAccessible::State state = QAccessibleWidget::state();
        const ListBoxWindow* list = listOf(widget());
        state.multiSelectable = state.extSelectable = list && list->isMultiple();
        return state;
    }

private:
    mutable std::unordered_map<int, QAccessible::Id> m_rows;
};

QAccessibleInterface* answer(const QString&, QObject* object) {
    auto* widget = qobject_cast<QWidget*>(object);
    return widget && listOf(widget) ? new AccessibleList(widget) : nullptr;
}

} // namespace

void answerForLists() {
    static const bool answers = [] {
        QAccessible::installFactory(&answer);
        return true;
    }();
    static_cast<void>(answers);
}

} // namespace tvx::afx
