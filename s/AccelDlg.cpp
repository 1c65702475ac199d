#include "s/AccelDlg.h"

#include "res/resource.h"
#include "s/AccelDlgRecord.h"
#include "s/MenuStr.h"
#include "s/Msg.h"
#include "s/Record.h"
#include "s/StringOf.h"

#include <algorithm>

// clang-format off
BEGIN_MESSAGE_MAP(Gui_AccelDlg, CDialog)
    ON_LBN_SELCHANGE(GUI_IDC_ACCEL_COMMANDS, &Gui_AccelDlg::OnSelchangeCommandlist)
    ON_LBN_SELCHANGE(GUI_IDC_ACCEL_KEYS, &Gui_AccelDlg::OnSelchangeCurrentkeylist)
    ON_BN_CLICKED(GUI_IDC_ACCEL_REMOVE, &Gui_AccelDlg::OnRemovebutton)
    ON_BN_CLICKED(GUI_IDC_ACCEL_ASSIGN, &Gui_AccelDlg::OnAssignbutton)
    ON_BN_CLICKED(GUI_IDC_ACCEL_SPECIFY, &Gui_AccelDlg::OnSpecifybutton)
    ON_BN_CLICKED(GUI_IDC_ACCEL_FIND_KEY, &Gui_AccelDlg::OnFindKey)
    ON_BN_CLICKED(GUI_IDC_ACCEL_UNDO, &Gui_AccelDlg::OnUndo)
    ON_BN_CLICKED(GUI_IDC_ACCEL_RESET, &Gui_AccelDlg::OnReset)
    ON_EN_CHANGE(GUI_IDC_ACCEL_HOTKEY, &Gui_AccelDlg::OnTypedKey)
    ON_EN_CHANGE(GUI_IDC_ACCEL_FIND_FIELD, &Gui_AccelDlg::OnKeyToFind)
    ON_EN_CHANGE(GUI_IDC_ACCEL_FILTER, &Gui_AccelDlg::OnChangeFilter)
END_MESSAGE_MAP()
// clang-format on

void EnableButton(CWnd& button, bool on, CWnd& heir) {
    if (!on && CWnd::GetFocus() == &button) {
        heir.SetFocus();
    }
    button.EnableWindow(on ? TRUE : FALSE);
}

CString KeyMessage(UINT id, const CString& key, const CString& owner) {
    Gui_Msg text(id);
    text << key << owner;
    return text.GetValue();
}

Gui_AccelDlg::Gui_AccelDlg(CMenu* menu, HACCEL table, CWnd* parent)
    : CDialog(GUI_IDD_ACCELERATORS, parent), m_record(MakeRecord<Record>(menu, table)) {}

Gui_AccelDlg::~Gui_AccelDlg() = default;

void Gui_AccelDlg::ApplyChangesToFrameWindow(CFrameWnd* frame) {
    DestroyAcceleratorTable(frame->m_hAccelTable);
    frame->m_hAccelTable = m_record->map.CreateTable();
    m_record->map.AnnotateMenu(frame->GetMenu());
}

void Gui_AccelDlg::SetResetAccels(const Gui_AccelMap& accels) {
    m_record->resetTo = accels;
}

Gui_AccelMap* Gui_AccelDlg::GetAccelMap() const {
    return MakeRecord<Gui_AccelMap>(m_record->map).release();
}

void Gui_AccelDlg::DoDataExchange(CDataExchange* dx) {
    CDialog::DoDataExchange(dx);
    DDX_Control(dx, GUI_IDC_ACCEL_COMMANDS, m_record->commandList);
    DDX_Control(dx, GUI_IDC_ACCEL_KEYS, m_record->keyList);
    DDX_Control(dx, GUI_IDC_ACCEL_HOTKEY, m_record->hotKey);
    DDX_Control(dx, GUI_IDC_ACCEL_FIND_FIELD, m_record->findField);
    DDX_Control(dx, GUI_IDC_ACCEL_REMOVE, m_record->remove);
    DDX_Control(dx, GUI_IDC_ACCEL_ASSIGN, m_record->assign);
    DDX_Control(dx, GUI_IDC_ACCEL_SPECIFY, m_record->specify);
    DDX_Control(dx, GUI_IDC_ACCEL_FILTER, m_record->filter);
}

