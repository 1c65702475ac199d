#pragma once

#include "Resource.h"
#include "afxwin.h"
#include "s/Process.h"

/// Runs a program and shows what it writes, as it comes. Each run has a window of its own, which can be stopped and
/// closed, and deletes itself. The program ends with its window.
class COutputWindow : public CDialog {
public:
    /// Starts a program and opens a window for it; says why when it cannot be started.
    static void Run(const CString& command, CWnd* parent);

protected:
    void DoDataExchange(CDataExchange* dx) override;
    BOOL OnInitDialog() override;
    void OnOK() override;
    void OnCancel() override;
    void PostNcDestroy() override;
    afx_msg void OnSize(UINT type, int width, int height);
    afx_msg void OnStop();
    afx_msg LRESULT OnOutput(WPARAM, LPARAM);

private:
    COutputWindow() = default;
    void dropOldLines();
    void showState();
    void place(CWnd& control, int moveX, int moveY, int growX, int growY);

    Gui_Process m_process;
    CEdit m_output;
    CStatic m_state;
    CButton m_stop;
    CSize m_size; ///< of the client area, as the controls are laid out now

    DECLARE_MESSAGE_MAP()
};
