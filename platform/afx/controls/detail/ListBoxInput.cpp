#include "platform/afx/controls/detail/ListBoxWindow.h"

#include <QAbstractScrollArea>
#include <QAccessible>
#include <QKeyEvent>
#include <QMouseEvent>
#include <QScrollBar>

// What users do with list boxes.

namespace tvx::afx {

void ListBoxWindow::tellSelection() {
    QAccessibleEvent event(m_area, QAccessible::SelectionWithin);
    QAccessible::updateAccessibility(&event);
    if ((style() & LBS_NOTIFY) != 0) {
        notify(LBN_SELCHANGE);
    }
}

/// Goes to a line as the user does.
/// @param extend keep the anchor and select up to here. @param toggle change this line only.
void ListBoxWindow::moveCaret(int index, bool extend, bool toggle) {
    if (!m_items.isValid(index) || (style() & LBS_NOSEL) != 0) {
        return;
    }
    const int before = m_current;
    m_caret = index;
    if (!isMultiple()) {
        m_current = m_anchor = index;
    } else if (extend && isExtended()) {
        m_anchor = m_anchor < 0 ? index : m_anchor;
        if (!toggle) {
            selectRange(0, m_items.count() - 1, false);
        }
        selectRange(m_anchor, index, true);
    } else if (toggle) {
        m_items.at(index).selected = !m_items.at(index).selected;
        m_anchor = index;
    } else if (isExtended()) {
        m_anchor = index;
        selectOnly(index, index);
    }
    showRow(index);
    refresh();
    tellCaret();
    // A multiple selection is told of at each step: the same line may have come in or gone out.
    if (isMultiple() || before != m_current) {
        tellSelection();
    }
}

// --- mouse ---

/// The right button asks for a menu on what is selected, or on the line under it.
void ListBoxWindow::pressForMenu(QPoint at) {
    const int row = rowUnder(at);
    if (row >= 0 && !isSelected(row)) {
        moveCaret(row, false, false);
    }
}

void ListBoxWindow::press(const QMouseEvent& event, bool twice) {
    if (event.button() == Qt::RightButton) {
        pressForMenu(event.position().toPoint());
    }
    if (event.button() != Qt::LeftButton) {
        return;
    }
    const int row = rowAt(event.position().toPoint().y());
    // The first of two presses has selected the line already.
    if (twice) {
        if ((style() & LBS_NOTIFY) != 0) {
            notify(LBN_DBLCLK);
        }
        return;
    }
    const bool control = event.modifiers().testFlag(Qt::ControlModifier);
    const bool shift = event.modifiers().testFlag(Qt::ShiftModifier);
    const bool toggle = (style() & LBS_MULTIPLESEL) != 0 ? !isExtended() || control : control;
    moveCaret(row, shift, toggle);
}

void ListBoxWindow::drag(const QMouseEvent& event) {
    const int row = rowAt(event.position().toPoint().y());
    const bool selects = !isMultiple() || isExtended();
    if (event.buttons().testFlag(Qt::LeftButton) && selects && row >= 0 && row != m_caret) {
        moveCaret(row, isExtended(), false);
    }
}

// --- keys ---

bool ListBoxWindow::search(const QString& text) {
    // From behind the keyboard's line and around, so that the same letter pressed again goes on.
    const int found = m_items.find(fromQt(text), m_caret, ListItems::Match::Prefix);
    if (found >= 0) {
        moveCaret(found, false, false);
    }
    return found >= 0;
}

void ListBoxWindow::selectAll() {
    selectRange(0, m_items.count() - 1, true);
    tellSelection();
}

bool ListBoxWindow::scrollSideways(int key) {
    QScrollBar* bar = m_area->horizontalScrollBar();
    if ((key != Qt::Key_Left && key != Qt::Key_Right) || bar->maximum() == 0) {
        return false;
    }
    bar->triggerAction(key == Qt::Key_Left ? QScrollBar::SliderSingleStepSub : QScrollBar::SliderSingleStepAdd);
    return true;
}

/// The line that a key leads to; none for a key that leads nowhere.
std::optional<int> ListBoxWindow::targetOf(int key) const {
    // One line less than is seen: the last line stays in sight as the first.
    const int page = std::max(visibleRows() - 1, 1);
    const int last = m_items.count() - 1;
    switch (key) {
    case Qt::Key_Up:
    case Qt::Key_Left:
        return std::max(m_caret - 1, 0);
    case Qt::Key_Down:
    case Qt::Key_Right:
        return std::min(m_caret + 1, last);
    case Qt::Key_PageUp:
        return std::max(m_caret - page, 0);
    case Qt::Key_PageDown:
        return std::min(m_caret + page, last);
    case Qt::Key_Home:
        return 0;
    case Qt::Key_End:
        return last;
    default:
        return std::nullopt;
    }
}

bool ListBoxWindow::key(const QKeyEvent& event) {
    const bool control = event.modifiers().testFlag(Qt::ControlModifier);
    const bool shift = event.modifiers().testFlag(Qt::ShiftModifier);
    if (scrollSideways(event.key())) {
        return true;
    }
    if (const auto target = targetOf(event.key())) {
        if (control && !shift && isExtended() && m_items.isValid(*target)) {
            // Only the keyboard's line moves; the blank key then takes it into the selection.
            m_caret = *target;
            showRow(m_caret);
            refresh();
            tellCaret();
        } else {
            moveCaret(*target, shift, control && shift);
        }
        return true;
    }
    if (event.key() == Qt::Key_Space && isMultiple()) {
        moveCaret(m_caret, shift, !isExtended() || control);
        return true;
    }
    if (event.key() == Qt::Key_A && control && isExtended()) {
        selectAll();
        return true;
    }
    const bool types = !control && !event.text().isEmpty() && event.text().at(0).isPrint();
    return types && hasStrings() && search(event.text());
}

} // namespace tvx::afx
