#include "platform/afx/controls/detail/TreeWindow.h"
#include "platform/base/Text.h"

#include <algorithm>

// The order of a tree's items.

namespace tvx::afx {

// --- walking ---

HTREEITEM TreeWindow::sibling(HTREEITEM item, int step) const {
    TreeNode* node = m_nodes.find(item);
    const int row = node ? TreeNodes::rowOf(*node) + step : -1;
    const bool exists = row >= 0 && row < static_cast<int>(node->parent->children.size());
    return exists ? TreeNodes::handleOf(node->parent->children[static_cast<std::size_t>(row)]) : nullptr;
}

HTREEITEM TreeWindow::nextSelected(HTREEITEM item) {
    if (m_nodes.selectedCount() == 0) {
        return nullptr;
    }
    TreeNode* node = item ? m_nodes.find(item) : &m_nodes.root();
    while (node && (node = TreeNodes::next(*node)) && !node->isSelected) {
    }
    return TreeNodes::handleOf(node);
}

HTREEITEM TreeWindow::relative(HTREEITEM item, UINT relation) {
    const TreeNode* node = m_nodes.find(item);
    const int row = node ? m_rows.rowOf(*node) : -1;
    switch (relation) {
    case TVGN_ROOT:
        item = TVI_ROOT;
        [[fallthrough]];
    case TVGN_CHILD: {
        const TreeNode* parent = parentOf(item);
        return parent && !parent->children.empty() ? TreeNodes::handleOf(parent->children.front()) : nullptr;
    }
    case TVGN_NEXT:
        return sibling(item, 1);
    case TVGN_PREVIOUS:
        return sibling(item, -1);
    case TVGN_PARENT:
        return node ? TreeNodes::handleOf(node->parent) : nullptr;
    case TVGN_CARET:
        return m_nodes.find(m_caret) ? m_caret : nullptr;
    case TVGN_FIRSTVISIBLE:
        layOut();
        return TreeNodes::handleOf(m_rows.at(top()));
    case TVGN_NEXTVISIBLE:
        return row >= 0 ? TreeNodes::handleOf(m_rows.at(row + 1)) : nullptr;
    case TVGN_PREVIOUSVISIBLE:
        return TreeNodes::handleOf(m_rows.at(row - 1));
    case TVGN_NEXTSELECTED:
        return nextSelected(item);
    default:
        return nullptr;
    }
}

// --- order ---

bool TreeWindow::sort(HTREEITEM item) {
    TreeNode* parent = parentOf(item);
    if (!parent) {
        return false;
    }
    // Texts that the parent keeps are asked for first; it may change the tree meanwhile.
    std::vector<std::pair<HTREEITEM, std::string>> texts;
    texts.reserve(parent->children.size());
    for (const TreeNode* child : std::vector<TreeNode*>(parent->children)) {
        texts.emplace_back(TreeNodes::handleOf(child), std::string());
    }
    for (auto& [child, text] : texts) {
        text = textOf(child);
    }
    std::ranges::stable_sort(
        texts, [](const auto& left, const auto& right) { return text::compareNoCase(left.second, right.second) < 0; });
    std::vector<HTREEITEM> order;
    order.reserve(texts.size());
    for (const auto& [child, text] : texts) {
        order.push_back(child);
    }
    return putInOrder(item, order);
}

bool TreeWindow::sortBy(const TVSORTCB& how) {
    const TreeNode* parent = parentOf(how.hParent);
    if (!parent || !how.lpfnCompare) {
        return false;
    }
    std::vector<std::pair<HTREEITEM, LPARAM>> data;
    data.reserve(parent->children.size());
    for (const TreeNode* child : parent->children) {
        data.emplace_back(TreeNodes::handleOf(child), child->data);
    }
    // A merge sort: whatever a host's function answers, nothing is read beyond the end.
    std::ranges::stable_sort(data, [&how](const auto& left, const auto& right) {
        return how.lpfnCompare(left.second, right.second, how.lParam) < 0;
    });
    std::vector<HTREEITEM> order;
    order.reserve(data.size());
    for (const auto& [child, value] : data) {
        order.push_back(child);
    }
    return putInOrder(how.hParent, order);
}

/// Puts children in an order that was found while others may have come and gone.
bool TreeWindow::putInOrder(HTREEITEM item, const std::vector<HTREEITEM>& order) {
    TreeNode* parent = parentOf(item);
    std::vector<TreeNode*> children;
    for (const HTREEITEM child : order) {
        if (TreeNode* node = m_nodes.find(child)) {
            children.push_back(node);
        }
    }
    if (!parent || children.size() != parent->children.size()) {
        return false;
    }
    TreeNodes::order(*parent, std::move(children));
    m_rows.forget();
    contentChanged();
    return true;
}

} // namespace tvx::afx
