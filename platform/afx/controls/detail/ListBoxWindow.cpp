#include "platform/afx/controls/detail/ListBoxWindow.h"

#include "platform/afx/controls/ListBox.h"
#include "platform/afx/controls/detail/AccessibleList.h"
#include "platform/afx/core/WindowCalls.h"
#include "platform/afx/core/detail/Dispatch.h"
#include "platform/afx/core/detail/Loop.h"
#include "platform/afx/gdi/detail/Fonts.h"
#include "platform/base/Text.h"

#include <QAbstractScrollArea>
#include <QAccessible>
#include <QCoreApplication>
#include <QKeyEvent>
#include <QMouseEvent>
#include <QPainter>
#include <QScrollBar>
#include <QStyle>
#include <QStyleOption>

namespace tvx::afx {

namespace {

/// Distance of a line's text from the left edge.
constexpr int textIndent = 3;

/// Between these overrides and the place of ours below stand frames of the toolkit, which cannot be unwound: what a
/// host's handler throws is stored.
class ListArea : public QAbstractScrollArea {
public:
    ListArea(QWidget* parent, ListBoxWindow& window) : QAbstractScrollArea(parent), m_window(window) {
        viewport()->setBackgroundRole(QPalette::Base);
        // The list paints every pixel itself; while it must not, what was painted before stays.
        viewport()->setAttribute(Qt::WA_OpaquePaintEvent);
    }

protected:
    void paintEvent(QPaintEvent* event) override {
        QPainter painter(viewport());
        storing([&] { m_window.paint(painter, event->rect()); });
    }
    void mousePressEvent(QMouseEvent* event) override {
        storing([&] { m_window.press(*event, false); });
    }
    void mouseDoubleClickEvent(QMouseEvent* event) override {
        storing([&] { m_window.press(*event, true); });
    }
    void mouseMoveEvent(QMouseEvent* event) override {
        storing([&] { m_window.drag(*event); });
    }
    void keyPressEvent(QKeyEvent* event) override {
        // A key whose handler failed is done with: the toolkit must not offer it to the parent as well.
        bool taken = true;
        storing([&] { taken = m_window.key(*event); });
        event->setAccepted(taken);
    }
    void resizeEvent(QResizeEvent* event) override {
        QAbstractScrollArea::resizeEvent(event);
        storing([this] { m_window.applyRange(); });
    }
    void focusInEvent(QFocusEvent* event) override {
        QAbstractScrollArea::focusInEvent(event);
        viewport()->update();
    }
    void focusOutEvent(QFocusEvent* event) override {
        QAbstractScrollArea::focusOutEvent(event);
        viewport()->update();
    }
    void scrollContentsBy(int, int) override {
        viewport()->update();
    }

private:
    ListBoxWindow& m_window;
};

/// The toolkit repaints a bar whose page it is told, changed or not.
void setPage(QScrollBar& bar, int page) {
    if (bar.pageStep() != page) {
        bar.setPageStep(page);
    }
}

std::unique_ptr<Window> makeListBox(const CREATESTRUCT& cs) {
    return std::make_unique<ListBoxWindow>(cs);
}

const WindowClassEntry listBoxEntry("ListBox", &makeListBox);

} // namespace

// --- making ---

ListBoxWindow::ListBoxWindow(const CREATESTRUCT& cs)
    : ListControl(cs, {ODT_LISTBOX, LBS_OWNERDRAWFIXED | LBS_OWNERDRAWVARIABLE, LBS_HASSTRINGS}) {}

QWidget* ListBoxWindow::makeWidget(QWidget* parent) {
    m_area = new ListArea(parent, *this);
    answerForLists();
    return m_area;
}

void ListBoxWindow::widgetMade() {
    applyBars();
    Control::widgetMade();
    // The height is rounded to whole lines only now that their height is known.
    setWindowRect(windowRect());
}

int ListBoxWindow::accessibleRole() const {
    return QAccessible::List;
}

QString ListBoxWindow::accessibleText(int index) const {
    const auto* list = dynamic_cast<const CListBox*>(object());
    return list           ? toQt(list->GetAccessibleText(index))
           : hasStrings() ? toQt(m_items.at(index).text.c_str())
                          : QString();
}

void ListBoxWindow::tellCaret() {
    if (m_area->hasFocus() && m_items.isValid(m_caret)) {
        QAccessibleEvent event(m_area, QAccessible::Focus);
        event.setChild(m_caret);
        QAccessible::updateAccessibility(&event);
    }
}

void ListBoxWindow::applyBars() {
    // With this style the bars stay when there is nothing to scroll, so that lines keep their width.
    const bool always = (style() & LBS_DISABLENOSCROLL) != 0;
    const auto policy = [&](DWORD bit) {
        return (style() & bit) == 0 ? Qt::ScrollBarAlwaysOff : always ? Qt::ScrollBarAlwaysOn : Qt::ScrollBarAsNeeded;
    };
    m_area->setVerticalScrollBarPolicy(policy(WS_VSCROLL));
    m_area->setHorizontalScrollBarPolicy(policy(WS_HSCROLL));
    m_area->setFrameStyle(hasBorder() ? QFrame::StyledPanel | QFrame::Sunken : QFrame::NoFrame);
}

void ListBoxWindow::styleChanged(DWORD oldStyle, DWORD oldExStyle) {
    Control::styleChanged(oldStyle, oldExStyle);
    guarded([this] { applyBars(); });
}

void ListBoxWindow::fontChanged() {
    Control::fontChanged();
    // The lines of an owner-drawn list are as high as the owner answered, whatever the font.
    if (!isOwnerDrawn()) {
        m_rowHeight = m_area->fontMetrics().height() + 2;
    }
    applyRange();
}

/// The parent says how high its lines are.
void ListBoxWindow::measure() {
    m_rowHeight = askHeight(m_area->fontMetrics().height() + 2);
    applyRange();
}

QWidget* ListBoxWindow::clientWidget() const {
    return widget() ? m_area->viewport() : nullptr;
}

QRect ListBoxWindow::clientRect() const {
    return widget() ? m_area->viewport()->rect() : QRect();
}

void ListBoxWindow::setWindowRect(const QRect& rect) {
    QRect whole = rect;
    // Lists show whole lines only, unless the style says that they need not.
    if ((style() & LBS_NOINTEGRALHEIGHT) == 0 && m_area) {
        const int frame = 2 * m_area->frameWidth();
        const int rows = (rect.height() - frame) / m_rowHeight;
        whole.setHeight(rows > 0 ? rows * m_rowHeight + frame : rect.height());
    }
    Window::setWindowRect(whole);
}

UINT ListBoxWindow::dialogCode(const MSG*) const {
    return DLGC_WANTARROWS | DLGC_WANTCHARS;
}

void ListBoxWindow::focusMoved(bool got) {
    if ((style() & LBS_NOTIFY) != 0) {
        notify(got ? LBN_SETFOCUS : LBN_KILLFOCUS);
    }
}

// --- rows and scrolling ---

void ListBoxWindow::applyRange() {
    m_rangeIsSmall = false;
    if (!widget()) {
        return;
    }
    guarded([this] {
        QScrollBar* vertical = m_area->verticalScrollBar();
        const int last = std::max(m_items.count() - visibleRows(), 0);
        // A bar that only grows or shrinks needs no new layout: lists are filled line by line.
        const QSignalBlocker quiet((vertical->maximum() > 0) == (last > 0) ? vertical : nullptr);
        setPage(*vertical, visibleRows());
        vertical->setRange(0, last);
        if (const int later = std::exchange(m_laterTop, -1); later >= 0) {
            vertical->setValue(later);
        }
        QScrollBar* horizontal = m_area->horizontalScrollBar();
        const int width = m_area->viewport()->width();
        setPage(*horizontal, width);
        horizontal->setSingleStep(10);
        horizontal->setRange(0, std::max(m_extent - width, 0));
    });
    showBars();
}

/// The toolkit shows and hides bars when the loop comes to it. Who scrolls to a line before that must not be told of
/// room that a bar takes.
void ListBoxWindow::showBars() {
    const auto isLate = [](const QScrollBar* bar, Qt::ScrollBarPolicy policy) {
        return policy == Qt::ScrollBarAsNeeded && bar->parentWidget()->isHidden() == (bar->maximum() > 0);
    };
    if (m_showsBars || (!isLate(m_area->horizontalScrollBar(), m_area->horizontalScrollBarPolicy()) &&
                        !isLate(m_area->verticalScrollBar(), m_area->verticalScrollBarPolicy()))) {
        return;
    }
    m_showsBars = true;
    QEvent request(QEvent::LayoutRequest);
    guarded([&] { QCoreApplication::sendEvent(m_area, &request); });
    m_showsBars = false;
}

/// Has all of it painted when the loop comes to it. Asked for again before that costs nothing.
void ListBoxWindow::refresh() {
    if (!m_frozen && !std::exchange(m_repaintDue, true)) {
        m_area->viewport()->update();
    }
}

void ListBoxWindow::setRedraw(bool redraw) {
    m_frozen = !redraw;
    refresh();
}

/// Adds a line to what the bar counts: later, and for all that come until then at once. At once when the bar comes up
/// with it, and takes its room.
void ListBoxWindow::lineAdded() {
    refresh();
    if (m_rangeIsSmall) {
        return;
    }
    const bool isShown = m_area->verticalScrollBar()->maximum() > 0;
    if (!isShown && m_items.count() > visibleRows()) {
        applyRange();
    } else if (isShown) {
        m_rangeIsSmall = true;
        // The widget lives a little longer than the list.
        const auto apply = [self = handle()] {
            if (auto* list = dynamic_cast<ListBoxWindow*>(from(self))) {
                storing([list] { list->applyRange(); });
            }
        };
        QMetaObject::invokeMethod(m_area, apply, Qt::QueuedConnection);
    }
}

void ListBoxWindow::contentChanged() {
    applyRange();
    refresh();
}

int ListBoxWindow::top() const {
    return m_laterTop >= 0 ? m_laterTop : m_area->verticalScrollBar()->value();
}

void ListBoxWindow::setTop(int index) {
    if (m_rangeIsSmall) {
        m_laterTop = std::clamp(index, 0, std::max(m_items.count() - visibleRows(), 0));
        refresh();
        return;
    }
    guarded([&] { m_area->verticalScrollBar()->setValue(index); });
}

int ListBoxWindow::visibleRows() const {
    return std::max(m_area->viewport()->height() / m_rowHeight, 1);
}

int ListBoxWindow::rowAt(int y) const {
    // A point above the area means the line before the first one seen, so that dragging there scrolls.
    const int row = top() + (y >= 0 ? y / m_rowHeight : -1);
    return std::clamp(row, -1, m_items.count() - 1);
}

int ListBoxWindow::rowUnder(QPoint point) const {
    const int row = point.y() >= 0 ? top() + point.y() / m_rowHeight : -1;
    return clientRect().contains(point) && m_items.isValid(row) ? row : -1;
}

QRect ListBoxWindow::rowRect(int index) const {
    const int scrolled = m_area->horizontalScrollBar()->value();
    const int width = std::max(m_extent, m_area->viewport()->width());
    return {-scrolled, (index - top()) * m_rowHeight, width, m_rowHeight};
}

void ListBoxWindow::showRow(int index) {
    if (index < top()) {
        setTop(index);
    } else if (index >= top() + visibleRows()) {
        setTop(index - visibleRows() + 1);
    }
}

// --- lines ---

LRESULT ListBoxWindow::add(LONG_PTR index, LPARAM text, bool sorted) {
    ListItems::Item item = newItem(text);
    if (index < -1 || index > m_items.count()) {
        return LB_ERR;
    }
    const int place = sorted ? m_items.insertSorted(std::move(item)) : m_items.insert(index, std::move(item));
    m_current += m_current >= place ? 1 : 0;
    m_caret += m_caret >= place ? 1 : 0;
    m_anchor += m_anchor >= place ? 1 : 0;
    lineAdded();
    return place;
}

LRESULT ListBoxWindow::removeRow(LONG_PTR index) {
    if (!m_items.isValid(index)) {
        return LB_ERR;
    }
    const int row = static_cast<int>(index);
    tellDeleted(row);
    m_items.remove(row);
    // The selection goes with its line, while the keyboard stays on the line that takes the place.
    m_current = m_current == row ? -1 : m_current > row ? m_current - 1 : m_current;
    m_caret = std::min(m_caret > row ? m_caret - 1 : m_caret, m_items.count() - 1);
    m_anchor = std::min(m_anchor > row ? m_anchor - 1 : m_anchor, m_items.count() - 1);
    contentChanged();
    return m_items.count();
}

void ListBoxWindow::reset() {
    tellAllDeleted();
    m_items.clear();
    m_current = m_caret = m_anchor = -1;
    contentChanged();
}

LRESULT ListBoxWindow::itemProc(UINT message, WPARAM wParam, LPARAM lParam, bool& known) {
    const auto row = static_cast<int>(wParam);
    switch (message) {
    case LB_ADDSTRING:
        return add(-1, lParam, (style() & LBS_SORT) != 0 && hasStrings());
    case LB_INSERTSTRING:
        return add(row, lParam, false);
    case LB_DELETESTRING:
        return removeRow(row);
    case LB_RESETCONTENT:
        reset();
        return 0;
    case LB_GETCOUNT:
        return m_items.count();
    case LB_GETTEXT:
        return copyText(wParam, lParam);
    case LB_GETTEXTLEN:
        return textLength(wParam);
    case LB_GETITEMDATA:
        return itemData(wParam);
    case LB_SETITEMDATA:
        return setItemData(wParam, lParam);
    case LB_FINDSTRING:
        return find(wParam, lParam, ListItems::Match::Prefix);
    case LB_FINDSTRINGEXACT:
        return find(wParam, lParam, ListItems::Match::Whole);
    case LB_SELECTSTRING: {
        const LRESULT found = find(wParam, lParam, ListItems::Match::Prefix);
        if (found >= 0) {
            setCurrent(found);
        }
        return found;
    }
    case LB_INITSTORAGE:
        m_items.reserve(wParam);
        return static_cast<LRESULT>(wParam);
    default:
        return selectionProc(message, wParam, lParam, known);
    }
}

// --- selection ---

LRESULT ListBoxWindow::setCurrent(LONG_PTR index) {
    if (isMultiple()) {
        return LB_ERR;
    }
    if (!m_items.isValid(index)) {
        m_current = -1;
        refresh();
        return LB_ERR; // for -1 as well, which takes the selection away
    }
    m_current = m_caret = m_anchor = static_cast<int>(index);
    showRow(m_current);
    refresh();
    tellCaret();
    return index;
}

void ListBoxWindow::selectRange(int first, int last, bool selected) {
    for (int row = std::max(std::min(first, last), 0); row <= std::max(first, last) && row < m_items.count(); ++row) {
        m_items.at(row).selected = selected;
    }
    refresh();
}

void ListBoxWindow::selectOnly(int first, int last) {
    selectRange(0, m_items.count() - 1, false);
    selectRange(first, last, true);
}

LRESULT ListBoxWindow::setSelected(bool selected, LONG_PTR index) {
    if (!isMultiple() || (index != -1 && !m_items.isValid(index))) {
        return LB_ERR;
    }
    if (index == -1) {
        selectRange(0, m_items.count() - 1, selected);
    } else {
        const int row = static_cast<int>(index);
        m_items.at(row).selected = selected;
        m_caret = row;
        m_anchor = selected ? row : m_anchor;
        refresh();
        tellCaret();
    }
    return LB_OKAY;
}

LRESULT ListBoxWindow::selectedItems(int capacity, int* indices) const {
    int stored = 0;
    for (int row = 0; row < m_items.count() && stored < capacity; ++row) {
        if (m_items.at(row).selected) {
            indices[stored++] = row;
        }
    }
    return stored;
}

LRESULT ListBoxWindow::selectionProc(UINT message, WPARAM wParam, LPARAM lParam, bool& known) {
    const auto row = static_cast<int>(wParam);
    switch (message) {
    case LB_SETCURSEL:
        return setCurrent(row);
    case LB_GETCURSEL:
        return isMultiple() ? m_caret : m_current;
    case LB_SETSEL:
        return setSelected(wParam != 0, static_cast<int>(lParam));
    case LB_GETSEL:
        if (!m_items.isValid(row)) {
            return LB_ERR;
        }
        return isSelected(row) ? TRUE : FALSE;
    case LB_GETSELCOUNT:
        return isMultiple() ? m_items.selectedCount() : LB_ERR;
    case LB_GETSELITEMS:
        return isMultiple() ? selectedItems(row, reinterpret_cast<int*>(lParam)) : LB_ERR;
    case LB_SELITEMRANGE:
        if (!isMultiple()) {
            return LB_ERR;
        }
        selectRange(LOWORD(lParam), HIWORD(lParam), wParam != 0);
        return LB_OKAY;
    case LB_SELITEMRANGEEX: {
        const auto last = static_cast<int>(lParam);
        if (!isMultiple()) {
            return LB_ERR;
        }
        // A first line behind the last one means: take these lines out.
        selectRange(row, last, row <= last);
        return LB_OKAY;
    }
    case LB_SETANCHORINDEX:
        m_anchor = row;
        return LB_OKAY;
    case LB_GETANCHORINDEX:
        return m_anchor;
    case LB_SETCARETINDEX:
        if (!m_items.isValid(row)) {
            return LB_ERR;
        }
        m_caret = row;
        showRow(row);
        refresh();
        tellCaret();
        return LB_OKAY;
    case LB_GETCARETINDEX:
        return m_caret;
    default:
        return layoutProc(message, wParam, lParam, known);
    }
}

LRESULT ListBoxWindow::layoutProc(UINT message, WPARAM wParam, LPARAM lParam, bool& known) {
    const auto row = static_cast<int>(wParam);
    switch (message) {
    case LB_GETTOPINDEX:
        return top();
    case LB_SETTOPINDEX:
        setTop(row);
        return LB_OKAY;
    case LB_GETITEMHEIGHT:
        return m_rowHeight;
    case LB_SETITEMHEIGHT:
        m_rowHeight = std::clamp(static_cast<int>(LOWORD(lParam)), 1, 1000);
        contentChanged();
        return LB_OKAY;
    case LB_GETITEMRECT:
        if (!m_items.isValid(row)) {
            return LB_ERR;
        }
        *reinterpret_cast<RECT*>(lParam) = fromQt(rowRect(row));
        return LB_OKAY;
    case LB_ITEMFROMPOINT: {
        const QPoint point(GET_X_LPARAM(lParam), GET_Y_LPARAM(lParam));
        return MAKELONG(std::max(rowAt(point.y()), 0), rowUnder(point) < 0 ? 1 : 0);
    }
    case LB_GETHORIZONTALEXTENT:
        return m_extent;
    case LB_SETHORIZONTALEXTENT:
        m_extent = row;
        applyRange();
        return 0;
    case LB_SETTABSTOPS: {
        const auto* stops = reinterpret_cast<const int*>(lParam);
        m_tabStops.clear();
        for (int i = 0; i < row; ++i) {
            m_tabStops.push_back(stops[i] * dialogBaseUnits(widget()->font()).width() / 4);
        }
        refresh();
        return TRUE;
    }
    default:
        known = false;
        return 0;
    }
}

LRESULT ListBoxWindow::defaultProc(UINT message, WPARAM wParam, LPARAM lParam) {
    if (message >= LB_ADDSTRING && message <= LB_ITEMFROMPOINT) {
        bool known = true;
        const LRESULT result = itemProc(message, wParam, lParam, known);
        return known ? result : LB_ERR;
    }
    if (message == WM_CREATE && isOwnerDrawn()) {
        measure(); // only now the control's own object can answer
        return 0;
    }
    if (message == WM_DESTROY) {
        // The owner frees its data while the control can still be asked about its lines.
        reset();
        return 0;
    }
    if (message == WM_SETREDRAW) {
        setRedraw(wParam != 0);
        return 0;
    }
    return Control::defaultProc(message, wParam, lParam);
}

// --- painting ---

void ListBoxWindow::paintText(QPainter& painter, const QRect& rect, const QString& text) const {
    if ((style() & LBS_USETABSTOPS) == 0 || !text.contains(QLatin1Char('\t'))) {
        painter.drawText(rect, Qt::AlignLeft | Qt::AlignVCenter | Qt::TextSingleLine, text);
        return;
    }
    // Tab stops stand where the list was told, then at the distance of 32 dialog units.
    const int distance =
        m_tabStops.size() == 1 ? m_tabStops.front() : std::max(32 * dialogBaseUnits(widget()->font()).width() / 4, 1);
    int x = 0;
    for (const QString& part : text.split(QLatin1Char('\t'))) {
        painter.drawText(rect.adjusted(x, 0, 0, 0), Qt::AlignLeft | Qt::AlignVCenter | Qt::TextSingleLine, part);
        x += painter.fontMetrics().horizontalAdvance(part) + 1;
        const auto stop = std::upper_bound(m_tabStops.begin(), m_tabStops.end(), x);
        x = m_tabStops.size() > 1 && stop != m_tabStops.end() ? *stop : (x / distance + 1) * distance;
    }
}

void ListBoxWindow::paintRow(QPainter& painter, int index) const {
    const QRect rect = rowRect(index);
    const auto& item = m_items.at(index);
    const bool selected = isSelected(index);
    const auto group = isEnabled() ? QPalette::Active : QPalette::Disabled;
    const QPalette& palette = m_area->viewport()->palette();
    if (selected) {
        painter.fillRect(rect, palette.brush(group, QPalette::Highlight));
    }
    painter.setPen(palette.color(group, selected ? QPalette::HighlightedText : QPalette::Text));
    paintText(painter, rect.adjusted(textIndent, 0, 0, 0), toQt(item.text.c_str()));
    if (index == m_caret && m_area->hasFocus()) {
        QStyleOptionFocusRect option;
        option.initFrom(m_area->viewport());
        option.rect = rect;
        option.backgroundColor = palette.color(selected ? QPalette::Highlight : QPalette::Base);
        m_area->style()->drawPrimitive(QStyle::PE_FrameFocusRect, &option, &painter, m_area);
    }
}

void ListBoxWindow::paintOwnerRows(QPainter& painter, int first, int last) {
    // The owner may end the list while it draws a line.
    const HWND self = handle();
    OwnerPainting drawing(*this, m_area->viewport()->size(), QPalette::Base);
    for (int row = first; row <= last && row < m_items.count() && from(self); ++row) {
        DRAWITEMSTRUCT item{};
        item.CtlType = ODT_LISTBOX;
        item.itemID = static_cast<UINT>(row);
        item.itemData = static_cast<ULONG_PTR>(m_items.at(row).data);
        item.rcItem = fromQt(rowRect(row));
        const bool selected = isSelected(row);
        item.itemState = (selected ? ODS_SELECTED : 0U) | (row == m_caret && m_area->hasFocus() ? ODS_FOCUS : 0U) |
                         (isEnabled() ? 0U : ODS_DISABLED);
        drawing.draw(item);
    }
    if (from(self)) {
        painter.drawImage(0, 0, drawing.image());
    }
}

void ListBoxWindow::paint(QPainter& painter, const QRect& exposed) {
    m_repaintDue = false;
    if (m_frozen) {
        return;
    }
    if (!isOwnerDrawn()) {
        painter.fillRect(exposed, m_area->viewport()->palette().brush(QPalette::Base));
    }
    const int first = std::max(top() + exposed.top() / m_rowHeight, 0);
    const int last = std::min(top() + exposed.bottom() / m_rowHeight, m_items.count() - 1);
    if (isOwnerDrawn()) {
        paintOwnerRows(painter, first, last);
        return;
    }
    for (int row = first; row <= last; ++row) {
        paintRow(painter, row);
    }
}

} // namespace tvx::afx
