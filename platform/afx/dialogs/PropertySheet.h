#pragma once

/// @file
/// Property sheets: dialogs of several pages with a row of tabs, OK, Cancel, Apply and Help.

#include "platform/afx/dialogs/Dialog.h"

#include <vector>

class CPropertySheet;

// Flags of a page
#define PSP_USETITLE 0x00000008
#define PSP_HASHELP 0x00000020

// Flags of a sheet
#define PSH_NOAPPLYNOW 0x00000080
#define PSH_HASHELP 0x00000200

// What a sheet tells its pages by WM_NOTIFY, and what a page answers to PSN_APPLY. CPropertyPage makes calls of it.
#define PSN_SETACTIVE (static_cast<UINT>(-200))
#define PSN_KILLACTIVE (static_cast<UINT>(-201))
#define PSN_APPLY (static_cast<UINT>(-202))
#define PSN_RESET (static_cast<UINT>(-203))
#define PSN_HELP (static_cast<UINT>(-205))
#define PSN_QUERYCANCEL (static_cast<UINT>(-209))
#define PSNRET_NOERROR 0
#define PSNRET_INVALID 1
#define PSNRET_INVALID_NOCHANGEPAGE 2

// PressButton
#define PSBTN_OK 3
#define PSBTN_APPLYNOW 4
#define PSBTN_CANCEL 5
#define PSBTN_HELP 6

/// Sent by CPropertyPage::QuerySiblings, with two numbers of the host's; a page that answers other than 0 ends it.
#define PSM_QUERYSIBLINGS 0x046C

/// What a host may set of a page before its sheet is shown.
struct PROPSHEETPAGE {
    DWORD dwFlags = 0;         ///< PSP_...
    LPCSTR pszTitle = nullptr; ///< with PSP_USETITLE: what the tab says instead of the template's caption
};

/// What a host may set of a sheet before it is shown.
struct PROPSHEETHEADER {
    DWORD dwFlags = 0;           ///< PSH_...
    LPCSTR pszCaption = nullptr; ///< for reading: the caption given to the constructor or SetTitle
    UINT nStartPage = 0;         ///< the page that is shown first
    HWND hwndParent = nullptr;   ///< not used: the constructor names the window to stand over
};

/// A page of a property sheet, made of a template as any dialog is. The caption of the template, or the one given
/// here, is what the tab says; its styles do not matter.
///
/// @code
/// class CGridPage : public CPropertyPage {
/// public:
///     CGridPage() : CPropertyPage(IDD_GRID) {}
///     int m_width = 10;
///
/// protected:
///     void DoDataExchange(CDataExchange* dx) override {
///         CPropertyPage::DoDataExchange(dx);
///         DDX_Text(dx, IDC_WIDTH, m_width);
///         DDV_MinMaxInt(dx, m_width, 1, 100);
///     }
///     afx_msg void OnChangeWidth() { SetModified(); } // ON_EN_CHANGE
///     BOOL OnApply() override {
///         SetGrid(m_width); // taken from the control already
///         return CPropertyPage::OnApply();
///     }
/// };
/// @endcode
///
/// The object is the host's and lives longer than its sheet's window. Its own window is made when the page is first to
/// be seen, and ends with the sheet's.
class TVX_PLATFORM_API CPropertyPage : public CDialog {
    DECLARE_DYNAMIC(CPropertyPage)

public:
    /// @param captionId string of the tab's text; 0: the template's caption
    explicit CPropertyPage(LPCSTR templateName, UINT captionId = 0);
    explicit CPropertyPage(UINT templateId, UINT captionId = 0);

    /// Flags and title. PSP_HASHELP is set from the start where the application handles ID_HELP; while such a page is
    /// shown, the sheet's Help button can be pressed.
    PROPSHEETPAGE m_psp;

    /// Notes that something was changed here, or not any more. Apply can be pressed while any page is changed.
    void SetModified(BOOL changed = TRUE);
    /// Tells the user that Cancel cannot take back what was done: OK becomes Close, and Cancel cannot be pressed.
    void CancelToClose();
    /// Sends PSM_QUERYSIBLINGS to the pages whose windows stand, this one too, until one answers other than 0; answers
    /// that.
    LRESULT QuerySiblings(WPARAM wParam, LPARAM lParam);

