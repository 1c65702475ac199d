#include "platform/afx/controls/detail/TreeWindow.h"

#include "platform/afx/core/detail/Dispatch.h"
#include "platform/afx/core/detail/Loop.h"
#include "platform/base/Text.h"

#include <algorithm>

namespace tvx::afx {

namespace {

std::unique_ptr<Window> makeTree(const CREATESTRUCT& cs) {
    return std::make_unique<TreeWindow>(cs);
}

const WindowClassEntry treeEntry("SysTreeView32", &makeTree);

TreeNode contentOf(const TVITEM& item) {
    TreeNode node;
    node.asksText = (item.mask & TVIF_TEXT) != 0 && item.pszText == LPSTR_TEXTCALLBACK;
    if ((item.mask & TVIF_TEXT) != 0 && !node.asksText && item.pszText) {
        node.text = item.pszText;
    }
    node.image = (item.mask & TVIF_IMAGE) != 0 ? item.iImage : 0;
    node.selectedImage = (item.mask & TVIF_SELECTEDIMAGE) != 0 ? item.iSelectedImage : node.image;
    node.data = (item.mask & TVIF_PARAM) != 0 ? item.lParam : 0;
    node.childrenHint = (item.mask & TVIF_CHILDREN) != 0 ? item.cChildren : 0;
    node.isBold = (item.mask & TVIF_STATE) != 0 && (item.state & item.stateMask & TVIS_BOLD) != 0;
    return node;
}

} // namespace

TreeWindow::TreeWindow(const CREATESTRUCT& cs) : Control(cs) {}

TreeWindow::~TreeWindow() = default;

TreeNodes& TreeWindow::nodes() const {
    return m_model->nodes();
}

QModelIndex TreeWindow::indexOf(TreeNode& node) const {
    return m_model->indexOf(node);
}

// --- notifications ---

/// Tells the parent. The tree may be gone afterwards.
LRESULT TreeWindow::tell(NMHDR& header, UINT code) {
    armIdle();
    if (!parent() || isDestroyed()) {
        return 0;
    }
    header = NMHDR{handle(), static_cast<UINT_PTR>(id()), code};
    return SendMessageA(parent()->handle(), WM_NOTIFY, header.idFrom, reinterpret_cast<LPARAM>(&header));
}

NMTREEVIEW TreeWindow::about(TreeNode* node) const {
    NMTREEVIEW told{};
    if (node && node->parent) {
        told.itemNew.mask = TVIF_HANDLE | TVIF_PARAM | TVIF_STATE;
        told.itemNew.hItem = TreeNodes::handleOf(node);
        told.itemNew.lParam = node->data;
        told.itemNew.state = stateOf(*node);
        told.itemNew.stateMask = ~0U;
    }
    return told;
}

QString TreeWindow::textOf(TreeNode& node) {
    if (!node.asksText) {
        return toQt(node.text.c_str());
    }
    std::array<char, 1024> buffer{};
    NMTVDISPINFO asked{};
    asked.item.mask = TVIF_TEXT | TVIF_HANDLE | TVIF_PARAM;
    asked.item.hItem = TreeNodes::handleOf(&node);
    asked.item.lParam = node.data;
    asked.item.pszText = buffer.data();
    asked.item.cchTextMax = static_cast<int>(buffer.size());
    tell(asked.hdr, TVN_GETDISPINFO);
    return asked.item.pszText ? toQt(asked.item.pszText) : QString(); // the host may point to a text of its own
}

bool TreeWindow::hasChildren(TreeNode& node) {
    if (!node.children.empty() || node.childrenHint != I_CHILDRENCALLBACK) {
        return !node.children.empty() || node.childrenHint != 0;
    }
    NMTVDISPINFO asked{};
    asked.item.mask = TVIF_CHILDREN | TVIF_HANDLE | TVIF_PARAM;
    asked.item.hItem = TreeNodes::handleOf(&node);
    asked.item.lParam = node.data;
    tell(asked.hdr, TVN_GETDISPINFO);
    return asked.item.cChildren != 0;
}

// --- items ---

HTREEITEM TreeWindow::insertItem(const TVINSERTSTRUCT& what) {
    TreeNode* parent = nodes().find(what.hParent);
    if (!parent && what.hParent && what.hParent != TVI_ROOT) {
        return nullptr; // one that has gone
    }
    TreeNode& above = parent ? *parent : nodes().root();
    const TreeNode content = contentOf(what.item);
    std::size_t row = above.children.size();
    if (what.hInsertAfter == TVI_FIRST) {
        row = 0;
    } else if (what.hInsertAfter == TVI_SORT) {
        row = TreeNodes::sortedPlace(above, content.text);
    } else if (TreeNode* before = nodes().find(what.hInsertAfter); before && before->parent == &above) {
        row = static_cast<std::size_t>(TreeNodes::rowOf(*before)) + 1;
    }
    HTREEITEM made = nullptr;
    guarded([&] { made = TreeNodes::handleOf(&m_model->insert(above, row, content)); });
    inserted(above);
    return made;
}

/// Has the view told of new items: once for all that come until the loop comes round.
void TreeWindow::inserted(TreeNode& parent) {
    const HTREEITEM above = TreeNodes::handleOf(&parent);
    if (parent.told == static_cast<int>(parent.children.size()) || (!m_untold.empty() && m_untold.back() == above)) {
        return;
    }
    if (m_untold.empty()) {
        const auto later = [self = handle()] {
            if (auto* tree = dynamic_cast<TreeWindow*>(from(self))) {
                storing([tree] { tree->tellItems(); });
            }
        };
        QMetaObject::invokeMethod(m_area, later, Qt::QueuedConnection);
    }
    m_untold.push_back(above);
}

void TreeWindow::tellItems() {
    for (const HTREEITEM above : std::exchange(m_untold, {})) {
        TreeNode* node = above ? nodes().find(above) : &nodes().root();
        // What is collapsed is told of its items when it is expanded.
        if (node && (!above || m_area->isExpanded(indexOf(*node)))) {
            guarded([&] { m_model->tellAll(*node); });
        }
    }
}

void TreeWindow::tellDeleted(TreeNode& node) {
    std::vector<HTREEITEM> going;
    const TreeNode* end = nullptr;
    for (TreeNode* below = &node; below && below != end; below = TreeNodes::next(*below)) {
        bool isBelow = false;
        for (const TreeNode* above = below; above && !isBelow; above = above->parent) {
            isBelow = above == &node;
        }
        if (!isBelow) {
            break;
        }
        if (below->parent) {
            going.push_back(TreeNodes::handleOf(below));
        }
    }
    // What lies below goes first, as the parts of what the host keeps do.
    for (auto item = going.rbegin(); item != going.rend(); ++item) {
        TreeNode* gone = nodes().find(*item);
        NMTREEVIEW told = about(gone);
        std::swap(told.itemOld, told.itemNew);
        if (gone) {
            tell(told.hdr, TVN_DELETEITEM);
        }
    }
}

bool TreeWindow::deleteItem(HTREEITEM item) {
    TreeNode* node = nodes().find(item);
    if (!node) {
        return false;
    }
    tellDeleted(*node);
    node = nodes().find(item);
    if (node && from(handle())) {
        guarded([&] { m_model->remove(*node); });
        m_selected.clear();
        selectionSettled(TreeCause::Unknown); // the keyboard has gone to a neighbour
    }
    return true;
}

void TreeWindow::deleteAll() {
    tellDeleted(nodes().root());
    m_untold.clear();
    m_selected.clear();
    m_toldCaret = nullptr;
    guarded([&] { m_model->clear(); });
}

UINT TreeWindow::stateOf(TreeNode& node) const {
    const QModelIndex index = indexOf(node);
    const bool isSelected = m_area->selectionModel()->isSelected(index);
    return (isSelected ? TVIS_SELECTED : 0U) | (m_area->isExpanded(index) ? TVIS_EXPANDED : 0U) |
           (node.isBold ? TVIS_BOLD : 0U) | (node.wasExpanded ? TVIS_EXPANDEDONCE : 0U);
}

bool TreeWindow::readItem(TVITEM& item) {
    TreeNode* node = nodes().find(item.hItem);
    if (!node) {
        return false;
    }
    if ((item.mask & TVIF_TEXT) != 0 && item.pszText && item.cchTextMax > 0) {
        const std::string text = node->asksText ? fromQt(textOf(*node)) : node->text;
        text::copyCut(text, item.pszText, static_cast<std::size_t>(item.cchTextMax));
    }
    if ((item.mask & TVIF_STATE) != 0) {
        item.state = stateOf(*node) & item.stateMask;
    }
    item.iImage = (item.mask & TVIF_IMAGE) != 0 ? node->image : item.iImage;
    item.iSelectedImage = (item.mask & TVIF_SELECTEDIMAGE) != 0 ? node->selectedImage : item.iSelectedImage;
    item.lParam = (item.mask & TVIF_PARAM) != 0 ? node->data : item.lParam;
    item.cChildren = (item.mask & TVIF_CHILDREN) != 0 ? static_cast<int>(hasChildren(*node)) : item.cChildren;
    return true;
}

bool TreeWindow::writeItem(const TVITEM& item) {
    TreeNode* node = nodes().find(item.hItem);
    if (!node) {
        return false;
    }
    const TreeNode content = contentOf(item);
    if ((item.mask & TVIF_TEXT) != 0) {
        node->text = content.text;
        node->asksText = content.asksText;
    }
    node->image = (item.mask & TVIF_IMAGE) != 0 ? item.iImage : node->image;
    node->selectedImage = (item.mask & TVIF_SELECTEDIMAGE) != 0 ? item.iSelectedImage : node->selectedImage;
    node->data = (item.mask & TVIF_PARAM) != 0 ? item.lParam : node->data;
    node->childrenHint = (item.mask & TVIF_CHILDREN) != 0 ? item.cChildren : node->childrenHint;
    if ((item.mask & TVIF_STATE) != 0) {
        writeState(*node, item);
    }
    guarded([&] { m_model->changed(*node); });
    return true;
}

void TreeWindow::writeState(TreeNode& node, const TVITEM& item) {
    node.isBold = (item.stateMask & TVIS_BOLD) != 0 ? (item.state & TVIS_BOLD) != 0 : node.isBold;
    if ((item.stateMask & TVIS_SELECTED) == 0) {
        return;
    }
    const bool select = (item.state & TVIS_SELECTED) != 0;
    const TreeArea::Quiet quiet(*m_area);
    guarded([&] {
        const QModelIndex index = indexOf(node);
        auto* selection = m_area->selectionModel();
        selection->select(index, !select                ? QItemSelectionModel::Deselect
                                 : m_area->isMultiple() ? QItemSelectionModel::Select
                                                        : QItemSelectionModel::ClearAndSelect);
        if (select && (!m_area->isMultiple() || !m_area->currentIndex().isValid())) {
            selection->setCurrentIndex(index, QItemSelectionModel::NoUpdate);
        }
    });
    m_selected.clear();
    m_toldCaret = caret();
}

// --- walking ---

HTREEITEM TreeWindow::visibleNeighbour(HTREEITEM item) {
    TreeNode* node = nodes().find(item);
    if (!node) {
        return nullptr;
    }
    const QModelIndex below = m_area->indexBelow(indexOf(*node));
    return below.isValid() ? TreeNodes::handleOf(&m_model->nodeOf(below)) : nullptr;
}

const std::vector<HTREEITEM>& TreeWindow::selectedItems() {
    if (m_selected.empty()) {
        std::vector<TreeNode*> chosen;
        for (const QModelIndex& index : m_area->selectionModel()->selectedIndexes()) {
            chosen.push_back(&m_model->nodeOf(index));
        }
        std::ranges::sort(chosen, [](TreeNode* left, TreeNode* right) { return TreeNodes::isBefore(*left, *right); });
        for (const TreeNode* node : chosen) {
            m_selected.push_back(TreeNodes::handleOf(node));
        }
        m_walked = 0;
    }
    return m_selected;
}

HTREEITEM TreeWindow::nextSelected(HTREEITEM item) {
    const auto& selected = selectedItems();
    if (!nodes().find(item)) {
        m_walked = 0;
        return selected.empty() ? nullptr : selected.front();
    }
    if (m_walked >= selected.size() || selected[m_walked] != item) {
        m_walked = static_cast<std::size_t>(std::ranges::find(selected, item) - selected.begin());
    }
    return m_walked + 1 < selected.size() ? selected[++m_walked] : nullptr;
}

HTREEITEM TreeWindow::relative(HTREEITEM item, UINT relation) {
    TreeNode* node = nodes().find(item);
    switch (relation) {
    case TVGN_ROOT:
        return nodes().root().children.empty() ? nullptr : TreeNodes::handleOf(nodes().root().children.front());
    case TVGN_CARET:
        return caret();
    case TVGN_FIRSTVISIBLE:
        m_area->layOut();
        return TreeNodes::handleOf(&m_model->nodeOf(m_area->indexAt(QPoint(1, 1))));
    case TVGN_NEXTVISIBLE:
        return visibleNeighbour(item);
    case TVGN_NEXTSELECTED:
        return nextSelected(item);
    case TVGN_CHILD:
        node = node ? node : item && item != TVI_ROOT ? nullptr : &nodes().root();
        return node && !node->children.empty() ? TreeNodes::handleOf(node->children.front()) : nullptr;
    case TVGN_PARENT:
        return node ? TreeNodes::handleOf(node->parent) : nullptr;
    case TVGN_NEXT:
    case TVGN_PREVIOUS: {
        const int row = node ? TreeNodes::rowOf(*node) + (relation == TVGN_NEXT ? 1 : -1) : -1;
        const bool exists = row >= 0 && row < static_cast<int>(node->parent->children.size());
        return exists ? TreeNodes::handleOf(node->parent->children[static_cast<std::size_t>(row)]) : nullptr;
    }
    default:
        return nullptr;
    }
}

// --- messages ---

LRESULT TreeWindow::itemProc(UINT message, WPARAM wParam, LPARAM lParam, bool& known) {
    const auto item = reinterpret_cast<HTREEITEM>(lParam);
    switch (message) {
    case TVM_INSERTITEM:
        return reinterpret_cast<LRESULT>(insertItem(*reinterpret_cast<const TVINSERTSTRUCT*>(lParam)));
    case TVM_DELETEITEM:
        if (!item || item == TVI_ROOT) {
            deleteAll();
            return TRUE;
        }
        return deleteItem(item) ? TRUE : FALSE;
    case TVM_GETCOUNT:
        return static_cast<LRESULT>(nodes().count());
    case TVM_GETNEXTITEM:
        return reinterpret_cast<LRESULT>(relative(item, static_cast<UINT>(wParam)));
    case TVM_GETITEM:
        return readItem(*reinterpret_cast<TVITEM*>(lParam)) ? TRUE : FALSE;
    case TVM_SETITEM:
        return writeItem(*reinterpret_cast<const TVITEM*>(lParam)) ? TRUE : FALSE;
    case TVM_SORTCHILDREN: {
        TreeNode* node = nodes().find(item);
        guarded([&] { m_model->sort(node ? *node : nodes().root()); });
        m_selected.clear();
        return TRUE;
    }
    case TVM_GETSELECTEDCOUNT:
        return static_cast<LRESULT>(selectedItems().size());
    default:
        return viewProc(message, wParam, lParam, known);
    }
}

LRESULT TreeWindow::defaultProc(UINT message, WPARAM wParam, LPARAM lParam) {
    if (message >= TVM_INSERTITEM && message <= TVM_GETSELECTEDCOUNT && m_area) {
        bool known = true;
        const LRESULT result = itemProc(message, wParam, lParam, known);
        return known ? result : 0;
    }
    if (message == WM_DESTROY) {
        // The owner frees its data while the control can still be asked about its items.
        deleteAll();
        return 0;
    }
    if (message == WM_SETREDRAW) {
        m_area->viewport()->setUpdatesEnabled(wParam != 0);
        return 0;
    }
    return Control::defaultProc(message, wParam, lParam);
}

} // namespace tvx::afx
