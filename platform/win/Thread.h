#pragma once

#include "platform/base/Export.h"
#include "platform/base/Types.h"

/// The number of the calling thread, unique on the whole machine. That of a process's first thread is the process's
/// own number (`GetCurrentProcessId`).
TVX_PLATFORM_API DWORD GetCurrentThreadId();
