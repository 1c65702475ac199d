#include "platform/afx/controls/detail/AccessibleList.h"

#include "platform/afx/controls/detail/AccessibleLine.h"
#include "platform/afx/controls/detail/ListBoxWindow.h"
#include "platform/afx/core/detail/Loop.h"

#include <QAccessibleWidget>

#include <unordered_map>

namespace tvx::afx {

namespace {

ListBoxWindow* listOf(const QWidget* widget) {
    Window* window = Window::of(widget);
    return window && window->widget() == widget ? dynamic_cast<ListBoxWindow*>(window) : nullptr;
}

/// A line of a list, known by its number: what stands there changes with the list.
class AccessibleRow : public AccessibleLine {
public:
    AccessibleRow(QWidget& list, int index) : AccessibleLine(list), m_index(index) {}

    bool isValid() const override {
        const ListBoxWindow* window = list();
        return window && m_index < window->items().count();
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
    QRect rect() const override {
        if (!isValid()) {
            return {};
        }
        return seenOf(*list()->clientWidget(), list()->rowRect(m_index));
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
        state.focused = control()->hasFocus() && window->caret() == m_index;
        state.active = window->caret() == m_index;
        state.disabled = !window->isEnabled();
        state.invisible = !control()->isVisible();
        state.offscreen = rect().isEmpty();
        return state;
    }

    QStringList actionNames() const override {
        return {pressAction()};
    }
    void doAction(const QString& name) override {
        if (name == pressAction() && isValid()) {
            storing([this] { list()->choose(m_index); });
        }
    }
    int index() const {
        return m_index;
    }

private:
    ListBoxWindow* list() const {
        return listOf(control());
    }
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
