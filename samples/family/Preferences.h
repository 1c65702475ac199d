#pragma once

#include "FamilyOptions.h"
#include "PreferencePage.h"
#include "s/BrowserPreference.h"
#include "s/PropSheet.h"

/// The preferences of an application of the family: a sheet with the pages that all of them have. An application adds
/// its own.
///
/// The sheet holds a copy of the options, which the pages show and change. OK and Apply store all of it and put it in
/// force; Cancel forgets it.
class CPreferences : public Gui_PropSheet {
public:
    explicit CPreferences(CWnd* parent);
    ~CPreferences() override;

    FamilyOptions& GetFamilyOptions() {
        return m_family;
    }
    /// Stores the options of all pages and puts them in force.
    void Store();
    /// Marks the item of a page.
    void SetPageChanged(const CPreferencePage& page);
    /// Selects an item again, whose page is being left with a wrong field.
    void ComeBack(Gui_PropItem& item);
    /// Gives the keyboard to the first or the last control of a page.
    void FocusPage(CWnd& page, bool last);

    /// Lets the user change the keys of commands.
    virtual void EditKeys() = 0;
    /// How many keys of commands the user has given or taken away.
    virtual int CountOwnKeys() const = 0;
    /// Makes the keys of commands those that the application comes with.
    virtual void ResetKeys() = 0;

protected:
    /// Adds a page below another one, or at the top.
    /// @param texts a string with the name, the subtitle and words to find the page by, one line each
    Gui_PropItem* AddPage(UINT texts, CWnd* (*make)(Gui_PropItem*, Gui_PropSheet*), Gui_PropItem* parent,
                          bool hasDefaults);
    /// Adds the pages that all applications have.
    void AddFamilyPages();
    BOOL OnInitDialog() override;
    void OnCancel() override;
    afx_msg LRESULT OnComeBack(WPARAM wParam, LPARAM lParam);
    DECLARE_MESSAGE_MAP()
    /// Stores what is the application's own, and puts it in force.
    virtual void StoreOwn() = 0;

private:
    void WidenTree();
    void MakeRoom();
    /// Marks the browser's page, which knows nothing of marks, when its field shows another program than holds.
    void MarkBrowser();

    FamilyOptions m_family;
    FamilyOptions m_familyBefore;       ///< as it was when it was read or stored
    std::vector<Gui_PropItem*> m_pages; ///< The base class owns them.
    /// Its page is shown in this sheet.
    Gui_BrowserPreference m_browser;
    Gui_PropItem* m_browserItem = nullptr;
    friend CWnd* MakeBrowserPage(Gui_PropItem* item, Gui_PropSheet* sheet);
    friend void OnTabPage(Gui_PropItem* item, CWnd* page, Gui_PropItem::Notification what);
};
