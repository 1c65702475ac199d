#include "s/AboutDlg.h"

#include "res/resource.h"
#include "s/ProductTexts.h"
#include "s/Record.h"
#include "s/WinApp.h"

#include <cstring>

struct Gui_AboutDlg::Record {
    CStatic iconControl;
    ProductTexts texts;
    CString empty; ///< the last line, for hosts that put a text there
    HICON icon = nullptr;
};

Gui_AboutDlg::Gui_AboutDlg(CWnd* parent) : CDialog(GUI_IDD_ABOUT, parent), m_record(MakeRecord<Record>()) {
    if (auto* app = dynamic_cast<Gui_WinApp*>(AfxGetApp())) {
        m_record->icon = app->GetAppIcon();
    }
    m_record->texts = GetProductTexts();
}

Gui_AboutDlg::~Gui_AboutDlg() = default;

BOOL Gui_AboutDlg::OnInitDialog() {
    CDialog::OnInitDialog();
    CString title;
    AfxFormatString1(title, GUI_IDS_ABOUT_TITLE, m_record->texts.name);
    SetWindowText(title);
    if (m_record->icon) {
        m_record->iconControl.SetIcon(m_record->icon);
    }
    CenterWindow();
    return TRUE;
}

void Gui_AboutDlg::DoDataExchange(CDataExchange* dx) {
    CDialog::DoDataExchange(dx);
    ProductTexts& texts = m_record->texts;
    DDX_Control(dx, GUI_IDC_ABOUT_ICON, m_record->iconControl);
    DDX_Text(dx, GUI_IDC_ABOUT_APP_NAME, texts.name);
    DDX_Text(dx, GUI_IDC_ABOUT_RELEASE, texts.release);
    DDX_Text(dx, GUI_IDC_ABOUT_APP_VERSION, texts.version);
    DDX_Text(dx, GUI_IDC_ABOUT_COPYRIGHT1, texts.copyright1);
    DDX_Text(dx, GUI_IDC_ABOUT_COPYRIGHT2, texts.copyright2);
    DDX_Text(dx, GUI_IDC_ABOUT_EMPTY, m_record->empty);
}

BOOL Gui_AboutDlg::PreTranslateMessage(MSG* message) {
    const bool copies = message->wParam == 'C' || message->wParam == VK_INSERT;
    if (message->message == WM_KEYDOWN && copies && GetKeyState(VK_CONTROL) < 0) {
        copyTexts();
        return TRUE;
    }
    return CDialog::PreTranslateMessage(message);
}

void Gui_AboutDlg::copyTexts() {
    const ProductTexts& texts = m_record->texts;
    CString all;
    for (const CString& line : {texts.name, texts.release, texts.version, texts.copyright1, texts.copyright2}) {
        if (!line.IsEmpty()) {
            all += line + "\n";
        }
    }
    const std::size_t size = static_cast<std::size_t>(all.GetLength()) + 1;
    HGLOBAL block = GlobalAlloc(GMEM_MOVEABLE, size);
    if (!block || !OpenClipboard(m_hWnd)) {
        GlobalFree(block);
        return;
    }
    std::memcpy(GlobalLock(block), all.GetString(), size);
    GlobalUnlock(block);
    EmptyClipboard();
    if (!SetClipboardData(CF_TEXT, block)) {
        GlobalFree(block);
    }
    CloseClipboard();
}
