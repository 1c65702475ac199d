#include "Keyboard.h"

#include "Resource.h"
#include "res/resource.h"
#include "s/AccelDlg.h"
#include "s/AccelProfile.h"
#include "samples/family/KeyDifferences.h"

#include <memory>

namespace {

constexpr const char* entry = "Keys";

/// The dialog, with a page of the help for its button.
class CKeyboardDlg : public Gui_AccelDlg {
public:
    using Gui_AccelDlg::Gui_AccelDlg;

protected:
    DECLARE_MESSAGE_MAP()
};

// clang-format off
BEGIN_MESSAGE_MAP(CKeyboardDlg, Gui_AccelDlg)
    ON_BN_CLICKED(GUI_IDC_HELP_BUTTON, &CWnd::OnHelp)
END_MESSAGE_MAP()
// clang-format on

/// The keys that Notes comes with.
Gui_AccelMap ownKeys() {
    const HACCEL table = LoadAccelerators(nullptr, MAKEINTRESOURCE(IDR_MAINFRAME));
    Gui_AccelMap map(table);
    DestroyAcceleratorTable(table);
    return map;
}

} // namespace

CKeyboard::CKeyboard(CFrameWnd& main) : m_main(main) {
    Gui_AccelMap map = ownKeys();
    if (Gui_AccelProfile::Read(map, entry, nullptr)) {
        apply(map);
    }
}

void CKeyboard::Edit() {
    CKeyboardDlg dialog(m_main.GetMenu(), m_main.m_hAccelTable, &m_main);
    const Gui_AccelMap own = ownKeys();
    dialog.SetResetAccels(own);
    if (dialog.DoModal() == IDOK) {
        const std::unique_ptr<Gui_AccelMap> map(dialog.GetAccelMap());
        apply(*map);
        Gui_AccelProfile::Write(*map, own, entry, nullptr);
    }
}

int CKeyboard::CountOwn() const {
    return CountDifferences(Gui_AccelMap(m_main.m_hAccelTable), ownKeys());
}

void CKeyboard::Reset() {
    apply(ownKeys());
    Gui_AccelProfile::Forget(entry, nullptr);
}

// The frame destroys the table that it has at its end.
void CKeyboard::apply(const Gui_AccelMap& map) {
    DestroyAcceleratorTable(m_main.m_hAccelTable);
    m_main.m_hAccelTable = map.CreateTable();
    map.AnnotateMenu(m_main.GetMenu());
}
