#pragma once

#include "afxwin.h"
#include "s/PropItem.h"

#include <memory>
#include <vector>

class CPreferences;

/// A page of the preferences: a child dialog whose fields show the copy of the options that its sheet holds. What the
/// user changes marks the page's item; the fields are taken over when the page is left or applied.
///
/// In a sheet that is larger than the template, fields for text and what reaches the template's right edge grow with
/// it, buttons there move, and so does what stands below a field of several lines.
class CPreferencePage : public CDialog {
public:
    CPreferencePage(UINT templateId, CPreferences& sheet);
    BOOL Create(CWnd* parent);

    /// Shows what the sheet's options are now. A wrong field keeps what the user has typed, and the others with it.
    void Show();
    /// Takes the fields over. A wrong one is explained and gets the keyboard, and nothing of the page is taken.
    bool Take();
    /// The page is shown again for its wrong field.
    void ShowWrong();
    /// Nobody can come back to the wrong field: what was typed there is given up.
    void ForgetWrong();
    /// Puts the options of this page to what the application comes with, and shows them.
    void ShowDefaults();
    UINT GetTopic() const {
        return m_template;
    }

    void OnOK() override;
    void OnCancel() override;

protected:
    BOOL OnInitDialog() override;
    afx_msg void OnSize(UINT type, int cx, int cy);
    BOOL OnCommand(WPARAM wParam, LPARAM lParam) override;
    /// Puts the options of this page to what the application comes with.
    virtual void SetDefaults() {}
    /// Marks the page as changed.
    void SetChanged();
    CPreferences& GetPreferences() const {
        return m_sheet;
    }
    DECLARE_MESSAGE_MAP()

private:
    /// A control as the template has it, and what it does in a page that is larger.
    struct Place {
        HWND control = nullptr;
        CRect rect;
        bool grows = false;     ///< in width
        bool moves = false;     ///< with the right edge
        bool isTall = false;    ///< grows in height
        bool isBeneath = false; ///< moves with the lower edge
    };
    void FindPlaces();
    void LayOut(CSize more);

    std::vector<Place> m_places;
    CSize m_made;    ///< The size that the template has.
    int m_wrong = 0; ///< The field that was not taken.
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
