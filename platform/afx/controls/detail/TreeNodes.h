#pragma once

/// @file
/// What a tree holds, without a window: nodes in their order, known by numbers.

#include "platform/afx/controls/TreeMessages.h"
#include "platform/base/Export.h"

#include <array>
#include <cstdint>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

namespace tvx::afx {

struct TreeNode {
    std::string text;
    std::vector<TreeNode*> children; ///< TreeNodes owns them.
    TreeNode* parent = nullptr;
    LPARAM data = 0;
    int image = 0;
    int selectedImage = 0;
    int childrenHint = 0;  ///< As TVITEM::cChildren: 0 goes by the children that there are.
    bool asksText = false; ///< The host is asked for the text.
    bool isBold = false;
    bool isExpanded = false;
    bool wasExpanded = false;
    bool isSelected = false; ///< TreeNodes::select sets it.
    bool isUsed = false;

    /// For TreeNodes: the place in its tables, how often that was used before, and the row as it was last counted.
    std::uint32_t slot = 0;
    std::uint32_t generation = 0;
    std::uint32_t row = 0;
    std::uint32_t counted = 0; ///< How many children, from the first, have the right row.
    std::uint32_t shown = 0;   ///< For TreeRows: the line that shows it.
};

/// The nodes of a tree below one root, which is no item. Rows count from 0.
///
/// Handles are numbers of a place in a table and of its use, so that one that has gone is told from all others: a host
/// that keeps a handle too long gets a refusal and not another item.
class TVX_PLATFORM_API TreeNodes {
public:
    TreeNodes() = default;
    TreeNodes(const TreeNodes&) = delete;
    TreeNodes& operator=(const TreeNodes&) = delete;

    TreeNode& root() {
        return m_root;
    }
    const TreeNode& root() const {
        return m_root;
    }
    std::size_t count() const {
        return m_count;
    }
    /// The item of a handle; null for null, for those of places (TVI_...), and for one that has gone.
    TreeNode* find(HTREEITEM item) const;
    /// Null for null and for the root.
    static HTREEITEM handleOf(const TreeNode* node);
    /// The row among its siblings. Counts again behind the last change in front of it.
    static int rowOf(TreeNode& node);
    /// Where a text belongs among children in order: without regard to case, behind those that are equal to it.
    static std::size_t sortedPlace(const TreeNode& parent, std::string_view text);

    /// Makes an empty node.
    /// @param row not behind the last child
    TreeNode& insert(TreeNode& parent, std::size_t row);
    /// Ends a node with all below it.
    void remove(TreeNode& node);
    /// Puts the children in another order.
    static void order(TreeNode& parent, std::vector<TreeNode*> children);

    /// The next node in the order of the tree, in which what is below a node follows it; null behind the last.
    static TreeNode* next(TreeNode& node);
    /// The next one that is not below it.
    static TreeNode* nextBehind(TreeNode& node);
    /// Whether a node is below another one, however deep.
    static bool isBelow(const TreeNode& node, const TreeNode& above);

    void select(TreeNode& node, bool selected);
    void selectNone();
    std::size_t selectedCount() const {
        return m_selectedCount;
    }

private:
    static constexpr std::size_t chunkSize = 256;

    TreeNode& at(std::size_t slot) const {
        return (*m_chunks[slot / chunkSize])[slot % chunkSize];
    }
    TreeNode& take();
    void release(TreeNode& node);

    TreeNode m_root;
    std::vector<std::unique_ptr<std::array<TreeNode, chunkSize>>> m_chunks;
    std::vector<std::uint32_t> m_free;
    std::size_t m_taken = 0;
    std::size_t m_count = 0;
    std::size_t m_selectedCount = 0;
};

} // namespace tvx::afx
