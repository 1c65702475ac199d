#pragma once

/// @file
/// Tree controls.

#include "platform/afx/controls/detail/Control.h"
#include "platform/afx/controls/detail/TreeRows.h"

#include <QElapsedTimer>

#include <optional>

class QAbstractScrollArea;
class QMouseEvent;
class QTimer;

namespace tvx::afx {

/// What of an item is seen.
struct TreeLook {
    HTREEITEM item = nullptr;
    QString text;
    int image = 0;
    bool hasButton = false;
};

/// The "SysTreeView32" class: a table of nodes in lines of one height. Painting looks at the lines that are seen; the
/// others cost nothing but their place in a list.
///
/// Whatever the parent is told of or asked for, it may remove items and end the window meanwhile. So what lies across
/// such a call is a handle, never a node, and nothing of the toolkit's is half done then: the lines to be painted are
/// asked for before the first of them is.
class TVX_PLATFORM_API TreeWindow : public Control {
public:
    explicit TreeWindow(const CREATESTRUCT& cs);
    LRESULT defaultProc(UINT message, WPARAM wParam, LPARAM lParam) override;
    QWidget* clientWidget() const override;
    QRect clientRect() const override;
    int accessibleRole() const override;
    UINT dialogCode(const MSG* msg) const override;
    UINT colorMessage() const override {
        return WM_CTLCOLOREDIT;
    }

    // --- what assistive tools ask for ---
    bool isMultiple() const {
        return (m_treeStyle & TVS_EX_MULTISELECT) != 0;
    }
    const TreeRows& rows() const {
        return m_rows;
    }
    const TreeNode* nodeOf(HTREEITEM item) const {
        return m_nodes.find(item);
    }
    HTREEITEM caret() const {
        return m_caret;
    }
    /// The line of an item and the part of it that is filled when it is selected, in client coordinates. Empty for an
    /// item that is in no line.
    QRect rowRect(const TreeNode& node) const;
    /// The item in the line at a height, null for none.
    HTREEITEM itemAt(int y) const;
    /// Picture, label and button, asked of the parent where they are to be.
    TreeLook lookOf(HTREEITEM item);
    /// Selects an item, or opens or closes it, as the user does.
    /// @{
    void choose(HTREEITEM item);
    void toggle(HTREEITEM item);
    /// @}

    // --- what the widget hands on ---
    void paint(QPainter& painter, const QRect& exposed);
    void press(const QMouseEvent& event);
    void release(const QMouseEvent& event);
    void pressTwice(const QMouseEvent& event);
    /// The keyboard has come. @param byMouse with a press that is still to be handed on
    void focusCame(bool byMouse) {
        m_isNewToKeyboard = byMouse;
    }
    void scrolled();
    void resized();
    /// The whole label of the item at a point that shows only a part of it; empty otherwise.
    QString tipAt(QPoint point);
    /// Ends the change of a label. False when none is changed. @param cancel gives the new text up
    bool endEdit(bool cancel);

protected:
    QWidget* makeWidget(QWidget* parent) override;
    void widgetMade() override;
    void fontChanged() override;
    void styleChanged(DWORD oldStyle, DWORD oldExStyle) override;
    void focusMoved(bool got) override;
    void applyColors(QPalette& palette, const QColor& text, const QColor& background) const override;

private:
    /// Who does something: the parent is told of it.
    enum class By { Program, Mouse, Keyboard };
    /// What becomes of the other selected items.
    enum class Pick { Only, Toggle, Range, AddRange, All };
    struct Hit {
        HTREEITEM item = nullptr;
        UINT part = TVHT_NOWHERE;
    };

    // --- notifications; the window may have ended and items gone when they return ---
    LRESULT tell(NMHDR& header, UINT code);
    LRESULT tellMouse(UINT code);
    LRESULT tellItem(UINT code, UINT action, HTREEITEM before, HTREEITEM now);
    TVITEM about(HTREEITEM item) const;
    void ask(HTREEITEM item, UINT mask, TreeLook& look);
    bool hasChildren(HTREEITEM item);
    std::string textOf(HTREEITEM item);

    // --- items ---
    /// Sets what a message brings, but for the states.
    static void setContent(TreeNode& node, const TVITEM& item);
    HTREEITEM insertItem(const TVINSERTSTRUCT& what);
    bool removeItem(HTREEITEM item);
    void removeAll();
    void removeBelow(HTREEITEM item);
    void removeTold(TreeNode& node);
    bool readItem(TVITEM& item);
    bool writeItem(const TVITEM& item);
    void writeState(TreeNode& node, UINT state, UINT mask);
    UINT stateOf(const TreeNode& node) const;
    HTREEITEM relative(HTREEITEM item, UINT relation);
    HTREEITEM sibling(HTREEITEM item, int step) const;
    HTREEITEM nextSelected(HTREEITEM item);
    bool sort(HTREEITEM item);
    bool sortBy(const TVSORTCB& how);
    bool putInOrder(HTREEITEM item, const std::vector<HTREEITEM>& order);
    TreeNode* parentOf(HTREEITEM item);

