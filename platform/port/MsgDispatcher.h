#pragma once

#include "platform/base/Export.h"
#include "platform/port/MsgMan.h"

#include <string>

/// One message on its way to a manager.
struct Port_Msg {
    Port_MsgMan::MsgType type = Port_MsgMan::MsgTypeStatus;
    int code = 0;       ///< of a fatal message: the code with which the application is about to end
    std::string module; ///< where it was issued: the module ...
    std::string source; ///< ... its source ...
    int line = 0;       ///< ... and the line there
    std::wstring text;  ///< as issued, without prefix
};

/// Hands each message to one manager: the one registered last, unless it is disabled or busy writing a message, then
/// the one before it, and so on. While none is registered, or none takes it, a built-in `Port_MsgManDefault` does.
///
/// So whoever registers a manager gets every message issued until it is removed, and nobody else gets them too.
class TVX_PLATFORM_API Port_MsgDispatcher {
public:
    /// Registers @p manager as the first to get messages; it stays the caller's. One that is registered already moves
    /// to the front. Null is ignored.
    static void addMsgMan(Port_MsgMan* manager);

    /// Takes @p manager out, wherever it stands. One that is not registered, or null, is ignored.
    static void removeMsgMan(Port_MsgMan* manager);

    /// Hands @p msg to the manager whose turn it is. Code that issues messages calls `Port_MsgManData` instead.
    static void dispatch(const Port_Msg& msg);
};
