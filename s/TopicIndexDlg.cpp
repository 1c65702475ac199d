#include "s/TopicIndexDlg.h"

#include "res/resource.h"

#include <algorithm>

// clang-format off
BEGIN_MESSAGE_MAP(Gui_TopicIndexDlg, CDialog)
    ON_LBN_DBLCLK(GUI_IDC_TOPICS, &Gui_TopicIndexDlg::OnDoubleClick)
END_MESSAGE_MAP()
// clang-format on

Gui_TopicIndexDlg::Gui_TopicIndexDlg(const Strings& files, const Strings& titles, CWnd* parent)
    : CDialog(GUI_IDD_TOPICS, parent), m_titles(&titles), m_files(&files) {}

int Gui_TopicIndexDlg::GetSelectedIndex() const {
    return m_selected;
}

void Gui_TopicIndexDlg::DoDataExchange(CDataExchange* dx) {
    CDialog::DoDataExchange(dx);
    DDX_Control(dx, GUI_IDC_TOPICS, m_list);
}

BOOL Gui_TopicIndexDlg::OnInitDialog() {
    CDialog::OnInitDialog();
    const std::size_t count = std::min(m_titles->size(), m_files->size());
    for (std::size_t i = 0; i < count; ++i) {
        // The list is sorted: what ties a line to its file is the number that is kept with it.
        const int line = m_list.AddString((*m_titles)[i].c_str());
        m_list.SetItemData(line, static_cast<DWORD_PTR>(i));
    }
    m_list.SetCurSel(count > 0 ? 0 : -1);
    m_list.UpdateHorizontalExtent();
    return TRUE;
}

void Gui_TopicIndexDlg::OnOK() {
    const int line = m_list.GetCurSel();
    if (line != LB_ERR) {
        m_selected = static_cast<int>(m_list.GetItemData(line));
    }
    CDialog::OnOK();
}

void Gui_TopicIndexDlg::OnDoubleClick() {
    OnOK();
}
