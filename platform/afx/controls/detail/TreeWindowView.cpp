// How a tree looks, what is selected and expanded in it, and what the user does with it.

#include "platform/afx/controls/detail/ImageListData.h"
#include "platform/afx/controls/detail/TreeWindow.h"
#include "platform/afx/core/detail/Connect.h"
#include "platform/afx/core/detail/Loop.h"

#include <QAbstractItemDelegate>

#include <cstring>

namespace tvx::afx {

// --- making ---

QWidget* TreeWindow::makeWidget(QWidget* parent) {
    m_model = new TreeModel(*this, nullptr);
    m_area = new TreeArea(parent, *m_model, *this);
    m_model->setParent(m_area);
    connectStoring(m_area, &QTreeView::expanded, m_area,
                   [this](const QModelIndex& index) { m_model->nodeOf(index).wasExpanded = true; });
    connectStoring(m_area->selectionModel(), &QItemSelectionModel::selectionChanged, m_area, [this] {
        m_selected.clear();
        m_selectionMoved = true;
        // Assistive tools select without keys and buttons.
        if (!m_area->isInAction() && !m_area->isQuiet()) {
            selectionSettled(TreeCause::Unknown);
        }
    });
    connectStoring(m_area->itemDelegate(), &QAbstractItemDelegate::closeEditor, m_area, [this] {
        const HTREEITEM item = std::exchange(m_edited, nullptr);
        if (item && !m_labelTaken) {
            NMTVDISPINFO given{};
            given.item.mask = TVIF_HANDLE;
            given.item.hItem = item;
            tell(given.hdr, TVN_ENDLABELEDIT);
        }
    });
    return m_area;
}

void TreeWindow::widgetMade() {
    applyStyle();
    Control::widgetMade();
}

void TreeWindow::applyStyle() {
    m_area->setFrameStyle(hasBorder() ? QFrame::StyledPanel | QFrame::Sunken : QFrame::NoFrame);
    m_area->setButtons((style() & TVS_HASBUTTONS) != 0, (style() & TVS_LINESATROOT) != 0);
    m_area->setShowsSelectionAlways((style() & TVS_SHOWSELALWAYS) != 0);
    m_area->setMultiple((m_treeStyle & TVS_EX_MULTISELECT) != 0);
}

void TreeWindow::styleChanged(DWORD oldStyle, DWORD oldExStyle) {
    Control::styleChanged(oldStyle, oldExStyle);
    applyStyle();
}

void TreeWindow::focusMoved(bool) {
    m_area->viewport()->update(); // what is selected looks different with the keyboard
}

QWidget* TreeWindow::clientWidget() const {
    return widget() ? m_area->viewport() : nullptr;
}

QRect TreeWindow::clientRect() const {
    return widget() ? m_area->viewport()->rect() : QRect();
}

UINT TreeWindow::dialogCode(const MSG*) const {
    // While a label is edited, Enter and Escape end that and not the dialog.
    return m_edited ? DLGC_WANTALLKEYS : DLGC_WANTARROWS | DLGC_WANTCHARS;
}

bool TreeWindow::isEditable() const {
    return (style() & TVS_EDITLABELS) != 0;
}

void TreeWindow::setImages(HIMAGELIST images) {
    m_images = images;
    m_area->setIconSize(imageSizeOf(images));
    m_area->doItemsLayout();
}

QIcon TreeWindow::iconOf(const TreeNode& node) {
    if (!m_images) {
        return {};
    }
    const bool isSelected = TreeNodes::handleOf(&node) == caret();
    QIcon icon(imageOf(m_images, isSelected ? node.selectedImage : node.image));
    return icon;
}

// --- selection ---

HTREEITEM TreeWindow::caret() const {
    const QModelIndex index = m_area->currentIndex();
    const bool counts = m_area->isMultiple() || m_area->selectionModel()->isSelected(index);
    return counts ? TreeNodes::handleOf(&m_model->nodeOf(index)) : nullptr;
}

bool TreeWindow::maySelect(TreeNode& node) {
    NMTREEVIEW told = about(&node);
    told.itemOld = about(nodes().find(m_toldCaret)).itemNew;
    told.action = TVC_UNKNOWN;
    const HWND self = handle();
    const bool refused = tell(told.hdr, TVN_SELCHANGING) != 0;
    return !refused && from(self);
}

void TreeWindow::selectionSettled(TreeCause cause) {
    const HTREEITEM now = caret();
    if (now == m_toldCaret && !(m_selectionMoved && m_area->isMultiple())) {
        return;
    }
    m_selectionMoved = false;
    NMTREEVIEW told = about(nodes().find(now));
    told.itemOld = about(nodes().find(std::exchange(m_toldCaret, now))).itemNew;
    told.action = cause == TreeCause::Mouse ? TVC_BYMOUSE : cause == TreeCause::Keyboard ? TVC_BYKEYBOARD : TVC_UNKNOWN;
    tell(told.hdr, TVN_SELCHANGED);
}

LRESULT TreeWindow::selectItem(HTREEITEM item) {
    TreeNode* node = nodes().find(item);
    if (item && !node) {
        return FALSE;
    }
    if (item != caret() && !maySelect(node ? *node : nodes().root())) {
        return FALSE;
    }
    node = nodes().find(item); // the parent may have changed what there is
    const QModelIndex index = node ? indexOf(*node) : QModelIndex();
    const HWND self = handle();
    guarded([&] {
        const TreeArea::Quiet quiet(*m_area);
        m_area->selectionModel()->setCurrentIndex(index, index.isValid() ? QItemSelectionModel::ClearAndSelect
                                                                         : QItemSelectionModel::Clear);
    });
    if (from(self)) {
        selectionSettled(TreeCause::Unknown);
    }
    return TRUE;
}

bool TreeWindow::ensureVisible(HTREEITEM item) {
    TreeNode* node = nodes().find(item);
    if (!node) {
        return false;
    }
    for (TreeNode* above = node->parent; above && above->parent; above = above->parent) {
        setExpanded(*above, true);
    }
    guarded([&] { m_area->scrollTo(indexOf(*node)); });
    return true;
}

// --- expansion ---

bool TreeWindow::tellExpansion(UINT code, TreeNode& node, bool expand) {
    NMTREEVIEW told = about(&node);
    told.action = expand ? TVE_EXPAND : TVE_COLLAPSE;
    return tell(told.hdr, code) == 0;
}

void TreeWindow::setExpanded(TreeNode& node, bool expand) {
    guarded([&] {
        const QModelIndex index = indexOf(node);
        if (expand) {
            m_model->tellAll(node); // before it is laid out, not while it is
        }
        m_area->setExpanded(index, expand);
    });
}

LRESULT TreeWindow::expandItem(HTREEITEM item, UINT how, bool byUser) {
    TreeNode* node = nodes().find(item);
    if (!node || !hasChildren(*node)) {
        return FALSE;
    }
    const bool isOpen = m_area->isExpanded(indexOf(*node));
    const bool expand = how == TVE_TOGGLE ? !isOpen : how == TVE_EXPAND;
    const bool tells = byUser || !node->wasExpanded; // hosts that expand again know what is there
    if (expand == isOpen || (tells && !tellExpansion(TVN_ITEMEXPANDING, *node, expand))) {
        return FALSE;
    }
    node = nodes().find(item);
    if (!node || node->children.empty()) {
        return FALSE;
    }
    TreeNode* below = nodes().find(caret());
    while (below && below != node) {
        below = below->parent;
    }
    if (!expand && below && caret() != item) {
        selectItem(item); // the keyboard does not stay on what is not seen
    }
    setExpanded(*node, expand);
    if (tells) {
        tellExpansion(TVN_ITEMEXPANDED, *node, expand);
    }
    return TRUE;
}

void TreeWindow::toggle(TreeNode& node, bool expand) {
    expandItem(TreeNodes::handleOf(&node), expand ? TVE_EXPAND : TVE_COLLAPSE, true);
}

// --- labels ---

bool TreeWindow::editLabel(HTREEITEM item) {
    TreeNode* node = nodes().find(item);
    if (!node || !isEditable()) {
        return false;
    }
    std::string text = fromQt(textOf(*node));
    NMTVDISPINFO asked{};
    asked.item.mask = TVIF_HANDLE | TVIF_TEXT | TVIF_PARAM;
    asked.item.hItem = item;
    asked.item.lParam = node->data;
    asked.item.pszText = text.data();
    if (tell(asked.hdr, TVN_BEGINLABELEDIT) != 0 || !nodes().find(item)) {
        return false;
    }
    ensureVisible(item);
    m_edited = item;
    m_labelTaken = false;
    guarded([&] { m_area->edit(indexOf(*nodes().find(item))); });
    return true;
}

void TreeWindow::labelEdited(HTREEITEM item, const QString& text) {
    m_labelTaken = true;
    std::string given = fromQt(text);
    NMTVDISPINFO told{};
    told.item.mask = TVIF_HANDLE | TVIF_TEXT;
    told.item.hItem = item;
    told.item.pszText = given.data();
    told.item.cchTextMax = static_cast<int>(given.size()) + 1;
    const HWND self = handle();
    const bool isTaken = tell(told.hdr, TVN_ENDLABELEDIT) != 0;
    TreeNode* node = isTaken && from(self) ? nodes().find(item) : nullptr;
    if (node) {
        node->text = told.item.pszText ? told.item.pszText : std::string();
        node->asksText = false;
        m_model->changed(*node);
    }
}

void TreeWindow::startEditing(TreeNode& node) {
    editLabel(TreeNodes::handleOf(&node));
}

bool TreeWindow::tellMouse(UINT code) {
    NMHDR header{};
    return tell(header, code) != 0;
}

// --- places ---

/// @param rect holds the item's handle, and receives its place
LRESULT TreeWindow::itemRect(RECT* rect, bool labelOnly) {
    HTREEITEM item = nullptr;
    std::memcpy(static_cast<void*>(&item), rect, sizeof item);
    TreeNode* node = nodes().find(item);
    const QModelIndex index = node ? indexOf(*node) : QModelIndex();
    QRect place = m_area->visualRect(index);
    if (!place.isValid()) {
        return FALSE;
    }
    if (labelOnly) {
        place = m_area->labelRect(index);
    } else {
        place.setLeft(0);
        place.setRight(m_area->viewport()->width() - 1);
    }
    *rect = fromQt(place);
    return TRUE;
}

LRESULT TreeWindow::hitTest(TVHITTESTINFO& info) {
    m_area->layOut();
    const QPoint point(info.pt.x, info.pt.y);
    const QModelIndex index = m_area->indexAt(point);
    info.hItem = nullptr;
    info.flags = TVHT_NOWHERE;
    if (!index.isValid()) {
        return 0;
    }
    const QRect label = m_area->labelRect(index);
    const int iconEnd = label.left() + (m_images ? m_area->iconSize().width() : 0);
    info.hItem = TreeNodes::handleOf(&m_model->nodeOf(index));
    info.flags = m_area->buttonRect(index).contains(point) ? TVHT_ONITEMBUTTON
                 : point.x() < label.left()                ? TVHT_ONITEMINDENT
                 : point.x() < iconEnd                     ? TVHT_ONITEMICON
                 : point.x() <= label.right()              ? TVHT_ONITEMLABEL
                                                           : TVHT_ONITEMRIGHT;
    return reinterpret_cast<LRESULT>(info.hItem);
}

LRESULT TreeWindow::viewProc(UINT message, WPARAM wParam, LPARAM lParam, bool& known) {
    const auto item = reinterpret_cast<HTREEITEM>(lParam);
    switch (message) {
    case TVM_SELECTITEM:
        return wParam == TVGN_CARET ? selectItem(item) : FALSE;
    case TVM_EXPAND:
        return expandItem(item, static_cast<UINT>(wParam), false);
    case TVM_ENSUREVISIBLE:
        return ensureVisible(item) ? TRUE : FALSE;
    case TVM_EDITLABEL:
        editLabel(item);
        return 0;
    case TVM_GETITEMRECT:
        return itemRect(reinterpret_cast<RECT*>(lParam), wParam != 0);
    case TVM_HITTEST:
        return hitTest(*reinterpret_cast<TVHITTESTINFO*>(lParam));
    case TVM_GETIMAGELIST:
        return reinterpret_cast<LRESULT>(m_images);
    case TVM_SETIMAGELIST: {
        const HIMAGELIST before = m_images;
        setImages(reinterpret_cast<HIMAGELIST>(lParam));
        return reinterpret_cast<LRESULT>(before);
    }
    case TVM_SETEXTENDEDSTYLE: {
        const auto mask = wParam != 0 ? static_cast<DWORD>(wParam) : ~0U;
        const DWORD before = m_treeStyle;
        m_treeStyle = (before & ~mask) | (static_cast<DWORD>(lParam) & mask);
        applyStyle();
        return static_cast<LRESULT>(before);
    }
    case TVM_GETEXTENDEDSTYLE:
        return static_cast<LRESULT>(m_treeStyle);
    default:
        known = false;
        return 0;
    }
}

} // namespace tvx::afx
