#include "platform/afx/controls/detail/AccessibleTree.h"
#include "platform/afx/controls/detail/ImageListData.h"
#include "platform/afx/controls/detail/TreeArea.h"
#include "platform/afx/controls/detail/TreeWindow.h"
#include "platform/afx/core/detail/Connect.h"
#include "platform/afx/core/detail/Loop.h"

#include <QAccessible>
#include <QCoreApplication>
#include <QScrollBar>
#include <QStyle>
#include <QTimer>

#include <cstring>

// The lines of a tree, and where they stand.

namespace tvx::afx {

// --- making ---

QWidget* TreeWindow::makeWidget(QWidget* parent) {
    m_area = new TreeArea(parent, *this);
    m_editLater = new QTimer(m_area);
    m_editLater->setSingleShot(true);
    connectStoring(m_editLater, &QTimer::timeout, m_area, [this] { editLabel(m_caret); });
    answerForTrees();
    return m_area;
}

void TreeWindow::widgetMade() {
    applyBars();
    Control::widgetMade();
}

int TreeWindow::accessibleRole() const {
    return QAccessible::Tree;
}

void TreeWindow::applyBars() {
    m_area->setFrameStyle(hasBorder() ? QFrame::StyledPanel | QFrame::Sunken : QFrame::NoFrame);
    refresh();
}

void TreeWindow::styleChanged(DWORD oldStyle, DWORD oldExStyle) {
    Control::styleChanged(oldStyle, oldExStyle);
    guarded([this] { applyBars(); });
}

void TreeWindow::fontChanged() {
    Control::fontChanged();
    setImages(m_images);
}

void TreeWindow::applyColors(QPalette& palette, const QColor& text, const QColor& background) const {
    applyFieldColors(palette, text, background);
}

QWidget* TreeWindow::clientWidget() const {
    return widget() ? m_area->viewport() : nullptr;
}

QRect TreeWindow::clientRect() const {
    return widget() ? m_area->viewport()->rect() : QRect();
}

UINT TreeWindow::dialogCode(const MSG*) const {
    return DLGC_WANTARROWS | DLGC_WANTCHARS;
}

void TreeWindow::focusMoved(bool) {
    refresh();
    tellCaret();
}

/// Lines are as high as their text, or as their pictures where those are higher.
HIMAGELIST TreeWindow::setImages(HIMAGELIST images) {
    constexpr int textMargin = 4;
    constexpr int imageMargin = 2;
    const HIMAGELIST before = std::exchange(m_images, images);
    m_rowHeight = std::max(m_area->fontMetrics().height() + textMargin, imageSizeOf(m_images).height() + imageMargin);
    m_extent = 0;
    contentChanged();
    return before;
}

DWORD TreeWindow::setTreeStyle(DWORD mask, DWORD style) {
    const DWORD before = m_treeStyle;
    mask = mask != 0 ? mask : ~DWORD{0};
    m_treeStyle = (before & ~mask) | (style & mask & TVS_EX_MULTISELECT);
    TreeNode* caret = m_nodes.find(m_caret);
    if (!isMultiple() && m_nodes.selectedCount() > 0) {
        m_nodes.selectNone();
        pick(caret, Pick::Only);
    }
    refresh();
    return before;
}

// --- lines and scrolling ---

/// Has lines counted and all painted when the loop comes to it, or when a question depends on it.
void TreeWindow::contentChanged() {
    refresh();
    if (std::exchange(m_layoutDue, true)) {
        return;
    }
    // The widget lives a little longer than the tree.
    const auto later = [self = handle()] {
        if (auto* tree = dynamic_cast<TreeWindow*>(from(self))) {
            storing([tree] { tree->layOut(); });
        }
    };
    QMetaObject::invokeMethod(m_area, later, Qt::QueuedConnection);
}

/// Has all of it painted when the loop comes to it. Asked for again before that costs nothing.
void TreeWindow::refresh() {
    if (!m_frozen && widget() && !std::exchange(m_repaintDue, true)) {
        m_area->viewport()->update();
    }
}

void TreeWindow::setRedraw(bool redraw) {
    m_frozen = !redraw;
    refresh();
}

void TreeWindow::layOut() {
    if (m_layoutDue && !isDestroyed()) {
        m_layoutDue = false;
        applyRange();
    }
}

void TreeWindow::applyRange() {
    if (!widget()) {
        return;
    }
    guarded([this] {
        QScrollBar* vertical = m_area->verticalScrollBar();
        const int last = std::max(m_rows.size() - pageRows(), 0);
        const int before = top();
        {
            // Lines that came or went above the first one must not move it.
            const QSignalBlocker quiet(vertical->isVisible() == (last > 0) ? vertical : nullptr);
            vertical->setPageStep(pageRows());
            vertical->setRange(0, last);
            vertical->setValue(before > 0 ? rowOfTop(before) : 0);
        }
        measure();
    });
    if (!isDestroyed()) {
        keepTop();
        showBars();
        placeField();
    }
}

/// Where the item that was in the first line is now, or what it is in.
int TreeWindow::rowOfTop(int before) const {
    for (const TreeNode* node = m_nodes.find(m_top); node && node->parent; node = node->parent) {
        if (const int row = m_rows.rowOf(*node); row >= 0) {
            return row;
        }
    }
    return before;
}

void TreeWindow::keepTop() {
    m_top = TreeNodes::handleOf(m_rows.at(top()));
}

/// Has the bar below go as far as the widest of the lines that were seen. The others are not measured.
void TreeWindow::measure() {
    const int first = top();
    for (int row = first; row < first + visibleRows() + 1 && !isDestroyed(); ++row) {
        const TreeNode* node = m_rows.at(row);
        if (!node) {
            break;
        }
        const HTREEITEM item = TreeNodes::handleOf(node);
        const TreeLook look = lookOf(item);
        node = m_nodes.find(item);
        if (node) {
            const QRect label = labelRect(*node, look.text);
            m_extent = std::max(m_extent, label.right() + 1 + m_area->horizontalScrollBar()->value());
        }
    }
    if (isDestroyed()) {
        return;
    }
    QScrollBar* horizontal = m_area->horizontalScrollBar();
    horizontal->setPageStep(m_area->viewport()->width());
    horizontal->setSingleStep(m_area->fontMetrics().averageCharWidth() * 2);
    horizontal->setRange(0, std::max(m_extent - m_area->viewport()->width(), 0));
}

/// The toolkit shows and hides bars when the loop comes to it. Who scrolls to an item before that must not be told of
/// room that a bar takes.
void TreeWindow::showBars() {
    const auto isLate = [](const QScrollBar* bar) { return bar->parentWidget()->isHidden() == (bar->maximum() > 0); };
    if (m_showsBars || (!isLate(m_area->horizontalScrollBar()) && !isLate(m_area->verticalScrollBar()))) {
        return;
    }
    m_showsBars = true;
    QEvent request(QEvent::LayoutRequest);
    guarded([&] { QCoreApplication::sendEvent(m_area, &request); });
    m_showsBars = false;
}

void TreeWindow::scrolled() {
    if (!isDestroyed() && !m_layoutDue) {
        keepTop();
        measure();
        placeField();
    }
    refresh();
}

void TreeWindow::resized() {
    applyRange();
}

int TreeWindow::top() const {
    return m_area->verticalScrollBar()->value();
}

void TreeWindow::setTop(int row) {
    guarded([&] { m_area->verticalScrollBar()->setValue(row); });
}

/// Lines that are wholly seen.
int TreeWindow::pageRows() const {
    return std::max(m_area->viewport()->height() / m_rowHeight, 1);
}

/// Those that are seen in part as well.
int TreeWindow::visibleRows() const {
    return (m_area->viewport()->height() + m_rowHeight - 1) / m_rowHeight;
}

void TreeWindow::showRow(int row) {
    if (row < top()) {
        setTop(row);
    } else if (row >= top() + pageRows()) {
        setTop(row - pageRows() + 1);
    }
}

/// Scrolls sideways as far as it takes to see a label, its beginning before its end.
void TreeWindow::showSideways(HTREEITEM item) {
    const TreeLook look = lookOf(item);
    const TreeNode* node = isDestroyed() ? nullptr : m_nodes.find(item);
    if (!node) {
        return;
    }
    const QRect label = labelRect(*node, look.text);
    const int start = left(*node);
    QScrollBar* bar = m_area->horizontalScrollBar();
    const int width = m_area->viewport()->width();
    const int beyond = label.right() + 1 - width;
    // Of a label that is too long anyway the beginning will do: what is above it is of more use than some more of it.
    const bool isSeen = label.width() > width && start >= 0 && start < width / 2;
    guarded([&] {
        if (start < 0) {
            bar->setValue(bar->value() + start);
        } else if (beyond > 0 && !isSeen) {
            bar->setValue(bar->value() + std::min(beyond, start));
        }
    });
}

bool TreeWindow::ensureVisible(HTREEITEM item) {
    const bool opened = openAround(item);
    const TreeNode* node = isDestroyed() ? nullptr : m_nodes.find(item);
    const int row = node ? m_rows.rowOf(*node) : -1;
    if (row < 0) {
        return false;
    }
    layOut();
    const int before = top();
    showRow(row);
    showSideways(item);
    return opened || (!isDestroyed() && before != top());
}

bool TreeWindow::showFirst(HTREEITEM item) {
    openAround(item);
    const TreeNode* node = isDestroyed() ? nullptr : m_nodes.find(item);
    const int row = node ? m_rows.rowOf(*node) : -1;
    if (row < 0) {
        return false;
    }
    layOut();
    setTop(row);
    return true;
}

// --- places ---

/// Whether the topmost items have room for a button before them.
bool TreeWindow::hasRootColumn() const {
    return (style() & TVS_LINESATROOT) != 0 && (style() & (TVS_HASBUTTONS | TVS_HASLINES)) != 0;
}

int TreeWindow::indent() const {
    return m_area->style()->pixelMetric(QStyle::PM_TreeViewIndentation, nullptr, m_area);
}

int TreeWindow::depthOf(const TreeNode& node) const {
    int depth = hasRootColumn() ? 1 : 0;
    for (const TreeNode* above = node.parent; above && above->parent; above = above->parent) {
        ++depth;
    }
    return depth;
}

/// Where an item's picture or label begins, in client coordinates.
int TreeWindow::left(const TreeNode& node) const {
    return depthOf(node) * indent() - m_area->horizontalScrollBar()->value();
}

/// The toolkit's margin on both sides of a picture or text.
int TreeWindow::margin() const {
    return m_area->style()->pixelMetric(QStyle::PM_FocusFrameHMargin, nullptr, m_area) + 1;
}

int TreeWindow::imageWidth() const {
    const int width = imageSizeOf(m_images).width();
    return width > 0 ? width + 2 * margin() : 0;
}

QRect TreeWindow::rowRect(const TreeNode& node) const {
    const int row = m_rows.rowOf(node);
    if (row < 0) {
        return {};
    }
    const int start = left(node);
    const int width = m_area->viewport()->width();
    const int end = std::max(width, m_extent - m_area->horizontalScrollBar()->value());
    return {start, (row - top()) * m_rowHeight, end - start, m_rowHeight};
}

QRect TreeWindow::labelRect(const TreeNode& node, const QString& text) const {
    QFont font = m_area->font();
    font.setBold(font.bold() || node.isBold);
    const QRect line = rowRect(node);
    const int width = QFontMetrics(font).horizontalAdvance(text) + 2 * margin();
    return {line.left() + imageWidth(), line.top(), width, line.height()};
}

/// The place of an item's button, whether it has one or not; empty where none could be.
QRect TreeWindow::buttonRect(const TreeNode& node) const {
    const bool hasColumn = node.parent && (node.parent->parent || hasRootColumn());
    if ((style() & TVS_HASBUTTONS) == 0 || !hasColumn) {
        return {};
    }
    const QRect line = rowRect(node);
    return {line.left() - indent(), line.top(), indent(), line.height()};
}

HTREEITEM TreeWindow::itemAt(int y) const {
    return y >= 0 ? TreeNodes::handleOf(m_rows.at(top() + y / m_rowHeight)) : nullptr;
}

TreeWindow::Hit TreeWindow::hit(QPoint point) {
    const QRect area = clientRect();
    if (!area.contains(point)) {
        const UINT aside = point.x() < 0 ? TVHT_TOLEFT : point.x() >= area.width() ? TVHT_TORIGHT : 0U;
        const UINT over = point.y() < 0 ? TVHT_ABOVE : point.y() >= area.height() ? TVHT_BELOW : 0U;
        return {nullptr, aside | over};
    }
    layOut();
    const HTREEITEM item = itemAt(point.y());
    const TreeLook look = lookOf(item);
    const TreeNode* node = isDestroyed() ? nullptr : m_nodes.find(item);
    if (!node) {
        return {};
    }
    const QRect label = labelRect(*node, look.text);
    const bool onButton = look.hasButton && buttonRect(*node).contains(point);
    return {item, onButton                     ? UINT{TVHT_ONITEMBUTTON}
                  : point.x() < left(*node)    ? UINT{TVHT_ONITEMINDENT}
                  : point.x() < label.left()   ? UINT{TVHT_ONITEMICON}
                  : point.x() <= label.right() ? UINT{TVHT_ONITEMLABEL}
                                               : UINT{TVHT_ONITEMRIGHT}};
}

LRESULT TreeWindow::hitTest(TVHITTESTINFO& info) {
    const Hit found = hit(toQt(info.pt));
    info.hItem = found.item;
    info.flags = found.part;
    return reinterpret_cast<LRESULT>(found.item);
}

/// @param rect holds the item, and receives its place
LRESULT TreeWindow::itemRect(RECT* rect, bool textOnly) {
    HTREEITEM item = nullptr;
    std::memcpy(static_cast<void*>(&item), rect, sizeof(HTREEITEM)); // NOLINT(bugprone-sizeof-expression): the handle
    layOut();
    const TreeLook look = lookOf(item);
    const TreeNode* node = isDestroyed() ? nullptr : m_nodes.find(item);
    const QRect line = node ? rowRect(*node) : QRect();
    if (line.isEmpty()) {
        return FALSE;
    }
    const QRect whole(0, line.top(), m_area->viewport()->width(), line.height());
    *rect = fromQt(textOnly ? labelRect(*node, look.text) : whole);
    return TRUE;
}

QString TreeWindow::tipAt(QPoint point) {
    const Hit found = hit(point);
    const TreeLook look = lookOf(found.item);
    const TreeNode* node = isDestroyed() ? nullptr : m_nodes.find(found.item);
    if (!node || m_field) {
        return {};
    }
    const QRect label = labelRect(*node, look.text);
    return clientRect().left() <= label.left() && label.right() <= clientRect().right() ? QString() : look.text;
}

} // namespace tvx::afx
