#include "s/MenuStr.h"

#include "platform/base/Text.h"
#include "s/Record.h"

#include <string>
#include <string_view>

namespace {

constexpr std::size_t longestText = 99;     // characters
constexpr std::size_t longestCharacter = 4; // bytes

CString itemText(const CMenu* menu, int item, unsigned int flags) {
    char buffer[longestText * longestCharacter + 1] = "";
    const int size = menu ? menu->GetMenuString(static_cast<UINT>(item), buffer, sizeof buffer, flags) : 0;
    const std::string_view whole(buffer, static_cast<std::size_t>(size));
    std::size_t end = whole.size();
    if (end > longestText) {
        end = 0;
        for (std::size_t count = 0; count < longestText && end < whole.size(); ++count) {
            end += tvx::text::characterLength(whole, end);
        }
    }
    return CString(whole.substr(0, end));
}

} // namespace

Gui_MenuStr::Gui_MenuStr() : m_text(MakeRecord<CString>()) {}

Gui_MenuStr::Gui_MenuStr(const char* text) : m_text(MakeRecord<CString>(text)) {}

Gui_MenuStr::Gui_MenuStr(const CMenu* menu, int item, unsigned int flags)
    : m_text(MakeRecord<CString>(itemText(menu, item, flags))) {}

Gui_MenuStr::~Gui_MenuStr() = default;

void Gui_MenuStr::SetText(const char* text) {
    *m_text = text;
}

void Gui_MenuStr::SetText(const CMenu* menu, int item, unsigned int flags) {
    *m_text = itemText(menu, item, flags);
}

CString Gui_MenuStr::GetText() const {
    return *m_text;
}

Gui_MenuStr::operator const char*() const {
    return *m_text;
}

int Gui_MenuStr::GetLength() const {
    return m_text->GetLength();
}

CString Gui_MenuStr::GetCommandText() const {
    const std::string_view text = m_text->View();
    std::string command;
    std::size_t end = text.size();
    std::size_t at = 0;
    while (at < end) {
        if (text[at] == '\t') {
            end = at;
            break;
        }
        if (text[at] == '&') {
            if (at > 0 && text[at - 1] == '(') {
                end = at - 1;
                command.pop_back();
                break;
            }
            ++at; // what follows is text, whatever it is
        }
        const std::size_t length = tvx::text::characterLength(text, at);
        command += text.substr(at, length);
        at += length;
    }
    return end == 0 ? *m_text : CString(command);
}

CString Gui_MenuStr::GetAccessKeyText() const {
    const std::string_view text = m_text->View();
    const std::size_t mark = text.find('&');
    if (mark == std::string_view::npos) {
        return {};
    }
    return CString(text.substr(mark + 1, tvx::text::characterLength(text, mark + 1)));
}

CString Gui_MenuStr::GetShortCutKeyText() const {
    const int tab = m_text->Find('\t');
    return tab < 0 ? CString() : m_text->Mid(tab + 1);
}

void Gui_MenuStr::SetCommandText(const char* text) {
    *m_text = CString(text) + "\t" + GetShortCutKeyText();
}

void Gui_MenuStr::SetShortCutKeyText(const char* text) {
    const CString shortCut(text); // which may be a part of this text
    ClearShortCutKeyText();
    m_text->AppendChar('\t');
    m_text->Append(shortCut);
}

void Gui_MenuStr::ClearShortCutKeyText() {
    const int tab = m_text->Find('\t');
    if (tab >= 0) {
        m_text->Truncate(tab);
    }
}
