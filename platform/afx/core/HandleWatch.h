#pragma once

/// @file
/// Being told by a message, instead of asking on a timer, that a process has ended or that a pipe has something to
/// read.

#include "platform/base/Export.h"
#include "platform/base/Types.h"

#include <span>

namespace tvx {

/// Posts a message, once, as soon as one of the handles is signalled (see WaitForSingleObject); that may be so already.
/// It is posted without that when some time has passed.
///
/// To be told again, call again when the message has been handled: then a child that writes faster than the window
/// reads fills its pipe and not the window's messages.
///
/// Messages with one number for one window are at least a frame apart (16 ms), so that a window which shows what it
/// reads repaints at most once a frame; the first comes at once.
///
/// @param handles  processes, reading ends of pipes, questions (Background.h). They stay open underneath until the
///                 message is posted or cancelPosts() is called, even when they are closed meanwhile.
/// @param window   one of this thread. When it ends, the request ends.
/// @param message  its number; both parameters are 0. A later call with the same window and number replaces this one.
/// @param timeout  milliseconds until it is posted at the latest; `INFINITE`: only when a handle is signalled
/// @return false when a handle or the window is none, with nothing changed
TVX_PLATFORM_API bool postWhenSignalled(std::span<const HANDLE> handles, HWND window, UINT message, DWORD timeout);

/// Withdraws requests for a handle. Do so before closing it. A message that was posted already still arrives.
TVX_PLATFORM_API void cancelPosts(HANDLE handle);

} // namespace tvx
