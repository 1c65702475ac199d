#pragma once

#include "platform/port/MsgManData.h"

/// The origin of a message that the library issues. Hosts switch messages off by these names, so they stay.
/// @param source    the source by its name below the library's folder, such as "../s/Version"
/// @param line      the line that issues the message
/// @param revision  the source's revision
inline Port_MsgManData LibraryOrigin(const char* source, int line, const char* revision) {
    return Port_MsgManData::createObject("GuiUtilities", source, line, revision);
}
