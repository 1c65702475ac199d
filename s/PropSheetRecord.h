#pragma once

#include "platform/afx/controls/ScrollBar.h"
#include "s/PropSheet.h"
#include "s/PropTree.h"
#include "s/TitleStatic.h"

#include <map>

/// @file
/// What lies behind a property sheet. Not for hosts.

/// The place of the page, and how a page that is larger is scrolled in it: by moving its controls.
class PropPagePlace {
public:
    /// Whether pages scroll.
    bool scrolls = false;

    /// Forgets the pages' sizes and the bars: the windows are gone.
    void forget();
    /// Gives a page its place.
    /// @param frame   in the sheet's client area
    /// @param corner  where the page stands: at first the frame's corner
    void place(CDialog& sheet, CWnd& page, const CRect& frame, CPoint corner);
    /// Hides the bars: there is no page.
    void leave();
    /// Follows a code of a bar. False when it is another's bar.
    bool onScroll(int bar, UINT code, const CScrollBar* from);
    /// Scrolls by pixels, as far as the page reaches. False when it does not reach further.
    bool scrollBy(CSize distance);
    /// Follows the wheel. False when nothing scrolls.
    bool onWheel(int delta);
    /// Brings a control of the page into sight.
    void show(HWND control);

private:
    struct PageSize {
        CSize size;
        CPoint position; ///< how far it is scrolled
    };
    /// How much of a page is seen.
    CSize visible() const;
    PageSize& sizeOf(HWND page);
    bool scrollTo(CPoint position);
    void showBars(CWnd& sheet, const CRect& inside, const CRect& frame);

    std::map<HWND, PageSize> m_sizes;
    HWND m_page = nullptr; ///< not the object, which its item may delete
    CScrollBar m_horizontal;
    CScrollBar m_vertical;
    int m_line = 0;
};

/// The state of a sheet, and what it does with its page, its keys and its size.
struct Gui_PropSheet::Record {
    /// A sheet that was not opened yet, with everything off.
    Record(Gui_PropSheet* owner, const Port::StringBase<char>& title, bool multiple)
        : sheet(owner), windowTitle(title), multipleSelection(multiple) {}

    Gui_PropSheet* sheet;                         ///< whose record it is
    Gui_PropItem* currentItem = nullptr;          ///< whose page is shown; null before the first, and without a page
    HWND treeWindow = nullptr;                    ///< where SetFocusPrev leads; null while the dialog is closed
    HWND okWindow = nullptr;                      ///< where SetFocusNext leads
    Port::StringBase<char> windowTitle;           ///< the caption; empty for the template's
    Gui_TitleStatic titleBand;                    ///< the lines above the page
    PropTree tree;                                ///< the categories
    std::vector<Gui_PropItem*> items;             ///< all that were added, owned, in that order
    std::vector<Gui_PropItem*> initiallySelected; ///< those added with the select flag
    bool multipleSelection;                       ///< whether several nodes can be selected
    bool wantsToClose = false;                    ///< OK was pressed
    bool dontClose = false;                       ///< and a page does not want it

    // --- beside the plain sheet ---

    bool hasSearch = false;               ///< SetSearch
    bool guardsWheel = false;             ///< SetWheelGuard
    bool remembers = false;               ///< SetMemory
    CString section;                      ///< of the settings, for that
    CStatic searchLabel;                  ///< "Search"
    CEdit searchField;                    ///< what is looked for
    CButton defaultsButton;               ///< made when an item with a defaults function is shown first
    PropPagePlace place;                  ///< where the page stands
    std::vector<Gui_PropItem*> selection; ///< what the user has selected, also while the search hides it
    bool isLaidOut = false;               ///< controls stand as a size has put them, no longer as the template has them
    bool wasOpen = false;                 ///< not the first opening: page objects may be left without windows
    std::vector<std::unique_ptr<CWnd>> formerPages; ///< page objects that others have replaced

    /// What every button and key begins with.
    void clearFlags() {
        wantsToClose = dontClose = false;
    }

    // --- pages ---

    /// Windows of pages end with that of the sheet. In a sheet that is opened again a page whose window has gone is
    /// made anew; the object before it stays, as hosts may look into it, unless the item gave the same one a new
    /// window.
    void revivePages(Gui_PropItem* item);
    /// Shows the page for a selection.
    void switchTo(const std::vector<Gui_PropItem*>& chosen);
    /// Takes leave of the page that is shown: tells it, hides it, empties the band.
    void leaveCurrent();
    /// Tells the current page that it is active, and shows its lines.
    void refreshCurrent();
    /// Gives the current page its place and shows it.
    void showCurrent();
    /// Has the current page apply, and takes the mark of changes away unless it refuses.
    void apply();
    /// Asks whether changes may be lost, where hosts have them marked and there are any.
    bool mayDiscard();
    /// Shows the Defaults button, or hides it, as the current item needs it.
    void showDefaultsButton();

    // --- keys and wheel ---

    /// The rules for Tab at the edges of the page. False when the key is the dialog's.
    bool onTab();
    /// Keys of the search field, and Ctrl+F. False when the key is the dialog's.
    bool onSearchKey(UINT key);
    /// Selects the item found behind the one selected.
    void selectNextFound();
    /// Whether the wheel turns over a control of the page in which it could change a value unseen: one that does not
    /// have the keyboard and shows no more when it is scrolled.
    bool isGuarded(const MSG& message) const;
    /// Take the keyboard from the tree or from OK into the page, which may choose the control.
    /// @{
    void focusFirst();
    void focusLast();
    /// @}

    // --- opening, layout, memory ---

    /// What is selected when the dialog opens.
    std::vector<Gui_PropItem*> firstSelection() const;
    /// Makes room above the tree for the search field, where it is wanted.
    void addSearchField();
    /// A dialog whose pages scroll fits the screen, however large its fonts are.
    void fitScreen();
    /// Lays the controls out in a client area.
    void layOut(CSize client);
    /// Answers where the first of the buttons begins.
    int layOutButtons(CSize client, CSize gap, int height);
    /// Puts the Defaults button beside the others, or above them where it has no room there. Answers the height that
    /// this takes from the tree.
    int layOutDefaults(CSize client, int left);
    /// The client area in which all buttons stand beside each other, and tree and page still show something; 0 while
    /// there are no controls.
    CSize leastClient() const;
    /// The size of the Defaults button.
    CSize defaultsSize() const;
    /// Five dialog units in both directions.
    CSize margin() const;
    /// That of the first button there is.
    int buttonHeight() const;
    /// The place of a control in the sheet's client area.
    CRect rectOf(const CWnd& control) const;
    /// Gives the dialog the size that is remembered; keeps size and node.
    /// @{
    void restoreSize();
    void remember() const;
    /// @}
};
