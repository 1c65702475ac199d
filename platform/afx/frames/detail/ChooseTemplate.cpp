#include "platform/afx/frames/detail/ChooseTemplate.h"

#include "platform/afx/controls/ListBox.h"
#include "platform/afx/dialogs/Dialog.h"
#include "platform/win/FrameworkIds.h"

namespace tvx::afx {

namespace {

/// The names in a list; a double click chooses too.
class NameDialog : public CDialog {
public:
    explicit NameDialog(const std::vector<CString>& names) : CDialog(AFX_IDD_NEWTYPEDLG), m_names(names) {}

    int chosen = -1;

protected:
    BOOL OnInitDialog() override {
        CDialog::OnInitDialog();
        m_list.SubclassDlgItem(AFX_IDC_LISTBOX, this);
        for (std::size_t i = 0; i < m_names.size(); ++i) {
            m_list.SetItemData(m_list.AddString(m_names[i]), i); // the list sorts
        }
        m_list.SetCurSel(0);
        return TRUE;
    }
    void OnOK() override {
        const int at = m_list.GetCurSel();
        if (at >= 0) {
            chosen = static_cast<int>(m_list.GetItemData(at));
            CDialog::OnOK();
        }
    }

    DECLARE_MESSAGE_MAP()

private:
    const std::vector<CString>& m_names;
    CListBox m_list;
};

// clang-format off
BEGIN_MESSAGE_MAP(NameDialog, CDialog)
    ON_LBN_DBLCLK(AFX_IDC_LISTBOX, &NameDialog::OnOK)
END_MESSAGE_MAP()
// clang-format on

} // namespace

int chooseName(const std::vector<CString>& names) {
    NameDialog dialog(names);
    return dialog.DoModal() == IDOK ? dialog.chosen : -1;
}

} // namespace tvx::afx
