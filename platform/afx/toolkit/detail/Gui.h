#pragma once

/// @file
/// The toolkit's application object, made when the first window is needed.

#include "platform/base/Export.h"
#include "platform/base/Types.h"

#include <exception>

class QEvent;
class QObject;

namespace tvx::afx {

/// What the toolkit's application object calls of the floors above it. They hand this over when the library is loaded,
/// before any window can be asked for.
struct GuiHooks {
    /// Offered each event once, with its deepest receiver. True: it went no further, and `result` is notify's answer.
    bool (*translate)(QObject* receiver, QEvent* event, bool& result) = nullptr;
    /// Takes an exception that escaped an event handler; the toolkit's frames below cannot be unwound.
    void (*storeException)(std::exception_ptr error) noexcept = nullptr;
    /// Called once, on the thread of the windows, when the application object stands.
    void (*started)() = nullptr;
};
void setGuiHooks(const GuiHooks& hooks);

/// Whether windows can be shown: a display was asked for and answers, or the toolkit was told to do without one.
/// Asks once and keeps the answer.
TVX_PLATFORM_API bool hasDisplay();
/// Makes the toolkit's application object if it does not stand yet. False when there is no display.
TVX_PLATFORM_API bool ensureGui();
/// The number of the thread that this process's windows live on, 0 before there can be any.
[[nodiscard]] DWORD guiThread();
/// Tells on standard error, once, that a window was wanted where none can be shown.
TVX_PLATFORM_API void tellMissingDisplay();
/// Whether that has been told.
TVX_PLATFORM_API bool wasDisplayMissed();

} // namespace tvx::afx
