#pragma once

#include "afxwin.h"
#include "platform/port/StringBase.h"
#include "s/Export.h"
#include "s/PropItem.h"

#include <memory>
#include <vector>

/// A dialog of settings: a tree of categories at the left, a title band above the page of the selected one at the
/// right, and OK, Cancel, Apply and Help. The user can size it.
///
/// A host builds a tree of items (Gui_PropItem), adds them and runs the dialog:
///
/// @code
/// Gui_PropSheet sheet("Preferences", this, false);
/// auto* drawing = new Gui_PropItem("Drawing", MakeDrawingPage, OnDrawingPage, Gui_PropItem::StateExpanded);
/// sheet.AddItem(drawing, false);
/// sheet.AddItem(new Gui_PropItem("Grid", MakeGridPage, OnGridPage, Gui_PropItem::StateDefault), drawing, true);
/// sheet.SetSearch(true);               // each beside the plain sheet, off unless asked for
/// sheet.SetPageScrolling(true);
/// sheet.SetMemory("Preferences");
/// sheet.DoModal();
/// @endcode
///
/// Pages are made when their nodes are first selected, and one is shown at a time. The item of the page that is shown,
/// the current item, is told of everything (Gui_PropItem::Notification); the sheet never looks inside a page. On a
/// change from one item to another the first is deactivated, its page hidden, the second activated, its page shown.
/// Apply, OK and Help reach the current item only: what a page that was left had to say was asked for when it was
/// deactivated. Cancel tells nobody.
///
/// An item without a page shows the page of the nearest item above that has one.
///
/// Items are added before the dialog is opened; the tree is built then. Page windows close with the dialog; items and
/// page objects live until the sheet is destroyed, so that a host can read them after DoModal. When the dialog is
/// opened again, a page that is needed is made anew by its item, and the object before it is kept with the others.
///
/// Tab goes from the tree into the page, through its controls and on to OK, Shift+Tab back. A page may choose its first
/// and last control (NotifyFocusFirst, NotifyFocusLast); what it leaves undone the sheet does. Pages that treat Tab in
/// a way of their own call SetFocusPrev and SetFocusNext at their ends. docs/property-sheets.md tells more.
class GUI_API Gui_PropSheet : public CDialog {
    DECLARE_DYNAMIC(Gui_PropSheet)

public:
    /// @param title            the caption, copied; empty for "Properties"
    /// @param parent           the window to stand over; null for the application's main window
    /// @param multipleSelection whether several nodes can be selected. The first one counts for the page
    Gui_PropSheet(const Port::StringBase<char>& title, CWnd* parent, bool multipleSelection);
    /// Deletes the items and with them their pages.
    ~Gui_PropSheet() override;

    /// The title of the constructor or of SetWindowTitle.
    virtual Port::StringBase<char> GetWindowTitle() const;
    /// The page of the current item; null without one.
    virtual CWnd* GetCurrentPage();
    /// The added items below one, in the order added; null for those at the top.
    virtual std::vector<Gui_PropItem*> GetChildItems(const Gui_PropItem* parent) const;
    /// The items of the selected nodes, from the top of the tree. Empty before the dialog is opened.
    virtual std::vector<Gui_PropItem*> GetSelectedItems() const;
    /// The item whose page is shown for a selection: the first of `items`, or the nearest one above it that has a page.
    /// May make pages on the way. Null when there is none.
    virtual Gui_PropItem* GetPageItem(const std::vector<Gui_PropItem*>& items);
    /// An open dialog gets the caption at once, an empty one too.
    virtual void SetWindowTitle(const Port::StringBase<char>& title);
    /// For pages: moves the keyboard to the tree, which stands before the page.
    virtual void SetFocusPrev();
    /// For pages: moves the keyboard to OK, which stands behind the page.
    virtual void SetFocusNext();
    /// Adds an item, which the sheet deletes.
    /// @param parent the item above it, which should be added, too: one that is not gets a node all the same, but
    ///     stays the caller's. Null: at the top
    /// @param select whether the node is selected when the dialog opens. Of several the first one is, or all with
    ///     multiple selection; the first node of the tree when there is none
    virtual void AddItem(Gui_PropItem* item, Gui_PropItem* parent, bool select);
    /// The same without a change of the parent link.
    virtual void AddItem(Gui_PropItem* item, bool select);
    /// Cancel reads "Close" from now on, for pages whose changes cannot be taken back. It still cancels. Nothing
    /// happens before the dialog is open.
    virtual void ChangeCancelToClose();
    /// For pages, in their apply notification: whether OK was pressed, not Apply.
    virtual bool WantsToClose() const;
    /// For pages, in their apply notification: keeps the dialog open after OK.
    virtual void DontClose();
    /// Shows the items' names anew in the tree, then, with `reactivate`, has the current page refresh itself.
    virtual void RefreshItemTree(bool reactivate);

    /// What a sheet has beside that, each off unless it is asked for before the dialog is opened.
    /// @{

    /// A field above the tree that finds items by words of their names, titles and keywords (Gui_PropItem::SetKeywords)
    /// and makes no page. The tree shows what was found and the items above and below it. The page that is shown stays
    /// until the user selects another node; Enter selects the next item found, Esc empties the field, and the tree is
    /// as it was. Ctrl+F leads to the field.
    void SetSearch(bool search);
    /// Items that hold changes (Gui_PropItem::SetChanged) are marked in the tree, and Cancel asks once before it
    /// discards them.
    void SetChangeMarks(bool marks);
    /// Remembers the node that is selected and the size of the dialog from one opening to the next in a section of the
    /// application's settings (entries "PropertyNode" and "PropertySize"). Items that were added with the select flag
    /// go before the node. A node is known by its names; a size counts for the font that it was made with.
    /// @param section null: nothing is remembered
    void SetMemory(const char* section);
    /// A page that was made larger than its place gets scroll bars, which move its controls, and the control with the
    /// keyboard is scrolled into sight. A dialog that is larger than the screen opens as large as that.
    void SetPageScrolling(bool scrolling);
    /// The wheel changes no value in a control that does not have the keyboard: it scrolls the page, if that scrolls.
    /// Lists, trees and fields scroll all the same. Combo boxes need no guard: they never change unseen.
    void SetWheelGuard(bool guard);
    /// White on the title band has a contrast of at least 4.5 to 1, in light palettes, too (Gui_TitleStatic).
    void SetReadableBand(bool readable);
    /// @}

    BOOL PreTranslateMessage(MSG* message) override;

protected:
    BOOL OnInitDialog() override;
    void OnOK() override;
    void OnCancel() override;
    afx_msg void OnApply();
    afx_msg void OnHelp();
    afx_msg LRESULT OnCommandHelp(WPARAM wParam, LPARAM lParam);
    afx_msg BOOL OnHelpInfo(HELPINFO* info);
    afx_msg void OnSize(UINT type, int cx, int cy);
    afx_msg void OnSelchangedTree(NMHDR* header, LRESULT* result);
    afx_msg void OnGetMinMaxInfo(MINMAXINFO* info);
    afx_msg void OnDestroy();
    afx_msg void OnDefaults();
    afx_msg void OnChangeSearch();
    afx_msg void OnVScroll(UINT code, UINT position, CScrollBar* bar);
    afx_msg void OnHScroll(UINT code, UINT position, CScrollBar* bar);
    afx_msg BOOL OnMouseWheel(UINT flags, short delta, CPoint point);
    DECLARE_MESSAGE_MAP()

private:
    friend class Gui_PropItem;
    struct Record;

    void itemChanged(Gui_PropItem* item);

    std::unique_ptr<Record> m_record;
};
