#include "s/Msg.h"

#include "afxcoll.h"
#include "platform/base/Text.h"
#include "s/Record.h"

#include <string>
#include <string_view>

struct Gui_Msg::Record {
    CString format;
    CString value; ///< the expanded text; empty means not yet expanded
    CStringArray parameters;
};

namespace {

void appendParameter(std::string& text, char marker, const CStringArray& parameters) {
    const INT_PTR index = marker - '1';
    if (index >= 0 && index <= 8 && index < parameters.GetSize()) {
        text += parameters[index].View();
    } else {
        text += "???";
    }
}

std::string expand(std::string_view format, const CStringArray& parameters) {
    std::string text;
    std::size_t start = 0;
    for (std::size_t at = format.find('%'); at != std::string_view::npos; at = format.find('%', start)) {
        text += format.substr(start, at - start);
        start = at + 1;
        appendParameter(text, start < format.size() ? format[start] : '\0', parameters);
        start += tvx::text::characterLength(format, start);
    }
    return text += format.substr(start);
}

} // namespace

Gui_Msg::Gui_Msg() : m_record(MakeRecord<Record>()) {}

Gui_Msg::Gui_Msg(const char* format) : Gui_Msg() {
    SetFormat(format);
}

Gui_Msg::Gui_Msg(unsigned int id, HINSTANCE module) : Gui_Msg() {
    SetFormat(id, module);
}

Gui_Msg::~Gui_Msg() = default;

void Gui_Msg::SetFormat(const char* format) {
    m_record->format = format;
    ClearParameters();
}

void Gui_Msg::SetFormat(unsigned int id, HINSTANCE module) {
    if (!m_record->format.LoadString(module, id) && module) {
        m_record->format.Empty();
    }
    ClearParameters();
}

void Gui_Msg::ClearParameters() {
    m_record->parameters.RemoveAll();
    m_record->value.Empty();
}

Gui_Msg& Gui_Msg::operator<<(const char* text) {
    m_record->parameters.Add(CString(text));
    return *this;
}

Gui_Msg& Gui_Msg::operator<<(int number) {
    m_record->parameters.Add(Format("%d", number));
    return *this;
}

CString Gui_Msg::GetValue() {
    return expanded();
}

Gui_Msg::operator const char*() {
    return expanded();
}

const CString& Gui_Msg::expanded() {
    Record& record = *m_record;
    if (record.value.IsEmpty()) {
        tvx::allocating([&] { record.value = CString(expand(record.format.View(), record.parameters)); });
    }
    return record.value;
}

CString Gui_Msg::Format(const char* format, int number) {
    CString text;
    text.Format(format ? format : "", number);
    return text;
}
