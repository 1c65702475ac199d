#include "platform/port/MsgManData.h"

#include "platform/base/Text.h"
#include "platform/port/Env.h"
#include "platform/port/MsgDispatcher.h"

namespace {

const char* orEmpty(const char* text) {
    return text ? text : "";
}

} // namespace

// Every operation has to open and close its own argument list, so they share what can be shared only by a macro.
#define ISSUE(type, code)                                                                                              \
    std::va_list arguments;                                                                                            \
    va_start(arguments, format);                                                                                       \
    issue(Port_MsgMan::type, code, format, arguments);                                                                 \
    va_end(arguments)

Port_MsgManData::Port_MsgManData(const char* module, const char* source, int line, const char* revision)
    : m_module(orEmpty(module)), m_source(orEmpty(source)), m_line(line), m_revision(orEmpty(revision)) {}

Port_MsgManData Port_MsgManData::createObject(const char* module, const char* source, int line, const char* revision) {
    return {module, source, line, revision};
}

void Port_MsgManData::issue(Port_MsgMan::MsgType type, int code, const char* format, std::va_list arguments) const {
    Port_MsgDispatcher::dispatch(
        {type, code, m_module, m_source, m_line, tvx::text::widen(tvx::text::formatV(format, arguments))});
}

void Port_MsgManData::issueStatus(const char* format, ...) const {
    ISSUE(MsgTypeStatus, 0);
}

void Port_MsgManData::issueInfo(const char* format, ...) const {
    ISSUE(MsgTypeInfo, 0);
}

void Port_MsgManData::issueWarning(const char* format, ...) const {
    ISSUE(MsgTypeWarning, 0);
}

void Port_MsgManData::issueError(const char* format, ...) const {
    ISSUE(MsgTypeError, 0);
}

void Port_MsgManData::issueInternal(const char* format, ...) const {
    ISSUE(MsgTypeInternal, 0);
}

void Port_MsgManData::issueFatal(int code, const char* format, ...) const {
    ISSUE(MsgTypeFatal, code);
}

void Port_MsgManData::debugStub(const char* format, ...) {
    if (!Port_Env::GetEnv("TVX_MSG_DEBUG")) {
        return;
    }
    std::va_list arguments;
    va_start(arguments, format);
    createObject("", "", 0, "").issue(Port_MsgMan::MsgTypeDebug, 0, format, arguments);
    va_end(arguments);
}
