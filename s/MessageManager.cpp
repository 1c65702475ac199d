#include "s/MessageManager.h"

#include "afxwin.h"
#include "platform/port/File.h"
#include "platform/port/Str.h"
#include "platform/port/Stream.h"
#include "s/Record.h"

struct Gui_MessageManager::Callbacks {
    Callback error;
    Callback status;
};

Gui_MessageManager::Gui_MessageManager() : Gui_MessageManager(nullptr, nullptr) {}

Gui_MessageManager::Gui_MessageManager(Callback errorCallback, Callback statusCallback)
    : Port_MsgManDefault(nullptr), m_callbacks(MakeRecord<Callbacks>(errorCallback, statusCallback)) {}

Gui_MessageManager::~Gui_MessageManager() = default;

namespace {

/// The lines that a message is shown in, as the formatting hands them over.
class Lines {
public:
    wchar_t** array = nullptr;
    int count = 0;

    Lines() = default;
    ~Lines() {
        UT_STR::WDelStrings(array, count);
    }
    Lines(const Lines&) = delete;
    Lines& operator=(const Lines&) = delete;

    CString joined() const {
        CString text;
        for (int i = 0; i < count; ++i) {
            text += UT_STR::WstrToMbstr(array[i]).c_str();
        }
        return text;
    }
};

} // namespace

void Gui_MessageManager::msgWrite(MsgType type, const wchar_t* text) {
    const CString out = tvx::allocating([&] {
        Lines lines;
        lines.array = msgFormat(type, getClean(), getMaxLineWidth(), text, &lines.count);
        return lines.joined();
    });
    if (type >= MsgTypeError && type <= MsgTypeFatal) {
        writeError(out);
    } else {
        writeStatus(out);
    }
}

void Gui_MessageManager::writeError(const CString& text) const {
    if (m_callbacks->error) {
        m_callbacks->error(text);
    } else {
        AfxMessageBox(text, MB_ICONERROR);
    }
}

void Gui_MessageManager::writeStatus(const CString& text) const {
    for (int start = 0; start < text.GetLength();) {
        const int end = text.Find('\n', start);
        const CString line = end < 0 ? text.Mid(start) : text.Mid(start, end - start);
        if (m_callbacks->status) {
            m_callbacks->status(line);
        } else {
            Port::File::getCout() << line.GetString() << Port::Stream::endl;
        }
        start = end < 0 ? text.GetLength() : end + 1;
    }
}
