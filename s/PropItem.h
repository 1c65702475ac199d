#pragma once

#include "afxwin.h"
#include "platform/port/StringBase.h"
#include "s/Export.h"

#include <memory>

class Gui_PropSheet;

/// One node of the category tree of a property sheet, and the owner of the page that the sheet shows when the node is
/// selected. A host describes a page by a name, a function that makes its window when it is needed first, and a
/// function that is told what happens to it:
///
/// @code
/// CWnd* MakeGridPage(Gui_PropItem*, Gui_PropSheet* sheet) {
///     auto page = std::make_unique<CGridPage>(); // a CDialog whose template has WS_CHILD
///     return page->Create(IDD_GRID, sheet) ? page.release() : nullptr;
/// }
///
/// void OnGridPage(Gui_PropItem* item, CWnd* page, Gui_PropItem::Notification what) {
///     if (what == Gui_PropItem::NotifyApply && !static_cast<CGridPage*>(page)->Apply())
///         item->GetPropSheet()->DontClose(); // something has to be put right first
/// }
///
/// auto* grid = new Gui_PropItem("Grid", MakeGridPage, OnGridPage, Gui_PropItem::StateDefault);
/// grid->SetPageTitle("Grid");
/// grid->SetPageSubTitle("Lines that parts snap to");
/// sheet.AddItem(grid, drawing, false); // below "Drawing"; the sheet owns it from here on
/// @endcode
///
/// Items form a tree by their parent links. The library calls all operations through the table of virtual ones, so a
/// host may derive a class and override any of them: CreatePage in place of a function, GetPage to share one page among
/// several items.
///
/// No operation reports an error: without a notify-page function notifications are dropped, without a create-page
/// function, or when that answers null, the item has no page and the sheet shows the one of the nearest item above.
class GUI_API Gui_PropItem {
public:
    /// What happened to the page.
    enum Notification {
        NotifyActivate = 0,   ///< it becomes the page shown, or is shown again after its node was selected anew
        NotifyReactivate = 1, ///< it is shown and is to refresh itself: the labels of the tree were refreshed
        NotifyDeactivate = 2, ///< it is no longer the page shown, or is about to be activated again
        NotifyApply = 3,      ///< Apply or OK was pressed while it is shown: apply the changes now
        NotifyHelp = 4,       ///< Help or the help key was pressed while it is shown
        NotifyFocusFirst = 5, ///< give the keyboard to the first control: Tab was pressed in the tree
        NotifyFocusLast = 6   ///< give the keyboard to the last control: Shift+Tab was pressed on OK
    };
    /// How the node is shown when the sheet opens.
    enum InitialState {
        StateDefault = 0,  ///< as the tree has it
        StateExpanded = 1, ///< with its children seen
        StateCollapsed = 2 ///< with its children hidden
    };
    /// Makes the page, as a child window of the sheet, and hidden: the sheet places and shows it. The item deletes the
    /// object at its end. Null: there is no page now; the next need of one asks again.
    using CreatePageFunction = CWnd* (*)(Gui_PropItem*, Gui_PropSheet*);
    /// Is told what happened; the page is null when the item has none.
    using NotifyPageFunction = void (*)(Gui_PropItem*, CWnd*, Notification);
    /// Puts the values that an application begins with into the controls of a page. What they are worth is decided by
    /// Apply and OK, as after typing.
    using DefaultsFunction = void (*)(Gui_PropItem*, CWnd*);

    /// @param name       the node's label, copied
    /// @param createPage null: the item has no page of its own
    /// @param notifyPage null: nobody is told
    Gui_PropItem(const Port::StringBase<char>& name, CreatePageFunction createPage, NotifyPageFunction notifyPage,
                 InitialState state);
    /// Deletes the page.
    virtual ~Gui_PropItem();
    Gui_PropItem(const Gui_PropItem&) = delete;
    Gui_PropItem& operator=(const Gui_PropItem&) = delete;

    /// The node's label, and how it is shown first.
    /// @{
    virtual Port::StringBase<char> GetName() const;
    virtual InitialState GetInitialState() const;
    /// @}
    /// The item above this one, null for one at the top.
    virtual Gui_PropItem* GetParentItem() const;
    /// The sheet that the item was added to, null before that.
    virtual Gui_PropSheet* GetPropSheet() const;
    /// The two lines above the page, empty at first.
    /// @{
    virtual Port::StringBase<char> GetPageTitle();
    virtual Port::StringBase<char> GetPageSubTitle();
    /// @}
    /// The page, made by CreatePage when there is none yet; null when there is none to be had.
    virtual CWnd* GetPage();
    /// The page if it was made already, else null.
    virtual CWnd* GetCachedPage();

    /// The tree shows another name after Gui_PropSheet::RefreshItemTree.
    virtual void SetName(const Port::StringBase<char>& name);
    /// Counts until the sheet opens.
    virtual void SetInitialState(InitialState state);
    /// Null: at the top. The place in the tree is that of the moment when the sheet opens.
    virtual void SetParentItem(Gui_PropItem* parent);
    /// Gui_PropSheet::AddItem calls it.
    virtual void SetPropSheet(Gui_PropSheet* sheet);
    /// Other lines above the page show when it next becomes the one shown.
    /// @{
    virtual void SetPageTitle(const Port::StringBase<char>& title);
    virtual void SetPageSubTitle(const Port::StringBase<char>& subTitle);
    /// @}
    /// Another page, or none, which the item owns from now on. The one before is not deleted: it is the caller's.
    virtual void SetCachedPage(CWnd* page);
    /// Calls the create-page function with this item and its sheet; null without one. Nothing is kept: GetPage does
    /// that.
    virtual CWnd* CreatePage();

    /// Each makes the page if there is none, then tells the notify-page function.
    /// @{
    virtual void ActivatePage();
    virtual void ReactivatePage();
    virtual void DeactivatePage();
    virtual void ApplyPageChanges();
    virtual void ShowHelp();
    virtual void SetFocusFirst();
    virtual void SetFocusLast();
    /// @}

    /// The functions of the constructor, which can be replaced, by null, too.
    /// @{
    CreatePageFunction GetCreatePageFunction() const;
    NotifyPageFunction GetNotifyPageFunction() const;
    void SetCreatePageFunction(CreatePageFunction createPage);
    void SetNotifyPageFunction(NotifyPageFunction notifyPage);
    /// @}

    /// Words that users may look for and that stand neither in the name nor in the lines above the page, such as the
    /// labels of its controls: the sheet's search finds the item by them and makes no page for it. Copied; at first
    /// there are none.
    /// @{
    void SetKeywords(const Port::StringBase<char>& keywords);
    Port::StringBase<char> GetKeywords() const;
    /// @}
    /// While the page of an item with such a function is shown, the sheet has a Defaults button that calls it. Null,
    /// as at first: no button.
    /// @{
    void SetDefaultsFunction(DefaultsFunction defaults);
    DefaultsFunction GetDefaultsFunction() const;
    /// @}
    /// Whether the page holds changes that were not applied, for hosts whose sheet shows that
    /// (Gui_PropSheet::SetChangeMarks). The page sets it when the user changes something; the sheet takes it back after
    /// an apply notification in which nobody called DontClose, and when the user has agreed to discard the changes.
    /// @{
    void SetChanged(bool changed);
    bool IsChanged() const;
    /// @}

private:
    struct Record;

    void notify(Notification what);

    std::unique_ptr<Record> m_record;
};
