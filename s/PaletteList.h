#pragma once

#include "s/CommandFilter.h"
#include "s/MenuCommands.h"

#include <string>
#include <string_view>
#include <vector>

/// One line of a command palette.
struct PaletteEntry {
    MenuCommand command;
    CString title;  ///< "Edit: Bring to Front"
    CString key;    ///< what the menu shows, else the first of its keys
    CString spoken; ///< the line as assistive tools read it: they do not see how it is drawn
    CommandText text;

    [[nodiscard]] bool isEnabled() const {
        return (command.state & (MF_GRAYED | MF_DISABLED)) == 0;
    }
    [[nodiscard]] bool isChecked() const {
        return (command.state & MF_CHECKED) != 0;
    }
};

/// What a command palette offers: the commands of a frame, and which of them fit what was typed, in which order.
class PaletteList {
public:
    /// The commands of the menu that a frame shows, with their states brought up to date through the frame.
    explicit PaletteList(CFrameWnd& frame);

    [[nodiscard]] const std::vector<PaletteEntry>& entries() const {
        return m_entries;
    }
    /// The entries that fit, the best first, of equal ones what was run last, then in the order of the menus.
    [[nodiscard]] std::vector<const PaletteEntry*> matches(std::string_view typed) const;
    /// Remembers, for all palettes of the process, that a command was run.
    static void NoteRun(UINT command);

private:
    std::vector<PaletteEntry> m_entries;
    std::vector<int> m_recent; ///< how recently each was run: larger is later, 0 never
};
