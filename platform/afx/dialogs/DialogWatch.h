#pragma once

/// @file
/// Being told that a dialog opens.

#include "platform/base/Export.h"

#include <functional>

namespace tvx {

/// Calls a function each time when a dialog of this process is about to be shown: one made from a template, with a
/// loop or without, a message box, a file, colour or font dialog. So a window that stands in front of all others can
/// give way. Child dialogs do not count, as property pages are.
///
/// The function may end the watch.
class TVX_PLATFORM_API DialogWatch {
public:
    explicit DialogWatch(std::function<void()> opens);
    ~DialogWatch();
    DialogWatch(const DialogWatch&) = delete;
    DialogWatch& operator=(const DialogWatch&) = delete;

private:
    friend void tellDialogOpens();
    std::function<void()> m_opens;
};

/// Calls those functions. For what shows dialogs.
void tellDialogOpens();

} // namespace tvx
