#pragma once

/// @file
/// Tree controls.

#include "platform/afx/controls/detail/Control.h"
#include "platform/afx/controls/detail/TreeArea.h"

namespace tvx::afx {

/// The "SysTreeView32" class: a table of nodes (TreeNodes) that the toolkit's tree shows through a model of ours.
class TreeWindow : public Control, private TreeHost, private TreeEvents {
public:
    explicit TreeWindow(const CREATESTRUCT& cs);
    ~TreeWindow() override;
    LRESULT defaultProc(UINT message, WPARAM wParam, LPARAM lParam) override;
    QWidget* clientWidget() const override;
    QRect clientRect() const override;
    UINT dialogCode(const MSG* msg) const override;
    /// Trees ask nobody for their colours.
    UINT colorMessage() const override {
        return WM_NULL;
    }

protected:
    QWidget* makeWidget(QWidget* parent) override;
    void widgetMade() override;
    void styleChanged(DWORD oldStyle, DWORD oldExStyle) override;
    void focusMoved(bool got) override;

private:
    // TreeHost
    QString textOf(TreeNode& node) override;
    bool hasChildren(TreeNode& node) override;
    QIcon iconOf(const TreeNode& node) override;
    bool isEditable() const override;
    void labelEdited(HTREEITEM item, const QString& text) override;
    // TreeEvents
    bool maySelect(TreeNode& node) override;
    void selectionSettled(TreeCause cause) override;
    void toggle(TreeNode& node, bool expand) override;
    void startEditing(TreeNode& node) override;
    bool tellMouse(UINT code) override;
    void tellItems() override;

    // --- items ---
    TreeNodes& nodes() const;
    QModelIndex indexOf(TreeNode& node) const;
    HTREEITEM insertItem(const TVINSERTSTRUCT& what);
    void inserted(TreeNode& parent);
    bool deleteItem(HTREEITEM item);
    void deleteAll();
    void tellDeleted(TreeNode& node);
    bool readItem(TVITEM& item);
    bool writeItem(const TVITEM& item);
    void writeState(TreeNode& node, const TVITEM& item);
    UINT stateOf(TreeNode& node) const;
    HTREEITEM relative(HTREEITEM item, UINT relation);
    HTREEITEM visibleNeighbour(HTREEITEM item);
    HTREEITEM nextSelected(HTREEITEM item);
    const std::vector<HTREEITEM>& selectedItems();

    // --- selection, expansion, labels ---
    HTREEITEM caret() const;
    LRESULT selectItem(HTREEITEM item);
    LRESULT expandItem(HTREEITEM item, UINT how, bool byUser);
    bool tellExpansion(UINT code, TreeNode& node, bool expand);
    void setExpanded(TreeNode& node, bool expand);
    bool editLabel(HTREEITEM item);
    bool ensureVisible(HTREEITEM item);
    LRESULT itemRect(RECT* rect, bool labelOnly);
    LRESULT hitTest(TVHITTESTINFO& info);

    LRESULT tell(NMHDR& header, UINT code);
    NMTREEVIEW about(TreeNode* node) const;
    LRESULT itemProc(UINT message, WPARAM wParam, LPARAM lParam, bool& known);
    LRESULT viewProc(UINT message, WPARAM wParam, LPARAM lParam, bool& known);
    void applyStyle();
    void setImages(HIMAGELIST images);

    TreeArea* m_area = nullptr;
    TreeModel* m_model = nullptr; ///< The area's child.
    HIMAGELIST m_images = nullptr;
    DWORD m_treeStyle = 0; ///< TVS_EX_...
    HTREEITEM m_toldCaret = nullptr;
    bool m_selectionMoved = false;
    std::vector<HTREEITEM> m_selected; ///< in their order; empty when it is to be made anew
    std::size_t m_walked = 0;          ///< where nextSelected was last
    std::vector<HTREEITEM> m_untold;   ///< Parents of items that the view does not know yet; null: the root.
    HTREEITEM m_edited = nullptr;
    bool m_labelTaken = false;
};

} // namespace tvx::afx
