#include "platform/afx/controls/detail/ImageListData.h"
#include "platform/afx/controls/detail/TreeWindow.h"

#include <QAbstractScrollArea>
#include <QIcon>
#include <QPainter>
#include <QStyle>
#include <QStyleOption>

// How a tree looks: as the desktop's style shows the toolkit's own trees.

namespace tvx::afx {

namespace {

/// How much of the selection's colour is left where the keyboard is not, in hundredths.
constexpr int fadedShare = 30;

QColor mix(const QColor& color, const QColor& ground) {
    const auto part = [](int one, int other) { return (one * fadedShare + other * (100 - fadedShare)) / 100; };
    return {part(color.red(), ground.red()), part(color.green(), ground.green()), part(color.blue(), ground.blue())};
}

/// Without the keyboard the selection is a faint one, on which texts have the colour that they have beside it.
void fade(QPalette& palette) {
    for (const auto group : {QPalette::Active, QPalette::Inactive}) {
        const QColor ground = palette.color(group, QPalette::Base);
        palette.setColor(group, QPalette::Highlight, mix(palette.color(group, QPalette::Highlight), ground));
        palette.setColor(group, QPalette::HighlightedText, palette.color(group, QPalette::Text));
    }
}

} // namespace

bool TreeWindow::showsSelection() const {
    return (style() & TVS_SHOWSELALWAYS) != 0 || m_area->hasFocus() || m_field;
}

/// Buttons, and lines where the style draws such: from the item's own column to the left.
void TreeWindow::paintBranches(QPainter& painter, const TreeNode& node, bool hasButton) const {
    QStyleOption option;
    option.initFrom(m_area->viewport());
    const QStyle::State plain = option.state & ~QStyle::State_MouseOver;
    const bool hasLines = (style() & TVS_HASLINES) != 0;
    option.rect = QRect(rowRect(node).left(), rowRect(node).top(), indent(), m_rowHeight);
    for (const TreeNode* at = &node; at->parent && (at->parent->parent || hasRootColumn()); at = at->parent) {
        option.rect.translate(-indent(), 0);
        option.state = plain;
        if (hasLines) {
            option.state |= at == &node ? QStyle::State_Item : QStyle::State_None;
            option.state |= at != at->parent->children.back() ? QStyle::State_Sibling : QStyle::State_None;
        }
        if (at == &node && hasButton && (style() & TVS_HASBUTTONS) != 0) {
            option.state |= QStyle::State_Children;
            option.state |= node.isExpanded ? QStyle::State_Open : QStyle::State_None;
        }
        if (option.rect.right() >= 0) {
            m_area->style()->drawPrimitive(QStyle::PE_IndicatorBranch, &option, &painter, m_area);
        }
    }
}

void TreeWindow::paintRow(QPainter& painter, const TreeNode& node, const TreeLook& look) const {
    paintBranches(painter, node, look.hasButton);
    QStyleOptionViewItem option;
    option.initFrom(m_area->viewport());
    option.widget = m_area;
    option.state &= ~(QStyle::State_HasFocus | QStyle::State_MouseOver);
    option.rect = rowRect(node);
    option.font = m_area->font();
    option.font.setBold(option.font.bold() || node.isBold);
    option.fontMetrics = QFontMetrics(option.font);
    option.displayAlignment = Qt::AlignLeft | Qt::AlignVCenter;
    option.textElideMode = Qt::ElideNone;
    option.showDecorationSelected = true;
    option.features = QStyleOptionViewItem::HasDisplay;
    option.text = look.text;
    if (const QSize size = imageSizeOf(m_images); !size.isEmpty()) {
        option.features |= QStyleOptionViewItem::HasDecoration;
        option.decorationSize = size;
        option.decorationAlignment = Qt::AlignCenter;
        const QPixmap picture = imageOf(m_images, look.image);
        option.icon.addPixmap(picture);
        // Hosts have pictures of their own for selected items, which the style must not tint.
        option.icon.addPixmap(picture, QIcon::Selected);
    }
    const bool hasKeyboard = m_area->hasFocus() || m_field;
    if (node.isSelected && showsSelection()) {
        option.state |= QStyle::State_Selected;
        if (!hasKeyboard) {
            fade(option.palette);
        }
    }
    if (look.item == m_caret && m_area->hasFocus()) {
        option.state |= QStyle::State_HasFocus | QStyle::State_KeyboardFocusChange;
    }
    m_area->style()->drawControl(QStyle::CE_ItemViewItem, &option, &painter, m_area);
}

void TreeWindow::paint(QPainter& painter, const QRect& exposed) {
    m_repaintDue = false;
    if (m_frozen || isDestroyed()) {
        return;
    }
    // The parent is asked before the first line is painted, as it may change the tree.
    const int first = top() + exposed.top() / m_rowHeight;
    const int last = top() + exposed.bottom() / m_rowHeight;
    std::vector<TreeLook> looks;
    for (int row = first; row <= last && !isDestroyed(); ++row) {
        if (const TreeNode* node = m_rows.at(row)) {
            looks.push_back(lookOf(TreeNodes::handleOf(node)));
        }
    }
    if (isDestroyed()) {
        return;
    }
    painter.fillRect(exposed, m_area->viewport()->palette().brush(QPalette::Base));
    for (const TreeLook& look : looks) {
        const TreeNode* node = m_nodes.find(look.item);
        if (node && m_rows.rowOf(*node) >= 0) {
            paintRow(painter, *node, look);
        }
    }
}

} // namespace tvx::afx
