#pragma once

/// @file
/// List boxes.

#include "platform/afx/controls/detail/ListControl.h"

#include <optional>

class QAbstractScrollArea;
class QKeyEvent;
class QMouseEvent;

namespace tvx::afx {

/// The "ListBox" class: lines of one height over a flat table, so that filling costs no measuring and painting only
/// looks at what is seen. Several columns (LBS_MULTICOLUMN) and lines of different heights are not offered: such lists
/// show one column, and the height asked for line 0.
class TVX_PLATFORM_API ListBoxWindow : public ListControl {
public:
    explicit ListBoxWindow(const CREATESTRUCT& cs);
    LRESULT defaultProc(UINT message, WPARAM wParam, LPARAM lParam) override;
    QWidget* clientWidget() const override;
    QRect clientRect() const override;
    void setWindowRect(const QRect& rect) override;
    int accessibleRole() const override;
    UINT dialogCode(const MSG* msg) const override;
    UINT colorMessage() const override {
        return WM_CTLCOLORLISTBOX;
    }

    // --- what assistive tools ask for ---
    bool isMultiple() const {
        return (style() & (LBS_MULTIPLESEL | LBS_EXTENDEDSEL)) != 0;
    }
    /// @param index of an existing line, here and below
    bool isSelected(int index) const {
        return isMultiple() ? m_items.at(index).selected : m_current == index;
    }
    /// What the host's object says of a line, else the line's own text.
    QString accessibleText(int index) const;
    /// The line with the keyboard, -1 for none.
    int caret() const {
        return m_caret;
    }
    /// The line of a place of the client area; -1 when none is there.
    int rowUnder(QPoint point) const;
    QRect rowRect(int index) const;
    /// Selects a line as the user does.
    void choose(int index) {
        moveCaret(index, false, false);
    }

    // --- what the widget hands on ---
    void paint(QPainter& painter, const QRect& exposed);
    void press(const QMouseEvent& event, bool twice);
    void drag(const QMouseEvent& event);
    bool key(const QKeyEvent& event);
    void applyRange();

protected:
    QWidget* makeWidget(QWidget* parent) override;
    void widgetMade() override;
    void fontChanged() override;
    void styleChanged(DWORD oldStyle, DWORD oldExStyle) override;
    void focusMoved(bool got) override;

private:
    bool isExtended() const {
        return (style() & LBS_EXTENDEDSEL) != 0;
    }
    void applyBars();
    void measure();
    void showBars();
    void lineAdded();
    void setRedraw(bool redraw);
    void contentChanged();
    void refresh();
    int top() const;
    void setTop(int index);
    int visibleRows() const;
    int rowAt(int y) const;
    void showRow(int index);
    LRESULT add(LONG_PTR index, LPARAM text, bool sorted);
    LRESULT removeRow(LONG_PTR index);
    void reset();
    LRESULT setCurrent(LONG_PTR index);
    LRESULT setSelected(bool selected, LONG_PTR index);
    void selectRange(int first, int last, bool selected);
    void selectOnly(int first, int last);
    LRESULT selectedItems(int capacity, int* indices) const;
    void moveCaret(int index, bool extend, bool toggle);
    void tellSelection();
    void tellCaret();
    void pressForMenu(QPoint at);
    void selectAll();
    bool scrollSideways(int key);
    std::optional<int> targetOf(int key) const;
    bool search(const QString& text);
    void paintRow(QPainter& painter, int index) const;
    void paintText(QPainter& painter, const QRect& rect, const QString& text) const;
    void paintOwnerRows(QPainter& painter, int first, int last);
    LRESULT itemProc(UINT message, WPARAM wParam, LPARAM lParam, bool& known);
    LRESULT selectionProc(UINT message, WPARAM wParam, LPARAM lParam, bool& known);
    LRESULT layoutProc(UINT message, WPARAM wParam, LPARAM lParam, bool& known);

    QAbstractScrollArea* m_area = nullptr;
    bool m_frozen = false;       ///< Nothing is painted until the program says so.
    bool m_repaintDue = false;   ///< The toolkit has been told that all must be painted.
    bool m_rangeIsSmall = false; ///< The bar does not count the last lines yet.
    bool m_showsBars = false;    ///< The toolkit is at it.
    int m_laterTop = -1;         ///< What is to be the first line once it does; -1 for the one that is.
    int m_current = -1;          ///< the selected line of a single selection
    int m_caret = -1;
    int m_anchor = -1;
    int m_rowHeight = 15;
    int m_extent = 0;
    std::vector<int> m_tabStops; ///< pixels
};

} // namespace tvx::afx
