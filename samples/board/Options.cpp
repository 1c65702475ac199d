#include "Options.h"

#include "Drawing.h"

namespace {

constexpr const char* section = "Preferences";

int readNumber(const char* entry, int own, int least, int most) {
    const int value = static_cast<int>(AfxGetApp()->GetProfileInt(section, entry, own));
    return value < least || value > most ? own : value;
}

/// Calls `use` with the name and the bounds of each number: one list for reading and writing.
template <class Record, class Use>
void eachNumber(Record& options, Use&& use) {
    constexpr int white = 0xFFFFFF;
    use("GridShown", options.gridShown, 0, 1);
    use("GridDistance", options.gridDistance, 0, Options::maxGrid);
    use("Snap", options.snap, 0, 1);
    use("Paper", options.paper, 0, white);
    use("GridColor", options.gridColor, 0, white);
    use("Handles", options.handles, 0, white);
    use("Outline", options.outline, 0, white);
    use("Filled", options.filled, 0, 1);
    use("Fill", options.fill, 0, white);
    use("LineWidth", options.lineWidth, 1, Options::maxLineWidth);
    use("TextSize", options.textSize, board::minTextSize, board::maxTextSize);
    use("ShowStatus", options.showStatus, 0, 1);
}

} // namespace

Options Options::Read() {
    Options options;
    eachNumber(options, [](const char* entry, auto& value, int least, int most) {
        value = readNumber(entry, static_cast<int>(value), least, most);
    });
    CWinApp* const app = AfxGetApp();
    const CString font = app->GetProfileString(section, "TextFont", options.textFont);
    options.textFont = font.IsEmpty() ? options.textFont : font;
    options.keepCommands = app->GetProfileInt("Settings", "KeepCommands", 1) != 0; // where the console had it first
    return options;
}

void Options::Write() const {
    CWinApp* const app = AfxGetApp();
    eachNumber(*this, [app](const char* entry, const auto& value, int, int) {
        app->WriteProfileInt(section, entry, static_cast<int>(value));
    });
    app->WriteProfileString(section, "TextFont", textFont);
    app->WriteProfileInt("Settings", "KeepCommands", keepCommands ? 1 : 0);
}
