#pragma once

#include "platform/base/Export.h"
#include "platform/base/Types.h"

#include <string>

namespace tvx {

/// A text that belongs to one process for ever: its id, the boot of the system, and when since then it started. Ids are
/// given again to later processes, the text never is.
/// @return empty when there is no such process, or the system does not tell
TVX_PLATFORM_API std::string processMark(DWORD processId);

/// Whether a mark is known to be that of another process than the one that has the id now. Without one of the marks,
/// or when the kept one is about another id, nothing is known and the answer is false.
/// @param mark  what processMark has answered at some time, perhaps before the system was started anew
TVX_PLATFORM_API bool isOtherProcess(DWORD processId, const std::string& mark);

} // namespace tvx
