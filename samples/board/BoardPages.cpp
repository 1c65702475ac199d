#include "BoardPages.h"

#include "Board.h"
#include "Drawing.h"
#include "Resource.h"

#include <cstdlib>

// --- the sheet ---

CBoardPreferences::CBoardPreferences(CWnd* parent) : CPreferences(parent), m_options(theApp.GetOptions()) {
    Gui_PropItem* const shapes = AddPage(IDS_PREF_SHAPES, &MakePage<CShapesPage, CBoardPreferences>, nullptr, true);
    AddPage(IDS_PREF_GRID, &MakePage<CGridPage, CBoardPreferences>, shapes, true);
    AddPage(IDS_PREF_COLORS, &MakePage<CColorsPage, CBoardPreferences>, shapes, true);
    AddPage(IDS_PREF_FONTS, &MakePage<CFontsPage, CBoardPreferences>, shapes, true);
    AddPage(IDS_PREF_CONSOLE, &MakePage<CConsolePage, CBoardPreferences>, nullptr, true);
    AddFamilyPages();
}

void CBoardPreferences::StoreOwn() {
    m_options.Write(theApp.GetOptions());
    theApp.SetOptions(m_options);
}

void CBoardPreferences::EditKeys() {
    theApp.GetKeyboard().Edit();
}

int CBoardPreferences::CountOwnKeys() const {
    return theApp.GetKeyboard().CountOwn();
}

void CBoardPreferences::ResetKeys() {
    theApp.GetKeyboard().Reset();
}

// --- shapes ---

// clang-format off
BEGIN_MESSAGE_MAP(CShapesPage, CBoardPage)
    ON_BN_CLICKED(IDC_PREF_FILLED, &CShapesPage::OnFilled)
END_MESSAGE_MAP()
// clang-format on

CShapesPage::CShapesPage(CBoardPreferences& sheet) : CBoardPage(IDD_PREF_SHAPES, sheet) {}

void CShapesPage::DoDataExchange(CDataExchange* dx) {
    CBoardPage::DoDataExchange(dx);
    Options options = GetOptions();
    DDX_Color(dx, IDC_PREF_OUTLINE, m_outline, options.outline);
    DDX_Check(dx, IDC_PREF_FILLED, options.filled);
    DDX_Color(dx, IDC_PREF_FILL, m_fill, options.fill);
    DDX_Text(dx, IDC_PREF_LINE_WIDTH, options.lineWidth);
    DDV_MinMaxInt(dx, options.lineWidth, 1, Options::maxLineWidth);
    GetOptions() = options; // not reached with a wrong number
    ShowState();
}

void CShapesPage::SetDefaults() {
    const Options own;
    Options& options = GetOptions();
    options.outline = own.outline;
    options.filled = own.filled;
    options.fill = own.fill;
    options.lineWidth = own.lineWidth;
}

void CShapesPage::OnFilled() {
    ShowState();
}

void CShapesPage::ShowState() {
    m_fill.EnableWindow(IsDlgButtonChecked(IDC_PREF_FILLED));
}

// --- grid ---

CGridPage::CGridPage(CBoardPreferences& sheet) : CBoardPage(IDD_PREF_GRID, sheet) {}

void CGridPage::DoDataExchange(CDataExchange* dx) {
    CBoardPage::DoDataExchange(dx);
    Options options = GetOptions();
    DDX_Check(dx, IDC_PREF_GRID_SHOWN, options.gridShown);
    DDX_Text(dx, IDC_PREF_GRID_DISTANCE, options.gridDistance);
    DDV_MinMaxInt(dx, options.gridDistance, 0, Options::maxGrid);
    DDX_Check(dx, IDC_PREF_SNAP, options.snap);
    GetOptions() = options; // not reached with a wrong number
}

void CGridPage::SetDefaults() {
    const Options own;
    Options& options = GetOptions();
    options.gridShown = own.gridShown;
    options.gridDistance = own.gridDistance;
    options.snap = own.snap;
}

// --- colours ---

