#include "Keyboard.h"

#include "Resource.h"
#include "res/resource.h"
#include "s/AccelDlg.h"
#include "s/AccelProfile.h"
#include "s/ExternFrame.h"
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

/// The keys that the board comes with.
Gui_AccelMap ownKeys() {
    Gui_AccelMap map;
    for (const UINT id : {IDR_MAINFRAME, IDR_BOARDTYPE}) {
        const HACCEL table = LoadAccelerators(nullptr, MAKEINTRESOURCE(id));
        map.AddAll(table);
        DestroyAcceleratorTable(table);
    }
    return map;
}

/// The keys of a menu: all but those whose commands only the other menu has. These must stay free for what is typed:
/// the main window's table is in force in the console, too, where Delete is no command. What neither has now, such as a
/// file of a list that is filled when the menu opens, may come to either.
Gui_AccelMap keysOf(HMENU menu, HMENU other, const Gui_AccelMap& map) {
    const auto has = [](HMENU one, UINT command) {
        return GetMenuState(one, command, MF_BYCOMMAND) != static_cast<UINT>(-1);
    };
    Gui_AccelMap keys(map);
    int count = 0;
    tagACCEL* table = nullptr;
    map.GetAll(count, table);
    const std::unique_ptr<tagACCEL[]> owner(table);
    for (int i = 0; i < count; ++i) {
        if (!has(menu, table[i].cmd) && has(other, table[i].cmd)) {
            keys.Remove(Gui_Accel(table[i]));
        }
    }
    return keys;
}

/// Puts keys in force: in a table, which takes the place of the former one, and in the menu that belongs to it.
void replace(HACCEL& accelerators, HMENU menu, HMENU other, const Gui_AccelMap& map) {
    const Gui_AccelMap keys = keysOf(menu, other, map);
    DestroyAcceleratorTable(accelerators);
    accelerators = keys.CreateTable();
    keys.AnnotateMenu(CMenu::FromHandle(menu));
}

} // namespace

CKeyboard::CKeyboard(CMDIFrameWnd& main, CMultiDocTemplate& drawings) : m_main(main), m_drawings(drawings) {
    Gui_AccelMap map = ownKeys();
    if (Gui_AccelProfile::Read(map, entry, nullptr)) {
        apply(map);
    }
}

void CKeyboard::Apply(CFrameWnd& window) const {
    if (m_keys) {
        replace(window.m_hAccelTable, window.m_hMenuDefault, m_main.m_hMenuDefault, *m_keys);
    }
}

void CKeyboard::Edit() {
    const Gui_AccelMap own = ownKeys();
    Gui_AccelMap now(own);
    Gui_AccelProfile::Read(now, entry, nullptr);
    const HACCEL table = now.CreateTable();
    CKeyboardDlg dialog(m_main.GetMenu(), table, nullptr);
    DestroyAcceleratorTable(table);
    dialog.SetResetAccels(own);
    if (dialog.DoModal() == IDOK) {
        const std::unique_ptr<Gui_AccelMap> map(dialog.GetAccelMap());
        apply(*map);
        Gui_AccelProfile::Write(*map, own, entry, nullptr);
    }
}

int CKeyboard::CountOwn() const {
    return CountDifferences(m_keys ? *m_keys : ownKeys(), ownKeys());
}

void CKeyboard::Reset() {
    apply(ownKeys());
    Gui_AccelProfile::Forget(entry, nullptr);
}

void CKeyboard::apply(const Gui_AccelMap& map) {
    m_keys = map;
    replace(m_main.m_hAccelTable, m_main.m_hMenuDefault, m_drawings.m_hMenuShared, map);
    replace(m_drawings.m_hAccelTable, m_drawings.m_hMenuShared, m_main.m_hMenuDefault, map);
    for (Gui_ExternFrame* window : Gui_ExternFrame::GetAll()) {
        Apply(*window);
    }
    // Open drawings have the handles that the template had; later ones take those that it has now.
    for (POSITION at = m_drawings.GetFirstDocPosition(); at;) {
        const CDocument* document = m_drawings.GetNextDoc(at);
        for (POSITION view = document->GetFirstViewPosition(); view;) {
            if (auto* frame = DYNAMIC_DOWNCAST(CMDIChildWnd, document->GetNextView(view)->GetParentFrame())) {
                frame->SetHandles(m_drawings.m_hMenuShared, m_drawings.m_hAccelTable);
            }
        }
    }
}
