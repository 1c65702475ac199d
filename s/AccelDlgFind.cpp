#include "platform/base/Text.h"
#include "res/resource.h"
#include "s/AccelDlg.h"
#include "s/AccelDlgRecord.h"
#include "s/CommandFilter.h"
#include "s/KeyIndex.h"
#include "s/KeyTexts.h"
#include "s/StringOf.h"

#include <algorithm>

// Finding commands, and ways back.

// The filter

namespace {

/// What the filter looks at, command by command.
std::vector<std::string> textsOf(const std::vector<MenuCommand>& commands, const KeyIndex& keys) {
    std::vector<std::string> texts;
    KeyTexts names;
    texts.reserve(commands.size());
    for (const MenuCommand& command : commands) {
        std::string text(command.label.View());
        for (const Gui_Accel& accel : keys.keysOf(command.id)) {
            text += '\n';
            text += names.textOf(accel).View();
        }
        texts.push_back(tvx::text::foldCase(text));
    }
    return texts;
}

} // namespace

void Gui_AccelDlg::fillCommands() {
    Record& record = *m_record;
    const std::optional<int> selected = record.selected();
    CString typed;
    record.filter.GetWindowText(typed);
    const std::vector<std::string> words = FoldedWords(typed.View());
    if (!words.empty() && record.filterTexts.empty()) {
        tvx::allocating([&] { record.filterTexts = textsOf(record.commands, KeyIndex(record.map)); });
    }
    record.commandList.ResetContent();
    record.shown.clear();
    for (int i = 0; i < static_cast<int>(record.commands.size()); ++i) {
        const auto place = static_cast<std::size_t>(i);
        if (!words.empty() && !HasAllWords(record.filterTexts[place], words)) {
            continue;
        }
        const int line = record.commandList.InsertString(-1, record.commands[place].label);
        record.commandList.SetItemData(line, record.commands[place].id);
        tvx::allocating([&] { record.shown.push_back(i); });
        if (selected == i) {
            record.commandList.SetCurSel(line);
        }
    }
    if (selected && !record.selected()) {
        OnSelchangeCommandlist();
        OnSelchangeCurrentkeylist();
    }
}

void Gui_AccelDlg::OnChangeFilter() {
    fillCommands();
}

void Gui_AccelDlg::select(int command) {
    Record& record = *m_record;
    if (std::find(record.shown.begin(), record.shown.end(), command) == record.shown.end()) {
        record.filter.SetWindowText(""); // which fills the list
    }
    const auto found = std::find(record.shown.begin(), record.shown.end(), command);
    record.commandList.SetCurSel(static_cast<int>(found - record.shown.begin()));
    record.commandList.SetFocus();
    OnSelchangeCommandlist();
}

// Finding by key

namespace {

/// The accelerator of a map that a key press fires: that of the key, or the one of a character with the same name.
/// Empty for none.
Gui_Accel ownerOf(const Gui_AccelMap& map, Gui_Accel pressed) {
    if (map.GetCmdAt(pressed, pressed.cmd)) {
        return pressed;
    }
    const CString name = pressed.GetKeyText();
    const std::vector<Gui_Accel> all = AccelsOf(map);
    const auto found = std::find_if(all.begin(), all.end(), [&name](const Gui_Accel& accel) {
        return (accel.fVirt & FVIRTKEY) == 0 && accel.GetKeyText().CompareNoCase(name) == 0;
    });
    return found != all.end() ? *found : Gui_Accel();
}

} // namespace

void Gui_AccelDlg::OnFindKey() {
    setNote(m_record->finding ? CString() : StringOf(GUI_IDS_KEY_FIND));
    showFindField(!m_record->finding);
}

/// While a key is looked for, a field for it stands in the place of the filter.
void Gui_AccelDlg::showFindField(bool show) {
    CWnd& field = m_record->findField;
    m_record->finding = show;
    m_record->findField.SetHotKey(0, 0);
    if (!show && GetFocus() == &field) {
        GetDlgItem(GUI_IDC_ACCEL_FIND_KEY)->SetFocus();
    }
    m_record->filter.ShowWindow(show ? SW_HIDE : SW_SHOW);
    field.ShowWindow(show ? SW_SHOW : SW_HIDE);
    if (show) {
        field.SetFocus();
    }
}

void Gui_AccelDlg::OnKeyToFind() {
    const Gui_Accel pressed = AccelOf(m_record->findField);
    if (m_record->finding && !pressed.IsEmpty()) {
        showFindField(false);
        findKey(pressed);
    }
}

BOOL Gui_AccelDlg::PreTranslateMessage(MSG* message) {
    const HWND button = ::GetDlgItem(m_hWnd, GUI_IDC_ACCEL_FIND_KEY);
    if (m_record->finding && message->message == WM_LBUTTONDOWN && message->hwnd != m_record->findField.m_hWnd &&
        message->hwnd != button) {
        OnFindKey();
    }
    // Enter goes on to what was found, where a dialog would end.
    const bool goesDown =
        message->message == WM_KEYDOWN && (message->wParam == VK_RETURN || message->wParam == VK_DOWN);
    if (goesDown && GetFocus() == &m_record->filter) {
        if (!m_record->shown.empty()) {
            select(m_record->selected().value_or(m_record->shown.front()));
        }
        return TRUE;
    }
    return CDialog::PreTranslateMessage(message);
}

void Gui_AccelDlg::findKey(const Gui_Accel& pressed) {
    Record& record = *m_record;
    const Gui_Accel owner = ownerOf(record.map, pressed);
    if (owner.IsEmpty()) {
        setNote(record.ownerText(pressed));
        return;
    }
    const auto found = std::find_if(record.commands.begin(), record.commands.end(),
                                    [&owner](const MenuCommand& command) { return command.id == owner.cmd; });
    setNote(KeyMessage(GUI_IDS_KEY_ASSIGNED, owner.GetKeyText(), record.nameOf(owner.cmd)));
    if (found == record.commands.end()) {
        return;
    }
    select(static_cast<int>(found - record.commands.begin()));
    record.keyList.SetCurSel(record.keyList.FindStringExact(-1, owner.GetKeyText()));
    OnSelchangeCurrentkeylist();
}

// Undo and Reset

void Gui_AccelDlg::setNote(const CString& text) {
    SetDlgItemText(GUI_IDC_ACCEL_NOTE, text);
}

void Gui_AccelDlg::changed(const CString& note) {
    m_record->filterTexts.clear();
    setNote(note);
    EnableButton(*GetDlgItem(GUI_IDC_ACCEL_UNDO), !m_record->before.empty(), m_record->commandList);
    EnableButton(*GetDlgItem(GUI_IDC_ACCEL_RESET), !m_record->map.IsSame(m_record->resetTo), m_record->commandList);
}

void Gui_AccelDlg::restore(const Gui_AccelMap& map) {
    m_record->map = map;
    changed(CString());
    refreshKeyState();
    fillKeys();
}

void Gui_AccelDlg::OnUndo() {
    if (!m_record->before.empty()) {
        const Gui_AccelMap last = m_record->before.back();
        m_record->before.pop_back();
        restore(last);
    }
}

void Gui_AccelDlg::OnReset() {
    tvx::allocating([this] { m_record->before.push_back(m_record->map); });
    restore(m_record->resetTo);
}
