#include "Options.h"

#include "Drawing.h"

#include <cstdio>

namespace {

constexpr const char* section = "Preferences";

int readNumber(const char* entry, int own, int least, int most) {
    const int value = static_cast<int>(AfxGetApp()->GetProfileInt(section, entry, own));
    return value < least || value > most ? own : value;
}

/// Calls `use` with the name, the field and the bounds of each number: one list for reading and writing.
template <class Use>
void eachNumber(Use&& use) {
    constexpr int white = 0xFFFFFF;
    use("GridShown", &Options::gridShown, 0, 1);
    use("GridDistance", &Options::gridDistance, 0, Options::maxGrid);
    use("Snap", &Options::snap, 0, 1);
    use("Paper", &Options::paper, 0, white);
    use("GridColor", &Options::gridColor, 0, white);
    use("Handles", &Options::handles, 0, white);
    use("Outline", &Options::outline, 0, white);
    use("Filled", &Options::filled, 0, 1);
    use("Fill", &Options::fill, 0, white);
    use("LineWidth", &Options::lineWidth, 1, Options::maxLineWidth);
    use("TextBold", &Options::textBold, 0, 1);
    use("TextItalic", &Options::textItalic, 0, 1);
    use("TextSize", &Options::textSize, board::minTextSize, board::maxTextSize);
    use("ShowStatus", &Options::showStatus, 0, 1);
}

} // namespace

LOGFONT Options::GetTextFont(int height) const {
    LOGFONT font{};
    font.lfHeight = -height;
    font.lfWeight = textBold ? FW_BOLD : FW_NORMAL;
    font.lfItalic = textItalic ? 1 : 0;
    std::snprintf(font.lfFaceName, sizeof font.lfFaceName, "%s", textFont.GetString());
    return font;
}

Options Options::Read() {
    Options options;
    eachNumber([&options](const char* entry, auto field, int least, int most) {
        options.*field = readNumber(entry, static_cast<int>(options.*field), least, most);
    });
    CWinApp* const app = AfxGetApp();
    const CString font = app->GetProfileString(section, "TextFont", options.textFont);
    options.textFont = font.IsEmpty() ? options.textFont : font;
    options.keepCommands = app->GetProfileInt("Settings", "KeepCommands", 1) != 0; // where the console had it first
    return options;
}

void Options::Write(const Options& before) const {
    CWinApp* const app = AfxGetApp();
    eachNumber([&](const char* entry, auto field, int, int) {
        if (this->*field != before.*field) {
            app->WriteProfileInt(section, entry, static_cast<int>(this->*field));
        }
    });
    if (textFont != before.textFont) {
        app->WriteProfileString(section, "TextFont", textFont);
    }
    if (keepCommands != before.keepCommands) {
        app->WriteProfileInt("Settings", "KeepCommands", keepCommands ? 1 : 0);
    }
}
