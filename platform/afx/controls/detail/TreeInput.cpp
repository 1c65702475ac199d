#include "platform/afx/controls/detail/TreeWindow.h"
#include "platform/afx/core/WindowCalls.h"
#include "platform/afx/core/detail/Keys.h"
#include "platform/afx/core/detail/Loop.h"
#include "platform/base/Text.h"

#include <QAbstractScrollArea>
#include <QAccessible>
#include <QApplication>
#include <QMouseEvent>
#include <QScrollBar>
#include <QTimer>

#include <algorithm>

// What users do with trees.

namespace tvx::afx {

// --- assistive tools ---

void TreeWindow::choose(HTREEITEM item) {
    select(item, Pick::Only, By::Keyboard);
}

void TreeWindow::toggle(HTREEITEM item) {
    expand(item, TVE_TOGGLE, By::Keyboard);
}

void TreeWindow::tellCaret() {
    const TreeNode* node = m_nodes.find(m_caret);
    const int row = node ? m_rows.rowOf(*node) : -1;
    if (row < 0 || !QAccessible::isActive()) {
        return;
    }
    if (m_area->hasFocus()) {
        QAccessibleEvent event(m_area, QAccessible::Focus);
        event.setChild(row);
        QAccessible::updateAccessibility(&event);
    }
    QAccessibleEvent event(m_area, QAccessible::SelectionWithin);
    QAccessible::updateAccessibility(&event);
}

void TreeWindow::tellOpened(HTREEITEM item, bool opened) {
    const TreeNode* node = m_nodes.find(item);
    const int row = node && QAccessible::isActive() ? m_rows.rowOf(*node) : -1;
    if (row < 0) {
        return;
    }
    QAccessible::State changed;
    changed.expanded = true;
    changed.collapsed = true;
    QAccessibleStateChangeEvent event(m_area, changed);
    event.setChild(row);
    QAccessible::updateAccessibility(&event);
    QAccessibleEvent order(m_area, QAccessible::ObjectReorder);
    QAccessible::updateAccessibility(&order);
}

// --- mouse ---

/// What keys that are held make of a selection.
TreeWindow::Pick TreeWindow::pickFor(bool control, bool shift) const {
    if (!isMultiple()) {
        return Pick::Only;
    }
    return shift ? control ? Pick::AddRange : Pick::Range : control ? Pick::Toggle : Pick::Only;
}

void TreeWindow::press(const QMouseEvent& event) {
    m_editLater->stop();
    const Hit at = hit(event.position().toPoint());
    const TreeNode* node = isDestroyed() ? nullptr : m_nodes.find(at.item);
    const bool isLeft = event.button() == Qt::LeftButton;
    if (!node || (!isLeft && event.button() != Qt::RightButton)) {
        m_mayEdit = false;
        return;
    }
    m_mayEdit = isLeft && at.part == TVHT_ONITEMLABEL && isOnlySelected(at.item) && !m_isNewToKeyboard;
    if (isLeft && at.part == TVHT_ONITEMBUTTON) {
        expand(at.item, TVE_TOGGLE, By::Mouse);
    } else if (isLeft && at.part != TVHT_ONITEMINDENT) {
        const auto held = event.modifiers();
        select(at.item, pickFor(held.testFlag(Qt::ControlModifier), held.testFlag(Qt::ShiftModifier)), By::Mouse);
    } else if (!isLeft && !node->isSelected) {
        // The right button asks for a menu on what is selected, or on the item under it.
        select(at.item, Pick::Only, By::Mouse);
    }
}

void TreeWindow::release(const QMouseEvent& event) {
    m_isNewToKeyboard = false;
    if (event.button() != Qt::LeftButton) {
        return;
    }
    const bool isTaken = tellMouse(NM_CLICK) != 0;
    if (m_mayEdit && !isTaken && !isDestroyed() && isEditable()) {
        m_editLater->start(QApplication::doubleClickInterval());
    }
    m_mayEdit = false;
}

void TreeWindow::pressTwice(const QMouseEvent& event) {
    m_editLater->stop();
    m_mayEdit = false;
    const Hit at = hit(event.position().toPoint());
    if (event.button() != Qt::LeftButton || isDestroyed()) {
        return;
    }
    if (at.part == TVHT_ONITEMBUTTON) {
        expand(at.item, TVE_TOGGLE, By::Mouse);
        return;
    }
    const bool isOnItem = at.item && at.part != TVHT_ONITEMINDENT;
    if (isOnItem && event.modifiers() == Qt::NoModifier) {
        select(at.item, Pick::Only, By::Mouse); // the first press may have hit another item
    }
    if (!isDestroyed() && tellMouse(NM_DBLCLK) == 0 && !isDestroyed() && isOnItem) {
        expand(at.item, TVE_TOGGLE, By::Mouse);
    }
}

// --- keys ---

/// The line that a key leads to; none for a key that leads nowhere.
std::optional<int> TreeWindow::targetOf(int key) const {
    const TreeNode* caret = m_nodes.find(m_caret);
    const int row = caret ? m_rows.rowOf(*caret) : -1;
    const int last = m_rows.size() - 1;
    // One line less than is seen: the last line stays in sight as the first.
    const int page = std::max(pageRows() - 1, 1);
    switch (key) {
    case VK_UP:
        return std::max(row - 1, 0);
    case VK_DOWN:
        return std::min(row + 1, last);
    case VK_PRIOR:
        return std::max(row - page, 0);
    case VK_NEXT:
        return std::min(row + page, last);
    case VK_HOME:
        return 0;
    case VK_END:
        return last;
    default:
        return std::nullopt;
    }
}

/// Right opens and then goes in, Left closes and then goes out; Backspace goes out.
bool TreeWindow::openKey(int key) {
    const HTREEITEM item = m_caret;
    const TreeNode* node = m_nodes.find(item);
    if (key != VK_LEFT && key != VK_RIGHT && key != VK_BACK) {
        return false;
    }
    if (!node) {
        return true;
    }
    HTREEITEM target = nullptr;
    if (key == VK_RIGHT && !node->isExpanded) {
        open(item, By::Keyboard);
    } else if (key == VK_RIGHT && !node->children.empty()) {
        target = TreeNodes::handleOf(node->children.front());
    } else if (key == VK_LEFT && node->isExpanded) {
        close(item, By::Keyboard, false);
    } else {
        target = TreeNodes::handleOf(node->parent);
    }
    if (target) {
        select(target, Pick::Only, By::Keyboard);
    }
    return true;
}

/// With Ctrl the keyboard moves alone through several selected items; else it scrolls.
bool TreeWindow::controlKey(int key) {
    if (key == 'A' && isMultiple() && m_nodes.find(m_caret)) {
        return select(m_caret, Pick::All, By::Keyboard);
    }
    const auto target = targetOf(key);
    const TreeNode* node = target ? m_rows.at(*target) : nullptr;
    if (node && isMultiple()) {
        m_caret = TreeNodes::handleOf(node);
        refresh();
        ensureVisible(m_caret);
        tellCaret();
        return true;
    }
    if (key == VK_SPACE && isMultiple()) {
        return select(m_caret, Pick::Toggle, By::Keyboard);
    }
    QScrollBar* bar = key == VK_LEFT || key == VK_RIGHT ? m_area->horizontalScrollBar() : m_area->verticalScrollBar();
    const auto action = key == VK_UP || key == VK_LEFT      ? QScrollBar::SliderSingleStepSub
                        : key == VK_DOWN || key == VK_RIGHT ? QScrollBar::SliderSingleStepAdd
                        : key == VK_PRIOR                   ? QScrollBar::SliderPageStepSub
                        : key == VK_NEXT                    ? QScrollBar::SliderPageStepAdd
                        : key == VK_HOME                    ? QScrollBar::SliderToMinimum
                        : key == VK_END                     ? QScrollBar::SliderToMaximum
                                                            : QScrollBar::SliderNoAction;
    guarded([&] { bar->triggerAction(action); });
    return action != QScrollBar::SliderNoAction;
}

bool TreeWindow::key(int key) {
    m_editLater->stop();
    layOut();
    if (isDestroyed() || isKeyDown(VK_MENU)) {
        return false;
    }
    if (key == VK_RETURN) {
        tellMouse(NM_RETURN);
        return true;
    }
    if (key == VK_F2 && isEditable()) {
        editLabel(m_caret);
        return true;
    }
    if (isKeyDown(VK_CONTROL) && !isKeyDown(VK_SHIFT)) {
        return controlKey(key);
    }
    const auto target = targetOf(key);
    if (target) {
        m_typed.clear();
    }
    if (const TreeNode* node = target ? m_rows.at(*target) : nullptr) {
        select(TreeNodes::handleOf(node), pickFor(isKeyDown(VK_CONTROL), isKeyDown(VK_SHIFT)), By::Keyboard);
    }
    return target || openKey(key);
}

// --- letters ---

/// The next line from a place on, the search going on at the top, whose label begins with a text.
HTREEITEM TreeWindow::lineWith(const std::string& text, int first) {
    for (int step = 0; step < m_rows.size() && !isDestroyed(); ++step) {
        const HTREEITEM item = TreeNodes::handleOf(m_rows.at((first + step) % m_rows.size()));
        if (text::startsWithNoCase(textOf(item), text)) {
            return item;
        }
    }
    return nullptr;
}

void TreeWindow::search(const QString& letters) {
    const TreeNode* caret = m_nodes.find(m_caret);
    const int row = caret ? m_rows.rowOf(*caret) : -1;
    // One letter again and again goes on to the next item; others are to be matched by the same one first.
    const bool isOneLetter = letters.count(letters.front()) == letters.size();
    const HTREEITEM found =
        isOneLetter ? lineWith(fromQt(letters.left(1)), row + 1) : lineWith(fromQt(letters), std::max(row, 0));
    if (found && !isDestroyed()) {
        select(found, Pick::Only, By::Keyboard);
    }
}

bool TreeWindow::typed(char32_t character) {
    const bool goesOn = !m_typed.isEmpty() && !m_typedAt.hasExpired(QApplication::keyboardInputInterval());
    if (character < U' ' || character == U'\x7F' || isKeyDown(VK_CONTROL)) {
        return false;
    }
    if (!goesOn) {
        m_typed.clear();
        switch (character) {
        case U'*':
            openAll(m_caret);
            return true;
        case U'+':
        case U'-':
            expand(m_caret, character == U'+' ? TVE_EXPAND : TVE_COLLAPSE, By::Keyboard);
            return true;
        case U' ':
            return m_caret && select(m_caret, Pick::Only, By::Keyboard);
        default:
            break;
        }
    }
    m_typed += QString::fromUcs4(&character, 1);
    m_typedAt.start();
    search(m_typed);
    return true;
}

LRESULT TreeWindow::inputProc(UINT message, WPARAM wParam, LPARAM lParam) {
    if (message == WM_KEYDOWN) {
        NMTVKEYDOWN told{{}, static_cast<WORD>(wParam), 0};
        tell(told.hdr, TVN_KEYDOWN);
        if (isDestroyed() || key(static_cast<int>(wParam))) {
            return 0;
        }
    } else if (message == WM_CHAR && typed(static_cast<char32_t>(wParam))) {
        return 0;
    } else if (message == WM_RBUTTONUP && tellMouse(NM_RCLICK) != 0) {
        return 0;
    }
    return isDestroyed() ? 0 : Control::defaultProc(message, wParam, lParam);
}

} // namespace tvx::afx
