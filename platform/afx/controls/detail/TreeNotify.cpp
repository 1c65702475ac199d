#include "platform/afx/controls/detail/TreeWindow.h"
#include "platform/afx/core/detail/Dispatch.h"

#include <array>

// What the parent of a tree is told of and asked for.

namespace tvx::afx {

void TreeWindow::setContent(TreeNode& node, const TVITEM& item) {
    if ((item.mask & TVIF_TEXT) != 0) {
        node.asksText = item.pszText == LPSTR_TEXTCALLBACK;
        node.text = node.asksText || !item.pszText ? "" : item.pszText;
    }
    node.image = (item.mask & TVIF_IMAGE) != 0 ? item.iImage : node.image;
    node.selectedImage = (item.mask & TVIF_SELECTEDIMAGE) != 0 ? item.iSelectedImage : node.selectedImage;
    node.data = (item.mask & TVIF_PARAM) != 0 ? item.lParam : node.data;
    node.childrenHint = (item.mask & TVIF_CHILDREN) != 0 ? item.cChildren : node.childrenHint;
}

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

} // namespace tvx::afx
