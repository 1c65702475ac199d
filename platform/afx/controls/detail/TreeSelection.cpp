#include "platform/afx/controls/detail/TreeWindow.h"

#include <QAbstractScrollArea>

#include <algorithm>
#include <utility>

// What is selected and open in a tree.

namespace tvx::afx {

// --- selection ---

bool TreeWindow::isOnlySelected(HTREEITEM item) const {
    const TreeNode* node = m_nodes.find(item);
    const bool isCaret = node ? item == m_caret && node->isSelected : !m_nodes.find(m_caret);
    return isCaret && m_nodes.selectedCount() == (node ? 1U : 0U);
}

bool TreeWindow::select(HTREEITEM item, Pick how, By by) {
    if (item && !m_nodes.find(item)) {
        return false;
    }
    if (by != By::Keyboard) {
        m_typed.clear(); // letters go on from where they have led
    }
    if (how == Pick::Only && isOnlySelected(item)) {
        show(item, by);
        return true;
    }
    const HTREEITEM before = m_nodes.find(m_caret) ? m_caret : nullptr;
    const UINT action = by == By::Mouse ? TVC_BYMOUSE : by == By::Keyboard ? TVC_BYKEYBOARD : TVC_UNKNOWN;
    const bool isRefused = tellItem(TVN_SELCHANGING, action, before, item) != 0;
    TreeNode* chosen = isDestroyed() ? nullptr : m_nodes.find(item);
    if (isRefused || isDestroyed() || (item && !chosen)) {
        return false;
    }
    pick(chosen, how);
    m_caret = item;
    refresh();
    show(item, by);
    if (!isDestroyed()) {
        tellCaret();
        tellItem(TVN_SELCHANGED, action, before, item);
    }
    return true;
}

/// Brings what was selected into sight. Nothing moves sideways under the mouse.
void TreeWindow::show(HTREEITEM item, By by) {
    const TreeNode* node = m_nodes.find(item);
    const int row = node ? m_rows.rowOf(*node) : -1;
    if (by == By::Mouse && row >= 0) {
        layOut();
        showRow(row);
    } else if (node) {
        ensureVisible(item);
    }
}

/// Selects as the user does, without asking or telling anybody.
void TreeWindow::pick(TreeNode* node, Pick how) {
    const HTREEITEM item = TreeNodes::handleOf(node);
    if (how == Pick::Toggle && node) {
        m_nodes.select(*node, !node->isSelected);
        m_anchor = item;
        return;
    }
    if (how != Pick::AddRange) {
        // One is taken out without a look at all others.
        if (TreeNode* caret = m_nodes.find(m_caret)) {
            m_nodes.select(*caret, false);
        }
        m_nodes.selectNone();
    }
    const int last = how == Pick::All ? m_rows.size() - 1 : node ? m_rows.rowOf(*node) : -1;
    const TreeNode* anchor = m_nodes.find(m_anchor);
    const int from = anchor ? m_rows.rowOf(*anchor) : -1;
    const bool isRange = how != Pick::Only && last >= 0 && (how == Pick::All || from >= 0);
    if (isRange) {
        const int first = how == Pick::All ? 0 : from;
        for (int row = std::min(first, last); row <= std::max(first, last); ++row) {
            m_nodes.select(*m_rows.at(row), true);
        }
    } else if (node) {
        m_nodes.select(*node, true);
        m_anchor = item;
    }
}

// --- opening and closing ---

bool TreeWindow::expand(HTREEITEM item, UINT how, By by) {
    const TreeNode* node = m_nodes.find(item);
    if (!node) {
        return false;
    }
    const UINT what = how & TVE_TOGGLE;
    const bool opens = what == TVE_TOGGLE ? !node->isExpanded : what == TVE_EXPAND;
    return opens ? open(item, by) : close(item, by, (how & TVE_COLLAPSERESET) != 0);
}

bool TreeWindow::open(HTREEITEM item, By by) {
    const TreeNode* node = m_nodes.find(item);
    if (!node || node->isExpanded || !hasChildren(item) || isDestroyed()) {
        return false;
    }
    node = m_nodes.find(item);
    // Programs that open again know what is there.
    const bool tells = by != By::Program || (node && !node->wasExpanded);
    if (tells && (tellItem(TVN_ITEMEXPANDING, TVE_EXPAND, nullptr, item) != 0 || isDestroyed())) {
        return false;
    }
    TreeNode* opened = m_nodes.find(item);
    if (!opened || opened->isExpanded || opened->children.empty()) {
        return opened && opened->isExpanded;
    }
    opened->isExpanded = opened->wasExpanded = true;
    m_rows.forget();
    contentChanged();
    tellOpened(item, true);
    if (tells) {
        tellItem(TVN_ITEMEXPANDED, TVE_EXPAND, nullptr, item);
    }
    return true;
}

/// What is below a closed item is not selected: what nobody sees must not be what a command is about.
/// @return whether the caret item was there
bool TreeWindow::deselectBelow(TreeNode& node) {
    const TreeNode* end = TreeNodes::nextBehind(node);
    for (TreeNode* below = TreeNodes::next(node); isMultiple() && below != end; below = TreeNodes::next(*below)) {
        m_nodes.select(*below, false);
    }
    const TreeNode* caret = m_nodes.find(m_caret);
    return caret && TreeNodes::isBelow(*caret, node);
}

bool TreeWindow::close(HTREEITEM item, By by, bool forget) {
    TreeNode* node = m_nodes.find(item);
    if (!node || !node->isExpanded) {
        return false;
    }
    const bool tells = by != By::Program;
    if (tells && (tellItem(TVN_ITEMEXPANDING, TVE_COLLAPSE, nullptr, item) != 0 || isDestroyed())) {
        return false;
    }
    node = m_nodes.find(item);
    if (node && deselectBelow(*node)) {
        select(item, Pick::Only, by);
    }
    node = isDestroyed() ? nullptr : m_nodes.find(item);
    if (!node) {
        return false;
    }
    node->isExpanded = false;
    m_rows.forget();
    m_extent = 0;
    contentChanged();
    tellOpened(item, false);
    if (tells) {
        tellItem(TVN_ITEMEXPANDED, TVE_COLLAPSE, nullptr, item);
    }
    if (forget && !isDestroyed()) {
        removeBelow(item);
        node = m_nodes.find(item);
        if (node) {
            node->wasExpanded = false;
        }
    }
    return true;
}

/// Opens what an item is in, from the outside in. Answers whether something was closed.
bool TreeWindow::openAround(HTREEITEM item) {
    std::vector<HTREEITEM> around;
    for (const TreeNode* node = m_nodes.find(item); node && node->parent; node = node->parent) {
        if (!node->parent->isExpanded && node->parent->parent) {
            around.push_back(TreeNodes::handleOf(node->parent));
        }
    }
    bool opened = false;
    for (auto closed = around.rbegin(); closed != around.rend() && !isDestroyed(); ++closed) {
        opened = open(*closed, By::Program) || opened;
    }
    return opened;
}

/// Opens an item with all below it. Hosts are asked for the children of the item itself only: what they insert on
/// demand may have no end.
void TreeWindow::openAll(HTREEITEM item) {
    std::vector<HTREEITEM> waiting{item};
    while (!waiting.empty() && !isDestroyed()) {
        const HTREEITEM next = waiting.back();
        waiting.pop_back();
        const TreeNode* node = m_nodes.find(next);
        if (node && (next == item || !node->children.empty())) {
            open(next, By::Keyboard);
        }
        node = isDestroyed() ? nullptr : m_nodes.find(next);
        if (node && node->isExpanded) {
            std::ranges::transform(node->children, std::back_inserter(waiting), &TreeNodes::handleOf);
        }
    }
}

} // namespace tvx::afx
