#pragma once

#include "platform/base/Export.h"

#include <array>
#include <string>
#include <vector>

struct Port_Msg;

/// Receives the messages that the portability library, the library and hosts issue: the base of all message managers.
///
/// A host that wants messages derives from `Port_MsgManDefault`, which formats as well, overrides `msgWrite`, and
/// registers an object of that class for the time it wants them:
///
///     Collector collector;
///     Port_MsgDispatcher::addMsgMan(&collector);
///     readDrawing(name);
///     Port_MsgDispatcher::removeMsgMan(&collector);
///
/// Everything runs on the user-interface thread. A manager belongs to whoever made it; one that is destroyed while
/// registered takes itself out of the dispatcher.
class TVX_PLATFORM_API Port_MsgMan {
public:
    /// The kinds of messages. From MsgTypeError up they form the error class.
    enum MsgType {
        MsgTypeDebug = 0,    ///< a trace for developers
        MsgTypeStatus = 1,   ///< what is going on; also the texts of usage summaries
        MsgTypeInfo = 2,     ///< something worth knowing
        MsgTypeWarning = 3,  ///< the work goes on, its result may not be what was wanted
        MsgTypeError = 4,    ///< something asked for could not be done
        MsgTypeInternal = 5, ///< a mistake in the program or in what is installed with it
        MsgTypeFatal = 6     ///< the application cannot go on
    };
    /// The number of types.
    static constexpr int MsgTypeCount = 7;

    /// Whether messages from one place are written.
    enum class MsgSwitch { Off, On };

    /// @param name a name for the manager, copied; may be null.
    explicit Port_MsgMan(const char* name);
    virtual ~Port_MsgMan();
    Port_MsgMan(const Port_MsgMan&) = delete;
    Port_MsgMan& operator=(const Port_MsgMan&) = delete;

    /// The name given to the constructor, empty for none.
    const char* getName() const {
        return m_name.c_str();
    }

    /// Whether the manager takes messages. A disabled one is passed over: the message goes to the manager registered
    /// before it. Managers start enabled.
    bool getEnabled() const {
        return m_enabled;
    }
    /// Makes the manager take messages, or be passed over.
    void setEnabled(bool enabled) {
        m_enabled = enabled;
    }

    /// Whether work should stop: 0 means go on, any other value is the code with which the application should end.
    /// A fatal message sets the flag of the manager that takes it (a code of 0 counts as 1); the flag is only a
    /// request, nothing in the library ends the process. Long operations ask it between their steps.
    int getAbort() const {
        return m_abort;
    }
    /// Sets the flag, for example when the user cancels, or clears it with 0.
    void setAbort(int code) {
        m_abort = code;
    }

    /// How many messages of @p type were written. Those that are switched off do not count.
    int getMsgCount(MsgType type) const;
    /// How many messages of the error class were written.
    int getErrorCount() const;
    /// Begins to count from 0 again.
    void resetMsgCounts() {
        m_counts.fill(0);
    }

    /// Switches messages off or on again by the place that issues them, as named in `Port_MsgManData::createObject`.
    /// Of several settings that concern one message the latest holds. Fatal messages are always written.
    /// @param module the module's name, compared exactly.
    /// @param source the source's name; null or empty means all of the module.
    /// @param line the line that issues the message; 0 means all of the source.
    void setMsgSwitch(const char* module, const char* source, int line, MsgSwitch state);

protected:
    /// Writes one message. Called for every message that the manager takes and that is not switched off. Messages
    /// issued from inside go to the manager registered before this one.
    /// @param text the message as it was issued: no prefix, not wrapped, of any number of lines.
    virtual void msgWrite(MsgType type, const wchar_t* text) = 0;

private:
    friend class Port_MsgDispatcher;

    struct Switch {
        std::string module;
        std::string source;
        int line;
        MsgSwitch state;
    };

    bool isReady() const;
    bool isSwitchedOff(const Port_Msg& msg) const;
    void take(const Port_Msg& msg);

    std::string m_name;
    bool m_enabled = true;
    bool m_writing = false;
    int m_abort = 0;
    std::array<int, MsgTypeCount> m_counts{};
    std::vector<Switch> m_switches;
};

/// The message manager with formatting. Registered or not, one object of this class takes the messages that nobody else
/// wants: it writes status and info messages to standard output and all others to standard error.
class TVX_PLATFORM_API Port_MsgManDefault : public Port_MsgMan {
public:
    /// @param name a name for the manager, copied; may be null.
    explicit Port_MsgManDefault(const char* name = nullptr);
    ~Port_MsgManDefault() override;

    /// Whether messages are written without the prefix that names their type. Off at first.
    bool getClean() const {
        return m_clean;
    }
    /// Turns the prefixes off, or on again with false.
    void setClean(bool clean) {
        m_clean = clean;
    }

    /// The width in columns at which lines are wrapped; 80 at first. 0 or less means that they are not.
    int getMaxLineWidth() const {
        return m_maxLineWidth;
    }
    /// Sets the width for the messages that follow.
    void setMaxLineWidth(int columns) {
        m_maxLineWidth = columns;
    }

    /// Turns a message into lines.
    ///
    /// The text gets the prefix of its type ("Error: ", "Warning: ", ...; status messages have none) unless @p clean,
    /// and is wrapped between words so that no line is wider than @p width columns. East-Asian wide characters take two
    /// columns, combining marks none. A word wider than a line is cut. Line feeds in the text stay; the continuation of
    /// an indented line is indented alike.
    /// @param width in columns; 0 or less leaves lines as long as they are.
    /// @param text may be null or empty, which gives no line at all.
    /// @param count receives the number of lines; must not be null.
    /// @return the lines, each ending with a line feed, the last one too. The caller frees them with
    ///     `UT_STR::WDelStrings(lines, count)`. Null when there is no line.
    static wchar_t** msgFormat(MsgType type, bool clean, int width, const wchar_t* text, int* count);

protected:
    /// Formats the message with the manager's settings and writes it to standard output or standard error.
    void msgWrite(MsgType type, const wchar_t* text) override;

private:
    bool m_clean = false;
    int m_maxLineWidth = 80;
};
