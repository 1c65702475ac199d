#include "platform/afx/controls/detail/TreeRows.h"

namespace tvx::afx {

namespace {

bool isLastOfAll(const TreeNode& node) {
    for (const TreeNode* at = &node; at->parent; at = at->parent) {
        if (at->parent->children.back() != at) {
            return false;
        }
    }
    return true;
}

} // namespace

bool TreeRows::isInOpen(const TreeNode& node) {
    for (const TreeNode* above = node.parent; above && above->parent; above = above->parent) {
        if (!above->isExpanded) {
            return false;
        }
    }
    return true;
}

void TreeRows::inserted(TreeNode& node) {
    if (!m_isCounted || !isInOpen(node)) {
        return;
    }
    if (isLastOfAll(node)) {
        node.shown = static_cast<std::uint32_t>(m_rows.size());
        m_rows.push_back(&node);
    } else {
        forget();
    }
}

void TreeRows::count() const {
    m_rows.clear();
    TreeNode* node = m_nodes.root().children.empty() ? nullptr : m_nodes.root().children.front();
    while (node) {
        node->shown = static_cast<std::uint32_t>(m_rows.size());
        m_rows.push_back(node);
        const bool isOpen = node->isExpanded && !node->children.empty();
        node = isOpen ? node->children.front() : TreeNodes::nextBehind(*node);
    }
}

const std::vector<TreeNode*>& TreeRows::all() const {
    if (!m_isCounted) {
        count();
        m_isCounted = true;
    }
    return m_rows;
}

TreeNode* TreeRows::at(int row) const {
    return row >= 0 && row < size() ? all()[static_cast<std::size_t>(row)] : nullptr;
}

int TreeRows::rowOf(const TreeNode& node) const {
    const bool isShown = node.shown < all().size() && all()[node.shown] == &node;
    return isShown ? static_cast<int>(node.shown) : -1;
}

} // namespace tvx::afx
