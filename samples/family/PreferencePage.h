#pragma once

#include "afxwin.h"
#include "s/PropItem.h"

#include <memory>

class CPreferences;

/// A page of the preferences: a child dialog whose fields show the copy of the options that its sheet holds. What the
/// user changes marks the page's item; the fields are taken over when the page is left or applied.
class CPreferencePage : public CDialog {
public:
    CPreferencePage(UINT templateId, CPreferences& sheet);
    BOOL Create(CWnd* parent);

    /// Shows what the sheet's options are now.
    void Show();
    /// Takes the fields over. A wrong one is explained and gets the keyboard, and nothing of the page is taken.
    bool Take();
    /// Puts the options of this page to what the application comes with, and shows them.
    void ShowDefaults();
    UINT GetTopic() const {
        return m_template;
    }

    void OnOK() override;
    void OnCancel() override;

protected:
    BOOL OnInitDialog() override;
    BOOL OnCommand(WPARAM wParam, LPARAM lParam) override;
    /// Puts the options of this page to what the application comes with.
    virtual void SetDefaults() {}
    /// Marks the page as changed.
    void SetChanged();
    CPreferences& GetPreferences() const {
        return m_sheet;
    }

private:
    UINT m_template;
    CPreferences& m_sheet;
    bool m_isFilling = false; ///< What happens to the fields is not the user's doing.
};

/// Makes a page of a class for an item: what Gui_PropItem calls when the page is first needed.
template <class Page, class Sheet>
CWnd* MakePage(Gui_PropItem*, Gui_PropSheet* sheet) {
    auto page = std::make_unique<Page>(static_cast<Sheet&>(*sheet));
    return page->Create(sheet) ? page.release() : nullptr;
}

/// What pages of this kind do when they are told of something.
void OnPreferencePage(Gui_PropItem* item, CWnd* page, Gui_PropItem::Notification what);
