#include "platform/afx/controls/detail/TreeWindow.h"

#include "platform/afx/controls/detail/ImageListData.h"
#include "platform/afx/core/detail/Dispatch.h"
#include "platform/base/Text.h"

#include <algorithm>
#include <array>

// The items of a tree, and what the parent is told of and asked for.

namespace tvx::afx {

namespace {

std::unique_ptr<Window> makeTree(const CREATESTRUCT& cs) {
    return std::make_unique<TreeWindow>(cs);
}

const WindowClassEntry treeEntry("SysTreeView32", &makeTree);

bool isPlace(HTREEITEM item) {
    return item == TVI_ROOT || item == TVI_FIRST || item == TVI_LAST || item == TVI_SORT;
}

/// Sets what does not show at once: all but the states.
void setContent(TreeNode& node, const TVITEM& item) {
    if ((item.mask & TVIF_TEXT) != 0) {
        node.asksText = item.pszText == LPSTR_TEXTCALLBACK;
        node.text = node.asksText || !item.pszText ? "" : item.pszText;
    }
    node.image = (item.mask & TVIF_IMAGE) != 0 ? item.iImage : node.image;
    node.selectedImage = (item.mask & TVIF_SELECTEDIMAGE) != 0 ? item.iSelectedImage : node.selectedImage;
    node.data = (item.mask & TVIF_PARAM) != 0 ? item.lParam : node.data;
    node.childrenHint = (item.mask & TVIF_CHILDREN) != 0 ? item.cChildren : node.childrenHint;
}

} // namespace

TreeWindow::TreeWindow(const CREATESTRUCT& cs) : Control(cs) {}

// --- notifications ---

LRESULT TreeWindow::tell(NMHDR& header, UINT code) {
    if (!parent() || isDestroyed()) {
        return 0;
    }
    header = NMHDR{handle(), static_cast<UINT_PTR>(id()), code};
    return SendMessageA(parent()->handle(), WM_NOTIFY, header.idFrom, reinterpret_cast<LPARAM>(&header));
}

LRESULT TreeWindow::tellMouse(UINT code) {
    armIdle();
    NMHDR header{};
    return tell(header, code);
}

TVITEM TreeWindow::about(HTREEITEM item) const {
    TVITEM told{};
    if (const TreeNode* node = m_nodes.find(item)) {
        told.mask = TVIF_HANDLE | TVIF_STATE | TVIF_PARAM;
        told.hItem = item;
        told.state = stateOf(*node);
        told.stateMask = ~0U;
        told.lParam = node->data;
    }
    return told;
}

LRESULT TreeWindow::tellItem(UINT code, UINT action, HTREEITEM before, HTREEITEM now) {
    armIdle();
    NMTREEVIEW told{};
    told.action = action;
    told.itemOld = about(before);
    told.itemNew = about(now);
    return tell(told.hdr, code);
}

/// Asks the parent for what it keeps itself.
/// @param mask TVIF_..., all that the item is to be asked for
void TreeWindow::ask(HTREEITEM item, UINT mask, TreeLook& look) {
    std::array<char, 1024> buffer{};
    NMTVDISPINFO asked{};
    asked.item = about(item);
    asked.item.mask = mask;
    asked.item.pszText = buffer.data();
    asked.item.cchTextMax = static_cast<int>(buffer.size());
    tell(asked.hdr, TVN_GETDISPINFO);
    const TVITEM& answer = asked.item;
    if ((mask & TVIF_TEXT) != 0) {
        look.text = toQt(answer.pszText); // the parent may have put a pointer of its own there
    }
    look.image = (mask & TVIF_IMAGE) != 0           ? answer.iImage
                 : (mask & TVIF_SELECTEDIMAGE) != 0 ? answer.iSelectedImage
                                                    : look.image;
    look.hasButton = (mask & TVIF_CHILDREN) != 0 ? answer.cChildren != 0 : look.hasButton;
    TreeNode* node = m_nodes.find(item);
    if (node && (answer.mask & TVIF_DI_SETITEM) != 0) {
        TVITEM kept = answer;
        kept.mask = mask;
        setContent(*node, kept);
    }
}

TreeLook TreeWindow::lookOf(HTREEITEM item) {
    const TreeNode* node = m_nodes.find(item);
    if (!node) {
        return {};
    }
    TreeLook look{item,
                  {},
                  node->isSelected ? node->selectedImage : node->image,
                  !node->children.empty() || node->childrenHint > 0};
    UINT mask = node->asksText ? TVIF_TEXT : 0;
    if (m_images && look.image == I_IMAGECALLBACK) {
        mask |= node->isSelected ? TVIF_SELECTEDIMAGE : TVIF_IMAGE;
    }
    if (node->children.empty() && node->childrenHint == I_CHILDRENCALLBACK) {
        mask |= TVIF_CHILDREN;
    }
    if (!node->asksText) {
        look.text = toQt(node->text.c_str());
    }
    if (mask != 0) {
        ask(item, mask, look);
    }
    return look;
}

bool TreeWindow::hasChildren(HTREEITEM item) {
    const TreeNode* node = m_nodes.find(item);
    if (!node || !node->children.empty() || node->childrenHint != I_CHILDRENCALLBACK) {
        return node && (!node->children.empty() || node->childrenHint > 0);
    }
    TreeLook look;
    ask(item, TVIF_CHILDREN, look);
    return look.hasButton;
}

std::string TreeWindow::textOf(HTREEITEM item) {
    const TreeNode* node = m_nodes.find(item);
    if (!node || !node->asksText) {
        return node ? node->text : std::string();
    }
    TreeLook look;
    ask(item, TVIF_TEXT, look);
    return fromQt(look.text);
}

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
    if ((node = m_nodes.find(item))) {
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
    for (const TreeNode* child : std::vector<TreeNode*>(parent->children)) {
        texts.emplace_back(TreeNodes::handleOf(child), std::string());
    }
    for (auto& [child, text] : texts) {
        text = textOf(child);
    }
    std::ranges::stable_sort(
        texts, [](const auto& left, const auto& right) { return text::compareNoCase(left.second, right.second) < 0; });
    std::vector<HTREEITEM> order;
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
    for (const TreeNode* child : parent->children) {
        data.emplace_back(TreeNodes::handleOf(child), child->data);
    }
    // A merge sort: whatever a host's function answers, nothing is read beyond the end.
    std::ranges::stable_sort(data, [&how](const auto& left, const auto& right) {
        return how.lpfnCompare(left.second, right.second, how.lParam) < 0;
    });
    std::vector<HTREEITEM> order;
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
