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
        HWND window = nullptr; ///< that had it; a new window has another
        CSize size;
        CPoint position; ///< how far it is scrolled
    };
    /// How much of a page is seen.
    CSize visible() const;
    PageSize& sizeOf(CWnd& page);
    bool scrollTo(CPoint position);
    void showBars(CWnd& sheet, const CRect& inside, const CRect& frame);

    std::map<const CWnd*, PageSize> m_sizes;
    CWnd* m_page = nullptr;
    CScrollBar m_horizontal;
    CScrollBar m_vertical;
    int m_line = 0;
};

struct Gui_PropSheet::Record {
    Record(Gui_PropSheet* owner, const Port::StringBase<char>& title, bool multiple)
        : sheet(owner), windowTitle(title), multipleSelection(multiple) {}

    Gui_PropSheet* sheet;
    Gui_PropItem* currentItem = nullptr;
    HWND treeWindow = nullptr;
    HWND okWindow = nullptr;
    Port::StringBase<char> windowTitle;
    Gui_TitleStatic titleBand;
    PropTree tree;
    std::vector<Gui_PropItem*> items;
    std::vector<Gui_PropItem*> initiallySelected;
    bool multipleSelection;
    bool wantsToClose = false;
    bool dontClose = false;

    // --- beside the plain sheet ---

    bool hasSearch = false;
    bool guardsWheel = false;
    bool remembers = false;
    CString section;
    CStatic searchLabel;
    CEdit searchField;
    CButton defaultsButton;
    PropPagePlace place;
    /// What the user has selected, also while the search hides it.
    std::vector<Gui_PropItem*> selection;
    /// Whether the controls stand as a size of the dialog has put them, no longer as the template has them.
    bool isLaidOut = false;
    /// Whether this is not the first opening: page objects may be left whose windows have gone.
    bool wasOpen = false;
    /// Page objects that others have replaced.
    std::vector<std::unique_ptr<CWnd>> formerPages;

    void clearFlags() {
        wantsToClose = dontClose = false;
    }

    // --- pages ---

    void revivePages(Gui_PropItem* item);
    void switchTo(const std::vector<Gui_PropItem*>& chosen);
    void leaveCurrent();
    void refreshCurrent();
    void showCurrent();
    void apply();
    bool mayDiscard();
    void showDefaultsButton();

    // --- keys and wheel ---

    bool onTab();
    bool onSearchKey(UINT key);
    bool isGuarded(const MSG& message) const;
    void focusFirst();
    void focusLast();

    // --- opening, layout, memory ---

    std::vector<Gui_PropItem*> firstSelection() const;
    void addSearchField();
    void fitScreen();
    void layOut(CSize client);
    int layOutButtons(CSize client, CSize gap, int height);
    int layOutDefaults(CSize client, int left);
    CSize leastClient() const;
    CSize defaultsSize() const;
    CSize margin() const;
    int buttonHeight() const;
    CRect rectOf(const CWnd& control) const;
    void restoreSize();
    void remember() const;
};