    /// The page is about to be shown. The base version shows the members' values in the controls.
    /// @return FALSE to have the next page shown instead, in the direction in which the user goes
    virtual BOOL OnSetActive();
    /// The page is about to be left, by another page, OK or Apply. The base version takes the controls' values into the
    /// members.
    /// @return FALSE to stay: something has to be put right first
    virtual BOOL OnKillActive();
    /// OK or Apply, for each page whose window stands, in the order of the tabs. The base version calls OnOK.
    /// @return FALSE to keep the sheet open; pages behind this one are not asked then
    virtual BOOL OnApply();
    /// Cancel, for each page whose window stands. The base version calls OnCancel.
    virtual void OnReset();
    /// Cancel, first asked of the page that is shown. FALSE refuses it.
    virtual BOOL OnQueryCancel();
    /// Called by OnApply and OnReset; these do nothing.
    /// @{
    void OnOK() override;
    void OnCancel() override;
    /// @}

protected:
    BOOL OnNotify(WPARAM wParam, LPARAM lParam, LRESULT* result) override;
    std::optional<tvx::DialogTemplate> describe() const override;

private:
    friend class CPropertySheet;
    CPropertySheet* sheet() const;
    LRESULT answer(UINT code);

    CString m_caption;
    bool m_isFilled = false; ///< By OnInitDialog, just now.
    bool m_isModified = false;
};

/// A dialog of pages, one of which is seen at a time.
///
/// @code
/// CPropertySheet sheet(IDS_SETTINGS, this);
/// CGridPage grid;
/// CColorPage colors;
/// sheet.AddPage(&grid);
/// sheet.AddPage(&colors);
/// sheet.DoModal();
/// @endcode
///
/// It is as large as its largest page needs. Buttons are IDOK, IDCANCEL, ID_APPLY_NOW and IDHELP. Ctrl+Tab and
/// Ctrl+Page Down go to the next page, with Shift and by Ctrl+Page Up to the previous one; mnemonics in captions choose
/// a page. A modeless sheet has no buttons: closing it is Cancel.
class TVX_PLATFORM_API CPropertySheet : public CDialog {
    DECLARE_DYNAMIC(CPropertySheet)

public:
    /// @param caption   copied
    /// @param parent    the window to stand over; null for the application's main window
    /// @param firstPage the page that is shown first
    explicit CPropertySheet(LPCSTR caption, CWnd* parent = nullptr, UINT firstPage = 0);
    explicit CPropertySheet(UINT captionId, CWnd* parent = nullptr, UINT firstPage = 0);
    ~CPropertySheet() override;

    /// Flags, to be set before the sheet is shown: PSH_NOAPPLYNOW leaves out Apply; without PSH_HASHELP, which is set
    /// from the start where the application handles ID_HELP, there is no Help.
    PROPSHEETHEADER m_psh;

    /// Appends a page, which stays the caller's. Also while the sheet is open.
    void AddPage(CPropertyPage* page);
    /// Takes a page out. Its window ends; while it is the one shown, another takes its place.
    /// @{
    void RemovePage(CPropertyPage* page);
    void RemovePage(int index);
    /// @}
    int GetPageCount() const;
    /// Null for an index out of range.
    CPropertyPage* GetPage(int index) const;
    /// -1 for a page of another sheet.
    int GetPageIndex(const CPropertyPage* page) const;
    /// The page that is shown, or will be first.
    /// @{
    CPropertyPage* GetActivePage() const;
    int GetActiveIndex() const;
    /// @}
    /// Shows a page; before the sheet is open: chooses the first one. FALSE when there is no such page, or the one that
    /// is shown does not let go.
    /// @{
    BOOL SetActivePage(int index);
    BOOL SetActivePage(CPropertyPage* page);
    /// @}

    /// Changes the caption, now or for later.
    void SetTitle(LPCSTR text);
    /// Creates a modeless sheet and shows it.
    /// @param style -1: caption and system menu; with WS_CHILD a part of its parent
    BOOL Create(CWnd* parent = nullptr, DWORD style = static_cast<DWORD>(-1), DWORD exStyle = 0);
    int DoModal() override;
    /// Ends a modal sheet with a result; destroys a modeless one. No page is asked.
    void EndDialog(int result);
    /// Does what a button does (PSBTN_...). FALSE where it could not be pressed.
    BOOL PressButton(int button);

    BOOL PreTranslateMessage(MSG* message) override;

protected:
    /// Called when tabs, buttons and the first page stand.
    BOOL OnInitDialog() override;
    void OnOK() override;
    void OnCancel() override;
    std::optional<tvx::DialogTemplate> describe() const override;
    afx_msg void OnApplyNow();
    afx_msg void OnHelpButton();
    afx_msg void OnChooseTab(NMHDR* header, LRESULT* result);
    afx_msg void OnClose();
    afx_msg LRESULT OnCommandHelp(WPARAM wParam, LPARAM lParam);
    DECLARE_MESSAGE_MAP()

private:
    friend class CPropertyPage;
    bool make(CPropertyPage& page);
    LRESULT tell(CPropertyPage& page, UINT code);
    bool activate(int index);
    int firstWilling(int index, int step);
    void show(int index);
    bool applyAll();
    void noteModified();
    void layOut();
    void turnTo(int step);

    std::vector<CPropertyPage*> m_pages;
    int m_active = -1;
    CString m_caption;
    DWORD m_style = 0;
    DWORD m_exStyle = 0;
    bool m_modeless = false;
};