CColorsPage::CColorsPage(CBoardPreferences& sheet) : CBoardPage(IDD_PREF_COLORS, sheet) {}

void CColorsPage::DoDataExchange(CDataExchange* dx) {
    CBoardPage::DoDataExchange(dx);
    Options& options = GetOptions();
    DDX_Color(dx, IDC_PREF_PAPER, m_paper, options.paper);
    DDX_Color(dx, IDC_PREF_GRID_COLOR, m_grid, options.gridColor);
    DDX_Color(dx, IDC_PREF_HANDLES, m_handles, options.handles);
}

void CColorsPage::SetDefaults() {
    const Options own;
    Options& options = GetOptions();
    options.paper = own.paper;
    options.gridColor = own.gridColor;
    options.handles = own.handles;
}

// --- fonts ---

// clang-format off
BEGIN_MESSAGE_MAP(CFontsPage, CBoardPage)
    ON_BN_CLICKED(IDC_PREF_CHOOSE_FONT, &CFontsPage::OnChooseFont)
END_MESSAGE_MAP()
// clang-format on

CFontsPage::CFontsPage(CBoardPreferences& sheet) : CBoardPage(IDD_PREF_FONTS, sheet) {}

void CFontsPage::DoDataExchange(CDataExchange* dx) {
    CBoardPage::DoDataExchange(dx);
    Options options = dx->m_bSaveAndValidate ? m_shown : GetOptions();
    DDX_Text(dx, IDC_PREF_TEXT_SIZE, options.textSize);
    DDV_MinMaxInt(dx, options.textSize, board::minTextSize, board::maxTextSize);
    if (dx->m_bSaveAndValidate) { // not reached with a wrong number
        GetOptions().textSize = options.textSize;
        TakeFont(GetOptions(), options);
    } else {
        m_shown = options;
        ShowFont();
    }
}

void CFontsPage::SetDefaults() {
    GetOptions().textSize = Options().textSize;
    TakeFont(GetOptions(), Options());
}

void CFontsPage::TakeFont(Options& to, const Options& from) {
    to.textFont = from.textFont;
    to.textBold = from.textBold;
    to.textItalic = from.textItalic;
}

/// Names the typeface, and shows its letters.
void CFontsPage::ShowFont() {
    constexpr int height = 19;
    SetDlgItemText(IDC_PREF_FONT, m_shown.textFont);
    const LOGFONT wanted = m_shown.GetTextFont(height);
    CFont font;
    font.CreateFontIndirect(&wanted);
    GetDlgItem(IDC_PREF_SAMPLE)->SetFont(&font);
    m_sample.DeleteObject();
    m_sample.Attach(font.Detach());
}

void CFontsPage::OnChooseFont() {
    LOGFONT font = m_shown.GetTextFont(static_cast<int>(GetDlgItemInt(IDC_PREF_TEXT_SIZE)));
    CFontDialog dialog(&font, CF_SCREENFONTS | CF_INITTOLOGFONTSTRUCT, nullptr, this);
    if (dialog.DoModal() == IDOK) {
        dialog.GetCurrentFont(&font);
        m_shown.textFont = font.lfFaceName;
        m_shown.textBold = dialog.IsBold();
        m_shown.textItalic = dialog.IsItalic();
        SetDlgItemInt(IDC_PREF_TEXT_SIZE, static_cast<UINT>(std::abs(font.lfHeight)));
        ShowFont();
        SetChanged();
    }
}

// --- console ---

CConsolePage::CConsolePage(CBoardPreferences& sheet) : CBoardPage(IDD_PREF_CONSOLE, sheet) {}

void CConsolePage::DoDataExchange(CDataExchange* dx) {
    CBoardPage::DoDataExchange(dx);
    Options& options = GetOptions();
    DDX_Check(dx, IDC_PREF_KEEP_COMMANDS, options.keepCommands);
    DDX_Check(dx, IDC_PREF_SHOW_STATUS, options.showStatus);
}

void CConsolePage::SetDefaults() {
    const Options own;
    GetOptions().keepCommands = own.keepCommands;
    GetOptions().showStatus = own.showStatus;
}