    // --- selection and expansion ---
    bool select(HTREEITEM item, Pick pick, By by);
    void pick(TreeNode* node, Pick pick);
    DWORD setTreeStyle(DWORD mask, DWORD style);
    bool isOnlySelected(HTREEITEM item) const;
    void show(HTREEITEM item, By by);
    bool deselectBelow(TreeNode& node);
    bool expand(HTREEITEM item, UINT how, By by);
    bool open(HTREEITEM item, By by);
    bool close(HTREEITEM item, By by, bool forget);
    bool openAround(HTREEITEM item);
    bool ensureVisible(HTREEITEM item);
    void openAll(HTREEITEM item);

    // --- lines and places ---
    void contentChanged();
    void refresh();
    void layOut();
    void applyRange();
    void measure();
    void showBars();
    void keepTop();
    int rowOfTop(int before) const;
    int top() const;
    void setTop(int row);
    int pageRows() const;
    int visibleRows() const;
    int left(const TreeNode& node) const;
    int imageWidth() const;
    int margin() const;
    int indent() const;
    int depthOf(const TreeNode& node) const;
    QRect labelRect(const TreeNode& node, const QString& text) const;
    QRect buttonRect(const TreeNode& node) const;
    bool hasRootColumn() const;
    void showRow(int row);
    void showSideways(HTREEITEM item);
    Hit hit(QPoint point);
    LRESULT itemRect(RECT* rect, bool textOnly);
    LRESULT hitTest(TVHITTESTINFO& info);
    void applyBars();
    void setRedraw(bool redraw);
    HIMAGELIST setImages(HIMAGELIST images);
    bool showFirst(HTREEITEM item);

    // --- painting ---
    void paintRow(QPainter& painter, const TreeNode& node, const TreeLook& look) const;
    void paintBranches(QPainter& painter, const TreeNode& node, bool hasButton) const;
    bool showsSelection() const;

    // --- what the user does ---
    LRESULT inputProc(UINT message, WPARAM wParam, LPARAM lParam);
    bool key(int key);
    bool controlKey(int key);
    bool openKey(int key);
    std::optional<int> targetOf(int key) const;
    bool typed(char32_t character);
    void search(const QString& letters);
    HTREEITEM lineWith(const std::string& text, int first);
    Pick pickFor(bool control, bool shift) const;
    void tellCaret();
    void tellOpened(HTREEITEM item, bool opened);

    // --- labels ---
    bool isEditable() const;
    HWND editLabel(HTREEITEM item);
    HWND makeField(const std::string& text);
    void dropField();
    void placeField();

    LRESULT itemProc(UINT message, WPARAM wParam, LPARAM lParam, bool& known);
    LRESULT viewProc(UINT message, WPARAM wParam, LPARAM lParam, bool& known);

    QAbstractScrollArea* m_area = nullptr;
    QTimer* m_editLater = nullptr; ///< The area's: runs from a click on the caret item's label.
    TreeNodes m_nodes;
    TreeRows m_rows{m_nodes};
    HTREEITEM m_caret = nullptr;
    HTREEITEM m_anchor = nullptr; ///< Where a range of selected items begins.
    HTREEITEM m_top = nullptr;    ///< The item in the first line, when lines were counted last.
    HIMAGELIST m_images = nullptr;
    DWORD m_treeStyle = 0; ///< TVS_EX_...
    int m_rowHeight = 15;
    int m_extent = 0;               ///< The widest line seen, in pixels.
    bool m_frozen = false;          ///< Nothing is painted until the program says so.
    bool m_repaintDue = false;      ///< The toolkit has been told that all must be painted.
    bool m_layoutDue = false;       ///< The bars do not know of all lines.
    bool m_showsBars = false;       ///< The toolkit is at it.
    bool m_mayEdit = false;         ///< The press hit what was selected before.
    bool m_isNewToKeyboard = false; ///< The keyboard came with the press.
    HWND m_field = nullptr;         ///< Where a label is changed,
    HTREEITEM m_edited = nullptr;   ///< and that of which item.
    QString m_typed;                ///< The letters of a search,
    QElapsedTimer m_typedAt;        ///< and when the last one came.
};

} // namespace tvx::afx
