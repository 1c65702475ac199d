#include "BoardPages.h"

#include "Board.h"
#include "Drawing.h"
#include "Resource.h"

#include <cstdio>

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
    int size = GetOptions().textSize;
    DDX_Text(dx, IDC_PREF_TEXT_SIZE, size);
    DDV_MinMaxInt(dx, size, board::minTextSize, board::maxTextSize);
    if (dx->m_bSaveAndValidate) { // not reached with a wrong number
        GetOptions().textSize = size;
        GetOptions().textFont = m_face;
    } else {
        ShowFont(GetOptions().textFont);
    }
}

void CFontsPage::SetDefaults() {
    const Options own;
    GetOptions().textFont = own.textFont;
    GetOptions().textSize = own.textSize;
}

/// Names the typeface, and shows its letters.
void CFontsPage::ShowFont(const CString& face) {
    m_face = face;
    SetDlgItemText(IDC_PREF_FONT, face);
    CFont font;
    font.CreatePointFont(140, face);
    GetDlgItem(IDC_PREF_SAMPLE)->SetFont(&font);
    m_sample.DeleteObject();
    m_sample.Attach(font.Detach());
}

void CFontsPage::OnChooseFont() {
    LOGFONT font{};
    std::snprintf(font.lfFaceName, sizeof font.lfFaceName, "%s", m_face.GetString());
    font.lfHeight = -static_cast<LONG>(GetDlgItemInt(IDC_PREF_TEXT_SIZE));
    CFontDialog dialog(&font, CF_SCREENFONTS, nullptr, this);
    if (dialog.DoModal() == IDOK) {
        ShowFont(dialog.GetFaceName());
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
