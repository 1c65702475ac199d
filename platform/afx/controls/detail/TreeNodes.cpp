#include "platform/afx/controls/detail/TreeNodes.h"

#include "platform/base/Text.h"

#include <algorithm>
#include <utility>

namespace tvx::afx {

namespace {

/// Numbers of uses stay below this, so that no handle is one of the places (TVI_...), which are negative.
constexpr std::uint32_t generations = 0x7FFFFFFF;

bool isLess(std::string_view left, std::string_view right) {
    return text::compareNoCase(left, right) < 0;
}

} // namespace

// --- handles ---

HTREEITEM TreeNodes::handleOf(const TreeNode* node) {
    if (!node || !node->parent) {
        return nullptr;
    }
    const auto number = (static_cast<std::uint64_t>(node->generation) << 32U) | (node->slot + 1U);
    return reinterpret_cast<HTREEITEM>(number);
}

TreeNode* TreeNodes::find(HTREEITEM item) const {
    const auto number = reinterpret_cast<std::uint64_t>(item);
    const auto slot = static_cast<std::uint32_t>(number);
    if (slot == 0 || slot > m_taken) {
        return nullptr;
    }
    TreeNode& node = at(slot - 1);
    return node.isUsed && node.generation == number >> 32U ? &node : nullptr;
}

TreeNode& TreeNodes::take() {
    std::size_t slot = m_taken;
    if (!m_free.empty()) {
        slot = m_free.back();
        m_free.pop_back();
    } else {
        if (m_taken == m_chunks.size() * chunkSize) {
            m_chunks.push_back(std::make_unique<std::array<TreeNode, chunkSize>>());
        }
        ++m_taken;
    }
    TreeNode& node = at(slot);
    node.slot = static_cast<std::uint32_t>(slot);
    node.generation = std::max(node.generation, 1U); // so that no small number is a handle
    node.isUsed = true;
    ++m_count;
    return node;
}

void TreeNodes::release(TreeNode& node) {
    for (TreeNode* child : node.children) {
        release(*child);
    }
    select(node, false);
    const std::uint32_t slot = node.slot;
    const std::uint32_t generation = (node.generation + 1) % generations;
    node = TreeNode();
    node.generation = generation;
    m_free.push_back(slot);
    --m_count;
}

// --- order ---

int TreeNodes::rowOf(TreeNode& node) {
    TreeNode& parent = *node.parent;
    if (node.row >= parent.counted || parent.children[node.row] != &node) {
        for (std::size_t row = parent.counted; row < parent.children.size(); ++row) {
            parent.children[row]->row = static_cast<std::uint32_t>(row);
        }
        parent.counted = static_cast<std::uint32_t>(parent.children.size());
    }
    return static_cast<int>(node.row);
}

std::size_t TreeNodes::sortedPlace(const TreeNode& parent, std::string_view text) {
    const auto& children = parent.children;
    // Who inserts in order already, as readers of folders do, compares once.
    if (children.empty() || !isLess(text, children.back()->text)) {
        return children.size();
    }
    const auto place =
        std::upper_bound(children.begin(), children.end(), text,
                         [](std::string_view wanted, const TreeNode* node) { return isLess(wanted, node->text); });
    return static_cast<std::size_t>(place - children.begin());
}

TreeNode& TreeNodes::insert(TreeNode& parent, std::size_t row) {
    TreeNode& node = take();
    node.parent = &parent;
    node.row = static_cast<std::uint32_t>(row);
    const bool isLast = row == parent.children.size();
    parent.children.insert(parent.children.begin() + static_cast<std::ptrdiff_t>(row), &node);
    if (parent.counted >= row) {
        parent.counted = static_cast<std::uint32_t>(isLast ? row + 1 : row);
    }
    return node;
}

void TreeNodes::remove(TreeNode& node) {
    TreeNode& parent = *node.parent;
    const auto row = static_cast<std::uint32_t>(rowOf(node));
    parent.children.erase(parent.children.begin() + row);
    parent.counted = std::min(parent.counted, row);
    release(node);
}

void TreeNodes::order(TreeNode& parent, std::vector<TreeNode*> children) {
    parent.children = std::move(children);
    parent.counted = 0;
}

TreeNode* TreeNodes::next(TreeNode& node) {
    return node.children.empty() ? nextBehind(node) : node.children.front();
}

TreeNode* TreeNodes::nextBehind(TreeNode& node) {
    for (TreeNode* at = &node; at->parent; at = at->parent) {
        const auto row = static_cast<std::size_t>(rowOf(*at));
        if (row + 1 < at->parent->children.size()) {
            return at->parent->children[row + 1];
        }
    }
    return nullptr;
}

bool TreeNodes::isBelow(const TreeNode& node, const TreeNode& above) {
    for (const TreeNode* at = node.parent; at; at = at->parent) {
        if (at == &above) {
            return true;
        }
    }
    return false;
}

// --- selection ---

void TreeNodes::select(TreeNode& node, bool selected) {
    if (std::exchange(node.isSelected, selected) != selected) {
        m_selectedCount += selected ? 1 : -1;
    }
}

void TreeNodes::selectNone() {
    for (std::size_t slot = 0; slot < m_taken && m_selectedCount > 0; ++slot) {
        select(at(slot), false);
    }
}

} // namespace tvx::afx
