#include "s/PaletteList.h"

#include "platform/base/Text.h"
#include "res/resource.h"
#include "s/KeyIndex.h"
#include "s/KeyTexts.h"
#include "s/StringOf.h"

#include <algorithm>

namespace {

constexpr std::size_t mostRecent = 50;

/// The commands that were run, the last one last.
std::vector<UINT>& recentCommands() {
    static std::vector<UINT> commands;
    return commands;
}

/// Has the frame's handlers set the states of all items, as they would before each popup is shown.
void updateStates(const CFrameWnd& frame, const CMenu& menu) {
    for (int item = 0; item < static_cast<int>(menu.GetMenuItemCount()); ++item) {
        if (const HMENU popup = GetSubMenu(menu, item)) {
            frame.SendMessage(WM_INITMENUPOPUP, reinterpret_cast<WPARAM>(popup), MAKELPARAM(item, FALSE));
            if (const CMenu* inner = CMenu::FromHandle(popup)) {
                updateStates(frame, *inner);
            }
        }
    }
}

KeyIndex keysInForce(CFrameWnd& frame) {
    Gui_AccelMap map(frame.m_hAccelTable);
    map.AddAll(frame.GetDefaultAccelerator()); // a document's go before
    return KeyIndex(map);
}

/// What the lines of all commands are made with, looked up once.
struct Words {
    KeyTexts keys;
    CString checked;
    CString disabled;
};

CString spokenText(const PaletteEntry& entry, const Words& words) {
    CString text = entry.title;
    for (const auto& [applies, addition] : {std::pair(!entry.key.IsEmpty(), &entry.key),
                                            {entry.isChecked(), &words.checked},
                                            {!entry.isEnabled(), &words.disabled}}) {
        if (applies) {
            text += ", " + *addition;
        }
    }
    return text;
}

PaletteEntry entryOf(MenuCommand command, const KeyIndex& keys, Words& words) {
    PaletteEntry entry;
    const CString name = command.label.Mid(command.nameStart);
    const CString menus = command.label.Left(command.nameStart).Trim();
    entry.title = menus.IsEmpty() ? name : menus + ": " + name;
    entry.key = command.shortCut;
    const auto all = keys.keysOf(command.id);
    if (entry.key.IsEmpty() && !all.empty()) {
        entry.key = words.keys.textOf(all.front());
    }
    entry.text.label = tvx::text::foldCase(menus.View());
    entry.text.label += ' ';
    entry.text.nameStart = entry.text.label.size();
    entry.text.label += tvx::text::foldCase(name.View());
    entry.text.key = tvx::text::foldCase(entry.key.View());
    entry.command = std::move(command);
    entry.spoken = spokenText(entry, words);
    return entry;
}

} // namespace

PaletteList::PaletteList(CFrameWnd& frame) {
    CMenu* menu = frame.GetMenu();
    if (!menu) {
        return;
    }
    frame.SendMessage(WM_INITMENU, reinterpret_cast<WPARAM>(menu->m_hMenu));
    updateStates(frame, *menu);
    const KeyIndex keys = keysInForce(frame);
    Words words;
    words.checked = StringOf(GUI_IDS_PALETTE_CHECKED);
    words.disabled = StringOf(GUI_IDS_PALETTE_DISABLED);
    tvx::allocating([&] {
        const std::vector<UINT>& recent = recentCommands();
        for (MenuCommand& command : CommandsOf(frame.GetMenu())) {
            const auto run = std::find(recent.begin(), recent.end(), command.id);
            m_recent.push_back(run != recent.end() ? static_cast<int>(run - recent.begin()) + 1 : 0);
            m_entries.push_back(entryOf(std::move(command), keys, words));
        }
    });
}

std::vector<const PaletteEntry*> PaletteList::matches(std::string_view typed) const {
    const std::vector<std::string> words = FoldedWords(typed);
    struct Match {
        const PaletteEntry* entry;
        int rank, recent;
    };
    std::vector<Match> found;
    for (std::size_t i = 0; i < m_entries.size(); ++i) {
        if (const int rank = MatchRank(m_entries[i].text, words); rank > 0) {
            found.push_back({&m_entries[i], rank, m_recent[i]});
        }
    }
    std::stable_sort(found.begin(), found.end(), [](const Match& a, const Match& b) {
        return a.rank != b.rank ? a.rank > b.rank : a.recent > b.recent;
    });
    std::vector<const PaletteEntry*> entries;
    entries.reserve(found.size());
    std::transform(found.begin(), found.end(), std::back_inserter(entries),
                   [](const Match& match) { return match.entry; });
    return entries;
}

void PaletteList::NoteRun(UINT command) {
    std::vector<UINT>& recent = recentCommands();
    std::erase(recent, command);
    recent.push_back(command);
    if (recent.size() > mostRecent) {
        recent.erase(recent.begin());
    }
}
