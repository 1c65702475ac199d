#pragma once

#include "afxwin.h"

/// The main window of the calling thread's application; null before it stands and after its end.
inline HWND MainWindowHandle() {
    const CWinThread* thread = AfxGetThread();
    return thread && thread->m_pMainWnd ? thread->m_pMainWnd->m_hWnd : nullptr;
}
