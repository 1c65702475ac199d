#include "platform/afx/controls/detail/AccessibleTree.h"

#include "platform/afx/controls/detail/AccessibleLine.h"
#include "platform/afx/controls/detail/TreeWindow.h"
#include "platform/afx/core/detail/Loop.h"

#include <QAccessibleWidget>

#include <unordered_map>

namespace tvx::afx {

namespace {

/// The action that opens and closes an item, by the toolkit's name.
const QString& openAction() {
    return QAccessibleActionInterface::toggleAction();
}

TreeWindow* treeOf(const QWidget* widget) {
    Window* window = Window::of(widget);
    return window && window->widget() == widget ? dynamic_cast<TreeWindow*>(window) : nullptr;
}

/// An item, whatever line it is in.
class AccessibleItem : public AccessibleLine {
public:
    AccessibleItem(QWidget& tree, HTREEITEM item) : AccessibleLine(tree), m_item(item) {}

    bool isValid() const override {
        return node();
    }
    QAccessible::Role role() const override {
        return QAccessible::TreeItem;
    }
    QString text(QAccessible::Text kind) const override {
        QString text;
        if (kind == QAccessible::Name && node()) {
            storing([&] { text = tree()->lookOf(m_item).text; });
        }
        return text;
    }
    QRect rect() const override {
        const TreeNode* shown = node();
        if (!shown) {
            return {};
        }
        return seenOf(*tree()->clientWidget(), tree()->rowRect(*shown));
    }
    QAccessible::State state() const override {
        QAccessible::State state;
        bool hasButton = false;
        storing([&] { hasButton = node() && tree()->lookOf(m_item).hasButton; });
        const TreeNode* shown = node();
        if (!shown) {
            state.invalid = true;
            return state;
        }
        state.selectable = state.focusable = true;
        state.multiSelectable = state.extSelectable = tree()->isMultiple();
        state.selected = shown->isSelected;
        state.active = tree()->caret() == m_item;
        state.focused = state.active && control()->hasFocus();
        state.expandable = hasButton;
        state.expanded = hasButton && shown->isExpanded;
        state.collapsed = hasButton && !shown->isExpanded;
        state.disabled = !tree()->isEnabled();
        state.invisible = !control()->isVisible();
        state.offscreen = rect().isEmpty();
        return state;
    }

    QStringList actionNames() const override {
        return state().expandable ? QStringList{pressAction(), openAction()} : QStringList{pressAction()};
    }
    void doAction(const QString& name) override {
        if (!node()) {
            return;
        }
        if (name == pressAction()) {
            storing([this] { tree()->choose(m_item); });
        } else if (name == openAction()) {
            storing([this] { tree()->toggle(m_item); });
        }
    }
    /// -1 for an item that has gone.
    int row() const {
        const TreeNode* shown = node();
        return shown ? tree()->rows().rowOf(*shown) : -1;
    }

private:
    TreeWindow* tree() const {
        return treeOf(control());
    }
    const TreeNode* node() const {
        const TreeWindow* window = tree();
        return window ? window->nodeOf(m_item) : nullptr;
    }
    HTREEITEM m_item;
};

/// A tree. It makes what stands for an item when that is asked for.
class AccessibleTree : public QAccessibleWidget {
public:
    explicit AccessibleTree(QWidget* tree) : QAccessibleWidget(tree, QAccessible::Tree) {}
    ~AccessibleTree() override {
        for (const auto& [item, id] : m_items) {
            QAccessible::deleteAccessibleInterface(id);
        }
    }
    AccessibleTree(const AccessibleTree&) = delete;
    AccessibleTree& operator=(const AccessibleTree&) = delete;

    int childCount() const override {
        const TreeWindow* tree = treeOf(widget());
        return tree ? tree->rows().size() : 0;
    }
    QAccessibleInterface* child(int index) const override {
        const TreeWindow* tree = treeOf(widget());
        return tree ? itemFor(TreeNodes::handleOf(tree->rows().at(index))) : nullptr;
    }
    int indexOfChild(const QAccessibleInterface* child) const override {
        const auto* item = dynamic_cast<const AccessibleItem*>(child);
        return item ? item->row() : -1;
    }
    QAccessibleInterface* childAt(int x, int y) const override {
        const TreeWindow* tree = treeOf(widget());
        return tree ? itemFor(tree->itemAt(tree->clientWidget()->mapFromGlobal(QPoint(x, y)).y())) : nullptr;
    }
    QAccessibleInterface* focusChild() const override {
        const TreeWindow* tree = treeOf(widget());
        return tree && widget()->hasFocus() && tree->nodeOf(tree->caret()) ? itemFor(tree->caret()) : nullptr;
    }
    QAccessible::State state() const override {
        QAccessible::State state = QAccessibleWidget::state();
        const TreeWindow* tree = treeOf(widget());
        state.multiSelectable = state.extSelectable = tree && tree->isMultiple();
        return state;
    }

private:
    QAccessibleInterface* itemFor(HTREEITEM item) const {
        if (!item) {
            return nullptr;
        }
        if (m_items.size() >= m_most) {
            dropGone();
        }
        const auto [place, isNew] = m_items.try_emplace(item, 0);
        if (isNew) {
            place->second = QAccessible::registerAccessibleInterface(new AccessibleItem(*widget(), item));
        }
        return QAccessible::accessibleInterface(place->second);
    }
    /// Items that have gone leave what stood for them behind, until there are twice as many as were needed last.
    void dropGone() const {
        const TreeWindow* tree = treeOf(widget());
        std::erase_if(m_items, [tree](const auto& entry) {
            const bool isGone = !tree || !tree->nodeOf(entry.first);
            if (isGone) {
                QAccessible::deleteAccessibleInterface(entry.second);
            }
            return isGone;
        });
        m_most = std::max<std::size_t>(m_items.size() * 2, m_most);
    }
    mutable std::unordered_map<HTREEITEM, QAccessible::Id> m_items;
    mutable std::size_t m_most = 1000;
};

QAccessibleInterface* answer(const QString&, QObject* object) {
    auto* widget = qobject_cast<QWidget*>(object);
    return widget && treeOf(widget) ? new AccessibleTree(widget) : nullptr;
}

} // namespace

void answerForTrees() {
    static const bool answers = [] {
        QAccessible::installFactory(&answer);
        return true;
    }();
    static_cast<void>(answers);
}

} // namespace tvx::afx
