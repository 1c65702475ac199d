#include "s/HelpTrace.h"

#include "afxwin.h"
#include "s/Msg.h"

CString KeywordOf(unsigned long data, const char* without) {
    return data != 0 ? reinterpret_cast<const char*>(data) : without;
}

namespace {

/// The trace up to the map file.
CString requestText(unsigned long data, unsigned int command) {
    Gui_Msg text;
    const int number = static_cast<int>(data);
    switch (command) {
    case HELP_CONTEXT: {
        CString context;
        context.Format("0x%x", static_cast<unsigned int>(data));
        text.SetFormat("HELP_CONTEXT nCmd: %1 Help Id requested : %2\nCheck .hm file for %3");
        text << HELP_CONTEXT << number << context;
        break;
    }
    case HELP_CONTENTS:
        text.SetFormat("HELP_CONTENTS nCmd: %1 dwData: %2");
        text << HELP_CONTENTS << number;
        break;
    case HELP_FINDER:
        text.SetFormat("HELP_FINDER nCmd: %1 dwData: %2");
        text << HELP_FINDER << number;
        break;
    case HELP_KEY:
        text.SetFormat("HELP_KEY nCmd: %1 dwData LPCTSTR value : %2");
        text << HELP_KEY << KeywordOf(data, "NULL");
        break;
    default:
        text.SetFormat("Unsupported nCmd: %1 dwData value : %2");
        text << static_cast<int>(command) << number;
        break;
    }
    return text.GetValue();
}

} // namespace

void ShowHelpTrace(unsigned long data, unsigned int command, const char* mapFile) {
    AfxMessageBox(requestText(data, command) + " Map File: " + mapFile);
}
