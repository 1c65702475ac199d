#include "platform/afx/controls/detail/TreeArea.h"

#include "platform/afx/core/detail/Loop.h"

#include <QHeaderView>
#include <QHelpEvent>
#include <QKeyEvent>
#include <QPointer>
#include <QStyledItemDelegate>
#include <QToolTip>

namespace tvx::afx {

namespace {

/// Room above and below the text of an item, in pixels.
constexpr int rowMargin = 2;

class TreeDelegate : public QStyledItemDelegate {
public:
    explicit TreeDelegate(TreeArea& area) : QStyledItemDelegate(&area), m_area(area) {}
    QSize sizeHint(const QStyleOptionViewItem& option, const QModelIndex& index) const override {
        return QStyledItemDelegate::sizeHint(option, index) + QSize(0, 2 * rowMargin);
    }

protected:
    void initStyleOption(QStyleOptionViewItem* option, const QModelIndex& index) const override {
        QStyledItemDelegate::initStyleOption(option, index);
        if (!m_area.showsSelection()) {
            option->state &= ~QStyle::State_Selected;
        }
        if (!m_area.hasFocus()) {
            option->state &= ~QStyle::State_Active; // as the desktop shows what is selected where the keyboard is not
        }
    }

private:
    TreeArea& m_area;
};

} // namespace

// --- the selection ---

TreeSelection::TreeSelection(QAbstractItemModel* model, TreeArea& area)
    : QItemSelectionModel(model, &area), m_area(area) {}

void TreeSelection::setCurrentIndex(const QModelIndex& index, QItemSelectionModel::SelectionFlags command) {
    if (m_area.allows(index)) {
        QItemSelectionModel::setCurrentIndex(index, command);
    }
}

void TreeSelection::select(const QItemSelection& selection, QItemSelectionModel::SelectionFlags command) {
    // The toolkit moves the keyboard's item first, so what was refused then is not selected either.
    const QModelIndexList indexes = m_area.isMultiple() ? QModelIndexList() : selection.indexes();
    if (indexes.isEmpty() || m_area.allows(indexes.front())) {
        QItemSelectionModel::select(selection, command);
    }
}

void TreeSelection::select(const QModelIndex& index, QItemSelectionModel::SelectionFlags command) {
    select(QItemSelection(index, index), command);
}

// --- making ---

TreeArea::TreeArea(QWidget* parent, TreeModel& model, TreeEvents& events)
    : QTreeView(parent), m_model(model), m_events(events) {
    setModel(&m_model);
    setSelectionModel(new TreeSelection(&m_model, *this));
    setItemDelegate(new TreeDelegate(*this));
    setHeaderHidden(true);
    setUniformRowHeights(true);
    setEditTriggers(NoEditTriggers);
    setExpandsOnDoubleClick(false);
    setTextElideMode(Qt::ElideNone);
    setHorizontalScrollMode(ScrollPerPixel);
    setDragDropMode(NoDragDrop);
    // As wide as the widest item seen: with many items the others are not measured.
    header()->setStretchLastSection(false);
    header()->setSectionResizeMode(QHeaderView::ResizeToContents);
    header()->setResizeContentsPrecision(0);
}

void TreeArea::setMultiple(bool multiple) {
    setSelectionMode(multiple ? ExtendedSelection : SingleSelection);
}

void TreeArea::setButtons(bool shown, bool atRoot) {
    m_buttons = shown;
    setRootIsDecorated(shown && atRoot);
    viewport()->update();
}

bool TreeArea::showsSelection() const {
    return m_showsSelectionAlways || hasFocus() || (isEditing());
}

bool TreeArea::allows(const QModelIndex& index) {
    const bool isSame = index == currentIndex() && selectionModel()->isSelected(index);
    if (!m_inAction || isQuiet() || isSame) {
        return true;
    }
    if (m_asked != index || !index.isValid()) {
        m_asked = index;
        m_mayMove = false;
        storing([&] { m_mayMove = m_events.maySelect(m_model.nodeOf(index)); });
    }
    return m_mayMove;
}

// --- places ---

QRect TreeArea::buttonRect(const QModelIndex& index) const {
    const bool isAtRoot = !index.parent().isValid();
    if (!index.isValid() || !m_buttons || (isAtRoot && !rootIsDecorated()) || !m_model.hasChildren(index)) {
        return {};
    }
    const QRect content = visualRect(index);
    return {content.left() - indentation(), content.top(), indentation(), content.height()};
}

QRect TreeArea::labelRect(const QModelIndex& index) const {
    QRect content = visualRect(index);
    content.setWidth(sizeHintForIndex(index).width());
    return content;
}

void TreeArea::drawBranches(QPainter* painter, const QRect& rect, const QModelIndex& index) const {
    if (m_buttons) {
        QTreeView::drawBranches(painter, rect, index);
    }
}

void TreeArea::doItemsLayout() {
    storing([this] { m_events.tellItems(); });
    QTreeView::doItemsLayout();
}

void TreeArea::resizeEvent(QResizeEvent* event) {
    // Lines reach to the edge, so that they can be hit behind their texts.
    header()->setMinimumSectionSize(std::max(viewport()->width(), 1));
    QTreeView::resizeEvent(event);
}

// --- what the user does ---

/// Runs an action in which the selection may move. The host may have ended the tree when it returns.
template <class Call>
void TreeArea::act(TreeCause cause, Call&& call) {
    const QPointer<TreeArea> alive(this);
    const bool outer = std::exchange(m_inAction, true);
    m_asked = QModelIndex();
    m_mayMove = true;
    std::forward<Call>(call)();
    if (alive) {
        m_inAction = outer;
        storing([&] { m_events.selectionSettled(cause); });
    }
}

QItemSelectionModel::SelectionFlags TreeArea::selectionCommand(const QModelIndex& index, const QEvent* event) const {
    if (isMultiple()) {
        return QTreeView::selectionCommand(index, event);
    }
    // One item stays selected whatever keys are held, and where nothing was hit.
    return index.isValid() ? QItemSelectionModel::ClearAndSelect : QItemSelectionModel::NoUpdate;
}

bool TreeArea::pressButton(QPoint point) {
    const QModelIndex index = indexAt(point);
    if (!buttonRect(index).contains(point)) {
        return false;
    }
    storing([&] { m_events.toggle(m_model.nodeOf(index), !isExpanded(index)); });
    return true;
}

void TreeArea::mousePressEvent(QMouseEvent* event) {
    const QPoint point = event->position().toPoint();
    if (event->button() == Qt::LeftButton && pressButton(point)) {
        return;
    }
    // The right button asks for a menu and selects nothing; neither does a place without an item.
    const bool selects = event->button() == Qt::LeftButton && indexAt(point).isValid();
    if (!selects) {
        return;
    }
    act(TreeCause::Mouse, [&] { QTreeView::mousePressEvent(event); });
}

void TreeArea::mouseMoveEvent(QMouseEvent* event) {
    if (isMultiple() && event->buttons() == Qt::LeftButton) {
        act(TreeCause::Mouse, [&] { QTreeView::mouseMoveEvent(event); });
    } else if (event->buttons() == Qt::NoButton) {
        QTreeView::mouseMoveEvent(event);
    }
}

void TreeArea::mouseReleaseEvent(QMouseEvent* event) {
    const QPointer<TreeArea> alive(this);
    const bool isRight = event->button() == Qt::RightButton;
    if (event->button() == Qt::LeftButton && isMultiple()) {
        act(TreeCause::Mouse, [&] { QTreeView::mouseReleaseEvent(event); });
    } else {
        QTreeView::mouseReleaseEvent(event);
    }
    if (alive && (isRight || event->button() == Qt::LeftButton)) {
        storing([&] { m_events.tellMouse(isRight ? NM_RCLICK : NM_CLICK); });
    }
}

void TreeArea::mouseDoubleClickEvent(QMouseEvent* event) {
    const QPoint point = event->position().toPoint();
    if (event->button() != Qt::LeftButton || pressButton(point)) {
        return;
    }
    const QPersistentModelIndex index(indexAt(point));
    const QPointer<TreeArea> alive(this);
    bool isTaken = true;
    storing([&] { isTaken = m_events.tellMouse(NM_DBLCLK); });
    if (!isTaken && alive && index.isValid() && m_model.hasChildren(index)) {
        storing([&] { m_events.toggle(m_model.nodeOf(index), !isExpanded(index)); });
    }
}

void TreeArea::moveSideways(bool forward) {
    const QModelIndex index = currentIndex();
    const bool isOpen = isExpanded(index);
    if (forward ? !isOpen && m_model.hasChildren(index) : isOpen) {
        storing([&] { m_events.toggle(m_model.nodeOf(index), forward); });
        return;
    }
    const QModelIndex target = forward ? m_model.index(0, 0, index) : index.parent();
    if (target.isValid()) {
        act(TreeCause::Keyboard,
            [&] { selectionModel()->setCurrentIndex(target, QItemSelectionModel::ClearAndSelect); });
    }
}

/// Expands with all below that there is. Hosts are asked for the children of the first item only: what is asked for on
/// demand may have no end.
void TreeArea::expandAll(const QModelIndex& index, bool asks) {
    const QPersistentModelIndex item(index);
    const QPointer<TreeArea> alive(this);
    if (!m_model.hasChildren(index) || (!asks && m_model.nodeOf(index).children.empty())) {
        return;
    }
    if (!isExpanded(index)) {
        storing([&] { m_events.toggle(m_model.nodeOf(index), true); });
    }
    for (int row = 0; alive && item.isValid() && isExpanded(item) && row < m_model.rowCount(item); ++row) {
        expandAll(m_model.index(row, 0, item), false);
    }
}

bool TreeArea::expandKey(const QKeyEvent& event) {
    const QModelIndex index = currentIndex();
    if (!index.isValid()) {
        return false;
    }
    switch (event.key()) {
    case Qt::Key_Right:
    case Qt::Key_Left:
        moveSideways(event.key() == Qt::Key_Right);
        return true;
    case Qt::Key_Plus:
    case Qt::Key_Minus:
        storing([&] { m_events.toggle(m_model.nodeOf(index), event.key() == Qt::Key_Plus); });
        return true;
    case Qt::Key_Asterisk:
        expandAll(index, true);
        return true;
    case Qt::Key_F2:
        storing([&] { m_events.startEditing(m_model.nodeOf(index)); });
        return true;
    default:
        return false;
    }
}

void TreeArea::keyPressEvent(QKeyEvent* event) {
    if (expandKey(*event)) {
        return;
    }
    if (event->key() == Qt::Key_Return || event->key() == Qt::Key_Enter) {
        bool isTaken = false;
        storing([&] { isTaken = m_events.tellMouse(NM_RETURN); });
        event->setAccepted(isTaken);
        return;
    }
    act(TreeCause::Keyboard, [&] { QTreeView::keyPressEvent(event); });
}

void TreeArea::keyboardSearch(const QString& search) {
    act(TreeCause::Keyboard, [&] { QTreeView::keyboardSearch(search); });
}

bool TreeArea::viewportEvent(QEvent* event) {
    if (event->type() == QEvent::ToolTip) {
        const auto* help = static_cast<QHelpEvent*>(event);
        const QModelIndex index = indexAt(help->pos());
        const QRect label = index.isValid() ? labelRect(index) : QRect();
        // What does not fit is told in full.
        const bool isCut = index.isValid() && (label.right() > viewport()->rect().right() || label.left() < 0);
        QToolTip::showText(help->globalPos(), isCut ? index.data().toString() : QString(), viewport());
        return true;
    }
    return QTreeView::viewportEvent(event);
}

} // namespace tvx::afx
