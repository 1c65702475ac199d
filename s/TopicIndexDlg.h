#pragma once

#include "afxwin.h"
#include "platform/port/StringBase.h"
#include "s/Export.h"
#include "s/ListBox.h"

#include <vector>

/// "Topics Found": lets the user choose among the documents of a help request that has several.
///
/// @code
/// Gui_TopicIndexDlg topics(files, titles, nullptr);
/// if (topics.DoModal() == IDOK)
///     open(files[topics.GetSelectedIndex()]);
/// @endcode
class GUI_API Gui_TopicIndexDlg : public CDialog {
public:
    using Strings = std::vector<Port::StringBase<char>>;

    /// The n-th title belongs to the n-th file; a title without a file is not offered.
    /// @param files, titles  of the record; they must live as long as the dialog
    /// @param parent         the window to stand over; null for the application's main window
    Gui_TopicIndexDlg(const Strings& files, const Strings& titles, CWnd* parent);

    /// The place in the lists of what was chosen; 0 when nothing was.
    int GetSelectedIndex() const;

protected:
    BOOL OnInitDialog() override;
    void OnOK() override;
    void DoDataExchange(CDataExchange* dx) override;
    afx_msg void OnDoubleClick();
    DECLARE_MESSAGE_MAP()

private:
    Gui_ListBox m_list;
    const Strings* m_titles;
    const Strings* m_files;
    int m_selected = 0;
};
