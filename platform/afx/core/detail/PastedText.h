#pragma once

/// @file
/// What a paste takes its text from: the clipboard, or for as long as one lives a PastedText.

#include "platform/base/Export.h"

#include <QMimeData>
#include <QString>

#include <memory>

namespace tvx::afx {

/// Lets what is pasted while it lives come from elsewhere: the selection of another program by the middle button, a
/// text that was dropped. So a host that takes WM_PASTE and asks the clipboard gets what the user means.
class TVX_PLATFORM_API PastedText {
public:
    /// From this text.
    explicit PastedText(const QString& text);
    /// From the clipboard, whatever the paste that this one happens in takes.
    PastedText();
    ~PastedText();
    PastedText(const PastedText&) = delete;
    PastedText& operator=(const PastedText&) = delete;

private:
    friend const QMimeData* pastedData();
    std::unique_ptr<QMimeData> m_data;
    const PastedText* m_outer;
};

/// What can be pasted now; null when the desktop has nothing.
[[nodiscard]] TVX_PLATFORM_API const QMimeData* pastedData();

} // namespace tvx::afx
