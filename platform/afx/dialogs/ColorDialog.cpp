#include "platform/afx/dialogs/ColorDialog.h"

#include "platform/afx/dialogs/detail/ToolkitDialog.h"
#include "platform/afx/toolkit/detail/Gui.h"
#include "platform/win/FrameworkIds.h"

#include <QColorDialog>

#include <algorithm>
#include <array>

using namespace tvx::afx;

IMPLEMENT_DYNAMIC(CColorDialog, CWnd)

namespace {

constexpr int customColors = 16; // as many as the toolkit's dialog has

QColor toColor(COLORREF color) {
    return {GetRValue(color), GetGValue(color), GetBValue(color)};
}

COLORREF fromColor(const QColor& color) {
    return RGB(color.red(), color.green(), color.blue());
}

} // namespace

CColorDialog::CColorDialog(COLORREF color, DWORD flags, CWnd* parent) {
    m_cc.hwndOwner = parent ? parent->m_hWnd : nullptr;
    m_cc.rgbResult = color;
    m_cc.Flags = flags | CC_RGBINIT;
    m_cc.lpCustColors = GetSavedCustomColors();
}

COLORREF* CColorDialog::GetSavedCustomColors() {
    static std::array<COLORREF, customColors> colors = [] {
        std::array<COLORREF, customColors> white{};
        std::ranges::fill(white, RGB(255, 255, 255));
        return white;
    }();
    return colors.data();
}

INT_PTR CColorDialog::DoModal() {
    if (!ensureGui()) {
        return IDCANCEL;
    }
    ToolkitDialog<QColorDialog> dialog(m_cc.hwndOwner, TVX_IDS_COLOR, AFX_IDD_COLOR);
    for (int i = 0; i < customColors && m_cc.lpCustColors; ++i) {
        QColorDialog::setCustomColor(i, toColor(m_cc.lpCustColors[i]));
    }
    dialog.setCurrentColor((m_cc.Flags & CC_RGBINIT) != 0 ? toColor(m_cc.rgbResult) : QColor(Qt::black));
    const bool accepted = dialog.ask();
    for (int i = 0; i < customColors && m_cc.lpCustColors; ++i) {
        m_cc.lpCustColors[i] = fromColor(QColorDialog::customColor(i));
    }
    if (accepted) {
        m_cc.rgbResult = fromColor(dialog.currentColor());
    }
    return accepted ? IDOK : IDCANCEL;
}