BOOL Gui_AccelDlg::OnInitDialog() {
    CDialog::OnInitDialog();
    // The last time it was shown may have ended while a key was typed.
    m_record->idle = 1;
    m_record->finding = false;
    m_record->specify.GetWindowText(m_record->specifyText);
    m_record->remove.EnableWindow(FALSE);
    m_record->commands = CommandsOf(CMenu::FromHandle(m_record->menu));
    // As the list would sort them: in order, each is appended.
    std::stable_sort(m_record->commands.begin(), m_record->commands.end(),
                     [](const MenuCommand& a, const MenuCommand& b) { return a.label.CompareNoCase(b.label) < 0; });
    fillCommands();
    describeKey();
    changed(CString());
    return TRUE;
}

// Keys and commands

std::optional<int> Gui_AccelDlg::Record::selected() const {
    const int line = commandList.GetCurSel();
    return line >= 0 ? std::optional(shown[static_cast<std::size_t>(line)]) : std::nullopt;
}

Gui_Accel AccelOf(const CHotKeyCtrl& control) {
    WORD key = 0;
    WORD modifiers = 0;
    control.GetHotKey(key, modifiers);
    if (key == 0) {
        return {};
    }
    const int flags = FVIRTKEY | FNOINVERT | ((modifiers & HOTKEYF_ALT) != 0 ? FALT : 0) |
                      ((modifiers & HOTKEYF_SHIFT) != 0 ? FSHIFT : 0) |
                      ((modifiers & HOTKEYF_CONTROL) != 0 ? FCONTROL : 0);
    return {static_cast<BYTE>(flags), key, 0};
}

Gui_Accel Gui_AccelDlg::Record::typedAccel() const {
    Gui_Accel accel = AccelOf(hotKey);
    const int line = commandList.GetCurSel();
    if (accel.IsEmpty() || line < 0) {
        return {};
    }
    accel.cmd = static_cast<WORD>(commandList.GetItemData(line));
    return accel;
}

std::optional<CString> Gui_AccelDlg::Record::labelOf(UINT command) const {
    const auto found = std::find_if(commands.begin(), commands.end(),
                                    [command](const MenuCommand& listed) { return listed.id == command; });
    return found != commands.end() ? std::optional(found->label) : std::nullopt;
}

CString Gui_AccelDlg::Record::nameOf(UINT command) const {
    const auto label = labelOf(command);
    return label ? label->Mid(1) : StringOf(GUI_IDS_KEY_NO_ITEM);
}

std::optional<CString> Gui_AccelDlg::Record::menuOpenedBy(const Gui_Accel& key) const {
    const CMenu* bar = CMenu::FromHandle(menu);
    if (!bar || (key.fVirt & (FALT | FSHIFT | FCONTROL)) != FALT) {
        return std::nullopt;
    }
    for (int item = 0; item < static_cast<int>(bar->GetMenuItemCount()); ++item) {
        const Gui_MenuStr text(bar, item, MF_BYPOSITION);
        const CString access = text.GetAccessKeyText();
        if (access.GetLength() == 1 && static_cast<BYTE>(access[0]) == static_cast<BYTE>(key.key)) {
            return text.GetCommandText();
        }
    }
    return std::nullopt;
}

CString Gui_AccelDlg::Record::ownerText(const Gui_Accel& key) const {
    const CString name = key.GetKeyText();
    unsigned short command = 0;
    if (map.GetCmdAt(key, command)) {
        if (const auto label = labelOf(command)) {
            return KeyMessage(GUI_IDS_KEY_ASSIGNED, name, *label);
        }
    }
    if (const auto opened = menuOpenedBy(key)) {
        return KeyMessage(GUI_IDS_KEY_OF_MENU, name, *opened);
    }
    return KeyMessage(GUI_IDS_KEY_UNASSIGNED, name);
}

void Gui_AccelDlg::describeKey() {
    const Gui_Accel key = AccelOf(m_record->hotKey);
    if (key.IsEmpty()) {
        SetDlgItemText(GUI_IDC_ACCEL_KEY_TEXT, StringOf(GUI_IDS_KEY_BEGIN));
        EnableButton(m_record->assign, false, m_record->specify);
    } else {
        SetDlgItemText(GUI_IDC_ACCEL_KEY_TEXT, m_record->ownerText(key));
    }
}

