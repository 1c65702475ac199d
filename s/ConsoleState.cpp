#include "s/ConsoleState.h"

#include "platform/win/Registry.h"
#include "s/Profile.h"

namespace {

/// The value that keeps the texts, one a line. A backslash in a text is doubled, a line end becomes "\n".
constexpr const char* recallEntry = "ConsoleRecall";
constexpr std::size_t mostTexts = 500;
constexpr int longestText = 4000; // longer ones were pasted, not typed

CString Escaped(const CString& text) {
    CString line(text);
    line.Replace("\\", "\\\\");
    line.Replace("\r", "\\r");
    line.Replace("\n", "\\n");
    return line;
}

CString Unescaped(const CString& line) {
    CString text;
    for (int i = 0; i < line.GetLength(); ++i) {
        const char next = line[i] == '\\' && i + 1 < line.GetLength() ? line[++i] : '\0';
        switch (next) {
        case '\0':
            text += line[i];
            break;
        case 'n':
            text += '\n';
            break;
        case 'r':
            text += '\r';
            break;
        default:
            text += next;
        }
    }
    return text;
}

/// Holds the mark of a running command, also when the host throws.
class Running {
public:
    Running() {
        ConsoleState().m_isRunning = true;
    }
    ~Running() {
        ConsoleState().m_isRunning = false;
    }
    Running(const Running&) = delete;
    Running& operator=(const Running&) = delete;
};

} // namespace

Gui_ConsoleState& ConsoleState() {
    static Gui_ConsoleState state;
    return state;
}

int ResolveAndRunCommand(const char* input) {
    Gui_ConsoleState& state = ConsoleState();
    if (state.m_isRunning) {
        return -1;
    }
    if (!state.m_history) {
        return 1;
    }
    const Gui_ConsoleHistory::Resolved resolved = state.m_history->Resolve(input);
    if (resolved.message != 0) {
        AfxMessageBox(resolved.message, MB_OK | MB_ICONEXCLAMATION, resolved.message);
    }
    if (!resolved.runs || !state.m_callback) {
        return 1;
    }
    int result = 0;
    {
        const Running running;
        result = state.m_callback(resolved.command);
    }
    if (result == 1 && state.m_keepsRecall) {
        KeepRecallText(resolved.command);
    }
    return result;
}

std::vector<CString> ReadRecallTexts() {
    CString kept;
    Gui_Profile::ReadString(kept, recallEntry, nullptr);
    std::vector<CString> texts;
    int at = 0;
    for (CString line = kept.Tokenize("\n", at); at != -1; line = kept.Tokenize("\n", at)) {
        texts.push_back(Unescaped(line));
    }
    return texts;
}

// Read and written together, so that programs that run side by side keep each other's texts.
void KeepRecallText(const CString& text) {
    if (text.GetLength() > longestText) {
        return;
    }
    tvx::RegistryTransaction together;
    if (together.begin() != ERROR_SUCCESS) {
        return;
    }
    std::vector<CString> texts = ReadRecallTexts();
    if (!texts.empty() && texts.back() == text) {
        return;
    }
    texts.push_back(text);
    CString kept;
    for (std::size_t i = texts.size() > mostTexts ? texts.size() - mostTexts : 0; i < texts.size(); ++i) {
        kept += Escaped(texts[i]) + "\n";
    }
    Gui_Profile::WriteString(kept, recallEntry, nullptr);
    (void)together.commit();
}

void ForgetRecallTexts() {
    Gui_Profile::WriteString(nullptr, recallEntry, nullptr);
}
