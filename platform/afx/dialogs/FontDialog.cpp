#include "platform/afx/dialogs/FontDialog.h"

#include "platform/afx/dialogs/detail/ToolkitDialog.h"
#include "platform/afx/gdi/detail/Fonts.h"
#include "platform/afx/toolkit/detail/Gui.h"
#include "platform/base/Text.h"
#include "platform/win/FrameworkIds.h"

#include <QFontDatabase>
#include <QFontDialog>
#include <QFontInfo>

#include <climits>
#include <cmath>
#include <utility>

using namespace tvx::afx;

IMPLEMENT_DYNAMIC(CFontDialog, CWnd)

namespace {

constexpr double pixelsOfPoint = 96.0 / 72; // there are 96 pixels to an inch

LOGFONT describe(const QFont& font) {
    return describeFont(font, static_cast<int>(std::lround(QFontInfo(font).pointSizeF() * pixelsOfPoint)));
}

/// The font as the dialog knows it: of an installed family, with the name of its style, in points. Without that name
/// the dialog takes the first style that the family has.
QFont named(const LOGFONT& description) {
    QFont font = controlFont(description);
    const QFontInfo real(font);
    font.setFamily(real.family());
    font.setPointSizeF(std::round(real.pixelSize() / pixelsOfPoint));
    // Of styles that differ in width only, the one without a word for it is the usual one.
    std::pair<qsizetype, qsizetype> nearest{INT_MAX, INT_MAX};
    for (const QString& style : QFontDatabase::styles(font.family())) {
        const QFont candidate = QFontDatabase::font(font.family(), style, font.pointSize());
        const std::pair<qsizetype, qsizetype> distance{std::abs(candidate.weight() - font.weight()), style.size()};
        if (candidate.italic() == font.italic() && distance < nearest) {
            nearest = distance;
            font.setStyleName(style);
        }
    }
    return font;
}

} // namespace

CFontDialog::CFontDialog(LOGFONT* initial, DWORD flags, CDC*, CWnd* parent) {
    m_cf.hwndOwner = parent ? parent->m_hWnd : nullptr;
    m_cf.Flags = flags | (initial ? CF_INITTOLOGFONTSTRUCT : 0);
    if (initial) {
        m_lf = *initial;
    }
    m_cf.lpLogFont = &m_lf;
}

INT_PTR CFontDialog::DoModal() {
    if (!ensureGui()) {
        return IDCANCEL;
    }
    ToolkitDialog<QFontDialog> dialog(m_cf.hwndOwner, TVX_IDS_FONT, AFX_IDD_FONT);
    dialog.setOption(QFontDialog::MonospacedFonts, (m_cf.Flags & CF_FIXEDPITCHONLY) != 0);
    const bool isGiven = (m_cf.Flags & CF_INITTOLOGFONTSTRUCT) != 0 && m_cf.lpLogFont;
    dialog.setCurrentFont(named(isGiven ? *m_cf.lpLogFont : pointFont(80, "")));
    if (!dialog.ask()) {
        return IDCANCEL;
    }
    const QFont chosen = dialog.currentFont();
    m_lf = describe(chosen);
    m_cf.iPointSize = static_cast<int>(std::lround(QFontInfo(chosen).pointSizeF() * 10));
    if (m_cf.lpLogFont) {
        *m_cf.lpLogFont = m_lf;
    }
    return IDOK;
}
