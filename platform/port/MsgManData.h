#pragma once

#include "platform/base/Export.h"
#include "platform/port/MsgMan.h"

#include <cstdarg>
#include <string>

/// Says where a message comes from and issues it:
///
///     Port_MsgManData::createObject("GuiUtilities", "../s/HelpMap", __LINE__, "$Revision")
///         .issueError("Cannot read file %s .\n", name);
///
/// The formats are those of `printf`, checked by the compiler, with "." as decimal point whatever the locale. Texts are
/// in UTF-8; broken sequences pass through as they are. A line feed at the end of a format is optional.
class TVX_PLATFORM_API Port_MsgManData {
public:
    /// The origin of the messages issued through the result. Null counts as an empty text.
    /// @param module the program or library, for example "GuiUtilities".
    /// @param source the source file, for example "../s/WinApp"; with the module it is what messages are switched off
    /// by.
    /// @param line the line of the call.
    /// @param revision the source's revision, for debuggers; it is not shown.
    static Port_MsgManData createObject(const char* module, const char* source, int line, const char* revision);

    /// Says what is going on, or what the user asked for.
    [[gnu::format(printf, 2, 3)]] void issueStatus(const char* format, ...) const;
    /// Says something worth knowing.
    [[gnu::format(printf, 2, 3)]] void issueInfo(const char* format, ...) const;
    /// Says that the work goes on although its result may not be what was wanted.
    [[gnu::format(printf, 2, 3)]] void issueWarning(const char* format, ...) const;
    /// Says what could not be done, so that the user can do something about it.
    [[gnu::format(printf, 2, 3)]] void issueError(const char* format, ...) const;
    /// For mistakes of the program or its installation rather than of its user.
    [[gnu::format(printf, 2, 3)]] void issueInternal(const char* format, ...) const;
    /// For what the application cannot survive. The message is shown and sets the manager's abort flag; ending the
    /// application is up to the caller.
    /// @param code the code with which the application is about to end.
    [[gnu::format(printf, 3, 4)]] void issueFatal(int code, const char* format, ...) const;

    /// Issues a trace for developers, without an origin, when the environment variable `TVX_MSG_DEBUG` is set; does
    /// nothing otherwise.
    [[gnu::format(printf, 1, 2)]] static void debugStub(const char* format, ...);

private:
    Port_MsgManData(const char* module, const char* source, int line, const char* revision);
    void issue(Port_MsgMan::MsgType type, int code, const char* format, std::va_list arguments) const;

    std::string m_module;
    std::string m_source;
    int m_line;
    std::string m_revision;
};
