// The window of a property sheet: how it is made, laid out and ended.
#include "platform/afx/dialogs/PropertySheet.h"

#include "platform/afx/controls/detail/TabWindow.h"
#include "platform/afx/dialogs/detail/DialogWindow.h"
#include "platform/win/DialogTemplate.h"
#include "platform/win/FrameworkIds.h"

#include <QFontMetrics>

#include <algorithm>
#include <array>

using namespace tvx::afx;

namespace {

constexpr DWORD usualStyle = DS_MODALFRAME | WS_POPUP | WS_CAPTION | WS_SYSMENU;
constexpr std::array<int, 4> buttonIds = {IDOK, IDCANCEL, ID_APPLY_NOW, IDHELP};

tvx::DialogItemTemplate item(const char* className, int id, DWORD style, UINT text = 0) {
    tvx::DialogItemTemplate result;
    result.className = className;
    result.id = static_cast<DWORD>(id);
    result.style = style | WS_CHILD | WS_VISIBLE | WS_TABSTOP;
    CString caption;
    if (text != 0) {
        (void)caption.LoadString(text);
    }
    result.title = std::string(caption);
    return result;
}

} // namespace

std::optional<tvx::DialogTemplate> CPropertySheet::describe() const {
    tvx::DialogTemplate description;
    description.style = m_style != 0 ? m_style : usualStyle;
    description.extendedStyle = m_exStyle;
    description.title = m_caption;
    description.items.push_back(item(tabClass, AFX_IDC_TAB_CONTROL, 0));
    if (m_modeless) {
        return description;
    }
    description.items.push_back(item("Button", IDOK, BS_DEFPUSHBUTTON | WS_GROUP, TVX_IDS_OK));
    description.items.push_back(item("Button", IDCANCEL, BS_PUSHBUTTON, TVX_IDS_CANCEL));
    if ((m_psh.dwFlags & PSH_NOAPPLYNOW) == 0) {
        description.items.push_back(item("Button", ID_APPLY_NOW, BS_PUSHBUTTON | WS_DISABLED, TVX_IDS_APPLY));
    }
    if ((m_psh.dwFlags & PSH_HASHELP) != 0) {
        description.items.push_back(item("Button", IDHELP, BS_PUSHBUTTON, TVX_IDS_HELP));
    }
    return description;
}

BOOL CPropertySheet::Create(CWnd* parent, DWORD style, DWORD exStyle) {
    m_modeless = true;
    m_style = style != static_cast<DWORD>(-1) ? style : usualStyle | WS_VISIBLE;
    m_exStyle = exStyle;
    return CDialog::Create(m_lpszTemplateName, parent ? parent : m_pParentWnd);
}

int CPropertySheet::DoModal() {
    m_modeless = false;
    m_style = m_exStyle = 0;
    return CDialog::DoModal();
}

void CPropertySheet::EndDialog(int result) {
    if (m_modeless) {
        DestroyWindow();
    } else {
        CDialog::EndDialog(result);
    }
}

void CPropertySheet::SetTitle(LPCSTR text) {
    m_caption = text;
    m_psh.pszCaption = m_caption;
    if (m_hWnd) {
        SetWindowText(m_caption);
    }
}

BOOL CPropertySheet::OnInitDialog() {
    m_active = -1;
    layOut();
    activate(std::clamp(static_cast<int>(m_psh.nStartPage), 0, std::max(GetPageCount() - 1, 0)));
    CPropertyPage* shown = GetPage(m_active);
    CWnd* first = shown ? shown->GetNextDlgTabItem(nullptr) : nullptr;
    if (m_modeless || !first) {
        return m_modeless ? FALSE : TRUE;
    }
    GotoDlgCtrl(first);
    return FALSE;
}

/// Gives tabs and buttons their places, and the window the size that the largest page needs.
void CPropertySheet::layOut() {
    auto& window = static_cast<DialogWindow&>(*GetState());
    auto& tabs = static_cast<TabWindow&>(*window.child(AFX_IDC_TAB_CONTROL));
    QSize largest;
    for (int i = 0; i < GetPageCount(); ++i) {
        const auto description = GetPage(i)->describe();
        tabs.insert(i, description ? toQt(description->title.c_str()) : QString());
        largest = description ? largest.expandedTo(DialogWindow::insideOf(*description)) : largest;
    }
    const QRect units = window.map({4, 4, 50, 14}); // a gap and a button
    const int gap = units.y();
    std::vector<std::pair<Window*, int>> buttons; // with their widths
    int buttonsWidth = -gap;
    for (const int id : buttonIds) {
        if (Window* button = window.child(id)) {
            const QSize text = button->widget()->fontMetrics().size(Qt::TextShowMnemonic, button->text());
            buttons.emplace_back(button, std::max(units.width(), text.width() + 2 * gap));
            buttonsWidth += buttons.back().second + gap;
        }
    }
    // A row of many tabs widens the sheet by as much again as a page has; beyond that the row scrolls.
    QSize size = tabs.sizeAround(largest);
    size.setWidth(std::max({size.width(), buttonsWidth, std::min(tabs.tabsWidth(), 2 * size.width())}));
    tabs.setWindowRect(QRect(QPoint(gap, gap), size));
    int left = gap + size.width() - buttonsWidth;
    const int top = size.height() + 2 * gap;
    for (const auto& [button, width] : buttons) {
        button->setWindowRect(QRect(left, top, width, units.height()));
        left += width + gap;
    }
    const int height = buttons.empty() ? top : top + units.height() + gap;
    window.setClientSize(window.windowRect().topLeft(), QSize(size.width() + 2 * gap, height));
}
