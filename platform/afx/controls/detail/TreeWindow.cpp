#include "platform/afx/controls/detail/TreeWindow.h"

#include "platform/base/Text.h"

// The items of a tree.

namespace tvx::afx {

namespace {

std::unique_ptr<Window> makeTree(const CREATESTRUCT& cs) {
    return std::make_unique<TreeWindow>(cs);
}

const WindowClassEntry treeEntry("SysTreeView32", &makeTree);

bool isPlace(HTREEITEM item) {
    return item == TVI_ROOT || item == TVI_FIRST || item == TVI_LAST || item == TVI_SORT;
}

} // namespace

TreeWindow::TreeWindow(const CREATESTRUCT& cs) : Control(cs) {}

// --- inserting and removing ---

/// The node whose children a message is about; null for an item that has gone.
TreeNode* TreeWindow::parentOf(HTREEITEM item) {
    return !item || item == TVI_ROOT ? &m_nodes.root() : m_nodes.find(item);
}

HTREEITEM TreeWindow::insertItem(const TVINSERTSTRUCT& what) {
    TreeNode* parent = parentOf(what.hParent);
    if (!parent) {
        return nullptr;
    }
    std::size_t row = parent->children.size();
    if (what.hInsertAfter == TVI_FIRST) {
        row = 0;
    } else if (what.hInsertAfter == TVI_SORT) {
        const bool hasText = (what.item.mask & TVIF_TEXT) != 0 && what.item.pszText != LPSTR_TEXTCALLBACK;
        row = TreeNodes::sortedPlace(*parent, hasText && what.item.pszText ? what.item.pszText : "");
    } else if (what.hInsertAfter && !isPlace(what.hInsertAfter)) {
        TreeNode* before = m_nodes.find(what.hInsertAfter);
        if (!before || before->parent != parent) {
            return nullptr;
        }
        row = static_cast<std::size_t>(TreeNodes::rowOf(*before)) + 1;
    }
    TreeNode& node = m_nodes.insert(*parent, row);
    setContent(node, what.item);
    if ((what.item.mask & TVIF_STATE) != 0) {
        writeState(node, what.item.state, what.item.stateMask);
    }
    m_rows.inserted(node);
    // The first child gives a button to its parent, which may be in sight when the child is not.
    const bool isSeen = !parent->parent || parent->isExpanded || parent->children.size() == 1;
    if (isSeen && !m_layoutDue) {
        contentChanged();
    }
    return TreeNodes::handleOf(&node);
}

/// Removes a node without children and tells the parent of it. It is gone then, so that the parent may remove again
/// what it is told of.
void TreeWindow::removeTold(TreeNode& node) {
    NMTREEVIEW told{};
    told.itemOld = about(TreeNodes::handleOf(&node));
    m_nodes.remove(node);
    m_rows.forget();
    contentChanged();
    tell(told.hdr, TVN_DELETEITEM);
}

/// Removes an item's children and all below them, the last ones first: what is removed then moves nothing.
void TreeWindow::removeBelow(HTREEITEM item) {
    for (TreeNode* node = parentOf(item); node && !node->children.empty(); node = parentOf(item)) {
        while (!node->children.empty()) {
            node = node->children.back();
        }
        removeTold(*node);
    }
}

bool TreeWindow::removeItem(HTREEITEM item) {
    TreeNode* node = m_nodes.find(item);
    if (!node) {
        return false;
    }
    const TreeNode* caret = m_nodes.find(m_caret);
    const bool takesCaret = caret && (caret == node || TreeNodes::isBelow(*caret, *node));
    HTREEITEM heir = sibling(item, 1);
    heir = heir ? heir : sibling(item, -1);
    heir = heir ? heir : TreeNodes::handleOf(node->parent);
    removeBelow(item);
    node = m_nodes.find(item);
    if (node) {
        removeTold(*node);
    }
    if (takesCaret && !isDestroyed() && !m_nodes.find(m_caret)) {
        m_caret = nullptr;
        select(heir, Pick::Only, By::Program);
    }
    return true;
}

void TreeWindow::removeAll() {
    removeBelow(TVI_ROOT);
    m_extent = 0;
}

// --- properties ---

UINT TreeWindow::stateOf(const TreeNode& node) const {
    return (node.isSelected ? TVIS_SELECTED : 0U) | (node.isBold ? TVIS_BOLD : 0U) |
           (node.isExpanded ? TVIS_EXPANDED : 0U) | (node.wasExpanded ? TVIS_EXPANDEDONCE : 0U);
}

bool TreeWindow::readItem(TVITEM& item) {
    const TreeNode* node = m_nodes.find(item.hItem);
    if (!node) {
        return false;
    }
    item.state = (item.mask & TVIF_STATE) != 0 ? stateOf(*node) : item.state;
    item.iImage = (item.mask & TVIF_IMAGE) != 0 ? node->image : item.iImage;
    item.iSelectedImage = (item.mask & TVIF_SELECTEDIMAGE) != 0 ? node->selectedImage : item.iSelectedImage;
    item.lParam = (item.mask & TVIF_PARAM) != 0 ? node->data : item.lParam;
    if ((item.mask & TVIF_CHILDREN) != 0) {
        item.cChildren = hasChildren(item.hItem) ? 1 : 0;
    }
    if ((item.mask & TVIF_TEXT) != 0 && item.pszText && item.cchTextMax > 0) {
        text::copyCut(textOf(item.hItem), item.pszText, static_cast<std::size_t>(item.cchTextMax));
    }
    return true;
}

void TreeWindow::writeState(TreeNode& node, UINT state, UINT mask) {
    node.isBold = (mask & TVIS_BOLD) != 0 ? (state & TVIS_BOLD) != 0 : node.isBold;
    if ((mask & TVIS_EXPANDEDONCE) != 0) {
        node.wasExpanded = (state & TVIS_EXPANDEDONCE) != 0;
    }
    if ((mask & TVIS_SELECTED) == 0) {
        return;
    }
    const bool selects = (state & TVIS_SELECTED) != 0;
    const HTREEITEM item = TreeNodes::handleOf(&node);
    if (!isMultiple() && selects) {
        m_nodes.selectNone();
    }
    m_nodes.select(node, selects);
    if (selects && (!isMultiple() || !m_nodes.find(m_caret))) {
        m_caret = m_anchor = item;
    } else if (!selects && !isMultiple() && m_caret == item) {
        m_caret = nullptr;
    }
}

bool TreeWindow::writeItem(const TVITEM& item) {
    TreeNode* node = m_nodes.find(item.hItem);
    if (!node) {
        return false;
    }
    setContent(*node, item);
    if ((item.mask & TVIF_STATE) != 0) {
        writeState(*node, item.state, item.stateMask);
    }
    if (TreeRows::isInOpen(*node)) {
        contentChanged();
    }
    return true;
}

// --- messages ---

LRESULT TreeWindow::itemProc(UINT message, WPARAM wParam, LPARAM lParam, bool& known) {
    const auto item = reinterpret_cast<HTREEITEM>(lParam);
    switch (message) {
    case TVM_INSERTITEMA:
        return reinterpret_cast<LRESULT>(insertItem(*reinterpret_cast<const TVINSERTSTRUCT*>(lParam)));
    case TVM_DELETEITEM:
        if (item && item != TVI_ROOT) {
            return removeItem(item) ? TRUE : FALSE;
        }
        removeAll();
        return TRUE;
    case TVM_GETCOUNT:
        return static_cast<LRESULT>(m_nodes.count());
    case TVM_GETNEXTITEM:
        return reinterpret_cast<LRESULT>(relative(item, static_cast<UINT>(wParam)));
    case TVM_GETITEMA:
        return readItem(*reinterpret_cast<TVITEM*>(lParam)) ? TRUE : FALSE;
    case TVM_SETITEMA:
        return writeItem(*reinterpret_cast<const TVITEM*>(lParam)) ? TRUE : FALSE;
    case TVM_SORTCHILDREN:
        return sort(item) ? TRUE : FALSE;
    case TVM_SORTCHILDRENCB:
        return sortBy(*reinterpret_cast<const TVSORTCB*>(lParam)) ? TRUE : FALSE;
    case TVM_GETSELECTEDCOUNT:
        return static_cast<LRESULT>(m_nodes.selectedCount());
    default:
        return viewProc(message, wParam, lParam, known);
    }
}

LRESULT TreeWindow::viewProc(UINT message, WPARAM wParam, LPARAM lParam, bool& known) {
    const auto item = reinterpret_cast<HTREEITEM>(lParam);
    switch (message) {
    case TVM_SELECTITEM:
        if (wParam == TVGN_FIRSTVISIBLE) {
            return showFirst(item) ? TRUE : FALSE;
        }
        return wParam == TVGN_CARET && select(item, Pick::Only, By::Program) ? TRUE : FALSE;
    case TVM_EXPAND:
        return expand(item, static_cast<UINT>(wParam), By::Program) ? TRUE : FALSE;
    case TVM_ENSUREVISIBLE:
        return ensureVisible(item) ? TRUE : FALSE;
    case TVM_GETITEMRECT:
        return itemRect(reinterpret_cast<RECT*>(lParam), wParam != 0);
    case TVM_HITTEST:
        return hitTest(*reinterpret_cast<TVHITTESTINFO*>(lParam));
    case TVM_EDITLABELA:
        return reinterpret_cast<LRESULT>(editLabel(item));
    case TVM_GETEDITCONTROL:
        return reinterpret_cast<LRESULT>(m_field);
    case TVM_ENDEDITLABELNOW:
        return endEdit(wParam != 0) ? TRUE : FALSE;
    case TVM_GETIMAGELIST:
        return wParam == TVSIL_NORMAL ? reinterpret_cast<LRESULT>(m_images) : 0;
    case TVM_SETIMAGELIST:
        return wParam == TVSIL_NORMAL ? reinterpret_cast<LRESULT>(setImages(reinterpret_cast<HIMAGELIST>(lParam))) : 0;
    case TVM_GETEXTENDEDSTYLE:
        return static_cast<LRESULT>(m_treeStyle);
    case TVM_SETEXTENDEDSTYLE:
        return static_cast<LRESULT>(setTreeStyle(static_cast<DWORD>(wParam), static_cast<DWORD>(lParam)));
    default:
        known = false;
        return 0;
    }
}

LRESULT TreeWindow::defaultProc(UINT message, WPARAM wParam, LPARAM lParam) {
    if (message >= TV_FIRST && message <= TVM_GETSELECTEDCOUNT) {
        bool known = true;
        const LRESULT result = itemProc(message, wParam, lParam, known);
        return known ? result : 0;
    }
    switch (message) {
    case WM_DESTROY:
        // The parent frees its data while the control can still be asked about its items.
        endEdit(true);
        removeAll();
        return 0;
    case WM_SETREDRAW:
        setRedraw(wParam != 0);
        return 0;
    case WM_COMMAND:
        if (reinterpret_cast<HWND>(lParam) == m_field && HIWORD(wParam) == EN_CHANGE) {
            placeField();
        }
        return 0;
    default:
        return inputProc(message, wParam, lParam);
    }
}

} // namespace tvx::afx
