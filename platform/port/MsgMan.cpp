#include "platform/port/MsgMan.h"

#include "platform/port/File.h"
#include "platform/port/MsgDispatcher.h"
#include "platform/port/Str.h"
#include "platform/port/detail/MsgFormat.h"

#include <algorithm>
#include <iterator>
#include <memory>
#include <vector>

namespace {

const wchar_t* prefixOf(Port_MsgMan::MsgType type) {
    switch (type) {
    case Port_MsgMan::MsgTypeDebug:
        return L"Debug: ";
    case Port_MsgMan::MsgTypeStatus:
        return L"";
    case Port_MsgMan::MsgTypeInfo:
        return L"Info: ";
    case Port_MsgMan::MsgTypeWarning:
        return L"Warning: ";
    case Port_MsgMan::MsgTypeError:
        return L"Error: ";
    case Port_MsgMan::MsgTypeInternal:
        return L"Internal error: ";
    case Port_MsgMan::MsgTypeFatal:
        return L"Fatal error: ";
    }
    return L"";
}

bool goesToStandardOutput(Port_MsgMan::MsgType type) {
    return type == Port_MsgMan::MsgTypeStatus || type == Port_MsgMan::MsgTypeInfo;
}

std::vector<std::wstring> formatLines(Port_MsgMan::MsgType type, bool clean, int width, const wchar_t* text) {
    if (!text || !*text) {
        return {};
    }
    return Port::detail::wrapText((clean ? L"" : prefixOf(type)) + std::wstring(text), width);
}

std::unique_ptr<wchar_t[]> newLine(const std::wstring& text) {
    auto line = std::make_unique<wchar_t[]>(text.size() + 2);
    wchar_t* end = std::copy(text.begin(), text.end(), line.get());
    end[0] = L'\n';
    end[1] = L'\0';
    return line;
}

/// Sets a flag for as long as it lives.
class Flagged {
public:
    explicit Flagged(bool& flag) : m_flag(flag) {
        m_flag = true;
    }
    ~Flagged() {
        m_flag = false;
    }
    Flagged(const Flagged&) = delete;
    Flagged& operator=(const Flagged&) = delete;

private:
    bool& m_flag;
};

} // namespace

Port_MsgMan::Port_MsgMan(const char* name) : m_name(name ? name : "") {}

Port_MsgMan::~Port_MsgMan() {
    Port_MsgDispatcher::removeMsgMan(this);
}

int Port_MsgMan::getMsgCount(MsgType type) const {
    return m_counts.at(type);
}

int Port_MsgMan::getErrorCount() const {
    return m_counts[MsgTypeError] + m_counts[MsgTypeInternal] + m_counts[MsgTypeFatal];
}

void Port_MsgMan::setMsgSwitch(const char* module, const char* source, int line, MsgSwitch state) {
    const Switch added{module ? module : "", source ? source : "", line, state};
    std::erase_if(m_switches, [&](const Switch& known) {
        return known.module == added.module && known.source == added.source && known.line == added.line;
    });
    m_switches.push_back(added);
}

bool Port_MsgMan::isReady() const {
    return m_enabled && !m_writing;
}

bool Port_MsgMan::isSwitchedOff(const Port_Msg& msg) const {
    if (msg.type == MsgTypeFatal) {
        return false;
    }
    const auto latest = std::find_if(m_switches.rbegin(), m_switches.rend(), [&](const Switch& known) {
        return known.module == msg.module && (known.source.empty() || known.source == msg.source) &&
               (known.line == 0 || known.line == msg.line);
    });
    return latest != m_switches.rend() && latest->state == MsgSwitch::Off;
}

void Port_MsgMan::take(const Port_Msg& msg) {
    if (msg.type == MsgTypeFatal) {
        m_abort = msg.code != 0 ? msg.code : 1;
    }
    if (isSwitchedOff(msg)) {
        return;
    }
    ++m_counts.at(msg.type);
    const Flagged writing(m_writing);
    msgWrite(msg.type, msg.text.c_str());
}

Port_MsgManDefault::Port_MsgManDefault(const char* name) : Port_MsgMan(name) {}

Port_MsgManDefault::~Port_MsgManDefault() = default;

wchar_t** Port_MsgManDefault::msgFormat(MsgType type, bool clean, int width, const wchar_t* text, int* count) {
    const std::vector<std::wstring> lines = formatLines(type, clean, width, text);
    *count = static_cast<int>(lines.size());
    if (lines.empty()) {
        return nullptr;
    }
    // Owned until the heap has given all of them.
    std::vector<std::unique_ptr<wchar_t[]>> made;
    made.reserve(lines.size());
    std::transform(lines.begin(), lines.end(), std::back_inserter(made), newLine);
    auto** array = new wchar_t*[lines.size()];
    std::transform(made.begin(), made.end(), array, [](auto& line) { return line.release(); });
    return array;
}

void Port_MsgManDefault::msgWrite(MsgType type, const wchar_t* text) {
    std::string out;
    for (const std::wstring& line : formatLines(type, m_clean, m_maxLineWidth, text)) {
        out += UT_STR::WstrToMbstr(line.c_str()) + '\n';
    }
    (goesToStandardOutput(type) ? Port::File::getCout() : Port::File::getCerr()) << out;
}