void Gui_AccelDlg::refreshKeyState() {
    describeKey();
    EnableButton(m_record->assign, !m_record->typedAccel().IsEmpty(), m_record->specify);
}

void Gui_AccelDlg::fillKeys() {
    CListBox& list = m_record->keyList;
    list.ResetContent();
    const int line = m_record->commandList.GetCurSel();
    if (line < 0) {
        return;
    }
    const auto command = static_cast<unsigned short>(m_record->commandList.GetItemData(line));
    Gui_Accel accel;
    for (int index = 0; m_record->map.GetAccelAt(command, index, accel); ++index) {
        const int added = list.AddString(accel.GetKeyText());
        list.SetItemData(added, accel.EncodeFlagsAndKey());
    }
    OnSelchangeCurrentkeylist();
}

void Gui_AccelDlg::showCommand() {
    const auto command = m_record->selected();
    const UINT id = command ? m_record->commands[static_cast<std::size_t>(*command)].id : 0;
    SetDlgItemText(GUI_IDC_ACCEL_COMMAND_TEXT, command ? PromptOf(id) : CString());
}

// What the user does

void Gui_AccelDlg::OnSelchangeCommandlist() {
    showCommand();
    fillKeys();
    refreshKeyState();
}

void Gui_AccelDlg::OnSelchangeCurrentkeylist() {
    EnableButton(m_record->remove, m_record->keyList.GetCurSel() >= 0, m_record->keyList);
}

void Gui_AccelDlg::OnSpecifybutton() {
    if (m_record->idle) {
        m_record->specify.SetWindowText(StringOf(GUI_IDS_KEY_DONE));
        m_record->hotKey.SetHotKey(0, 0);
        m_record->hotKey.ShowWindow(SW_SHOW);
        m_record->hotKey.SetFocus();
        SetDlgItemText(GUI_IDC_ACCEL_KEY_TEXT, StringOf(GUI_IDS_KEY_TYPE));
        setNote(StringOf(GUI_IDS_KEY_AGAIN));
        m_record->typed.Clear();
        m_record->idle = 0;
        return;
    }
    setNote(CString());
    m_record->specify.SetWindowText(m_record->specifyText);
    if (GetFocus() == &m_record->hotKey) {
        m_record->specify.SetFocus();
    }
    m_record->hotKey.ShowWindow(SW_HIDE);
    refreshKeyState();
    m_record->idle = 1;
}

/// The control takes every key, so that the button cannot be pressed from the keyboard: a key typed twice does it.
void Gui_AccelDlg::OnTypedKey() {
    const Gui_Accel typed = AccelOf(m_record->hotKey);
    const bool isSecond = !typed.IsEmpty() && typed == m_record->typed;
    m_record->typed = typed;
    if (isSecond && !m_record->idle) {
        OnSpecifybutton();
        if (m_record->assign.IsWindowEnabled()) {
            m_record->assign.SetFocus();
        }
    }
}

void Gui_AccelDlg::OnAssignbutton() {
    const Gui_Accel accel = m_record->typedAccel();
    if (accel.IsEmpty()) {
        return;
    }
    unsigned short owner = 0;
    CString note;
    if (m_record->map.GetCmdAt(accel, owner) && owner != accel.cmd) {
        note = KeyMessage(GUI_IDS_KEY_TAKEN, accel.GetKeyText(), m_record->nameOf(owner));
    }
    if (owner != accel.cmd) {
        tvx::allocating([this] { m_record->before.push_back(m_record->map); });
        m_record->map.Add(accel);
    }
    changed(note);
    refreshKeyState();
    fillKeys();
}

void Gui_AccelDlg::OnRemovebutton() {
    const int line = m_record->keyList.GetCurSel();
    if (line < 0) {
        m_record->remove.EnableWindow(FALSE);
        return;
    }
    Gui_Accel accel;
    accel.DecodeFlagsAndKey(static_cast<unsigned long>(m_record->keyList.GetItemData(line)));
    tvx::allocating([this] { m_record->before.push_back(m_record->map); });
    m_record->map.Remove(accel);
    changed(CString());
    refreshKeyState();
    fillKeys();
}
