#pragma once

/// @file
/// Which items of a tree are seen in which line.

#include "platform/afx/controls/detail/TreeNodes.h"

namespace tvx::afx {

/// The lines of a tree: the items that are in open ones, in their order. They are counted when somebody asks, once for
/// all changes before.
class TVX_PLATFORM_API TreeRows {
public:
    explicit TreeRows(TreeNodes& nodes) : m_nodes(nodes) {}

    /// What changes the lines says so: nodes were removed, sorted, opened or closed...
    void forget() {
        m_isCounted = false;
    }
    /// ... or one was inserted. One at the end of all lines is added to them.
    void inserted(TreeNode& node);

    const std::vector<TreeNode*>& all() const;
    int size() const {
        return static_cast<int>(all().size());
    }
    /// Null for a line that does not exist.
    TreeNode* at(int row) const;
    /// The line of a node, -1 for one in a closed node.
    int rowOf(const TreeNode& node) const;
    /// Whether all nodes that it is in are open.
    static bool isInOpen(const TreeNode& node);

private:
    void count() const;

    TreeNodes& m_nodes;
    mutable std::vector<TreeNode*> m_rows;
    mutable bool m_isCounted = true;
};

} // namespace tvx::afx
