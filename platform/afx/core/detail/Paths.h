#pragma once

#include "platform/base/String.h"

namespace tvx::afx {

/// The last part of a name, behind the last separator of either kind or the drive's colon.
[[nodiscard]] CString lastPart(LPCSTR path);
/// The extension of a name with its dot, empty when it has none.
[[nodiscard]] CString extensionOf(LPCSTR path);
/// A name without its extension.
[[nodiscard]] CString withoutExtension(const CString& name);
/// A name from the root on; one that is relative begins in the current folder.
[[nodiscard]] CString fullPath(LPCSTR path);
/// The same in the spelling of what exists under it.
[[nodiscard]] CString spelledPath(LPCSTR path);
/// The file that a name from the root on leads to, links followed.
[[nodiscard]] CString realPath(LPCSTR path);
/// Whether two names mean the same file.
[[nodiscard]] bool sameFile(LPCSTR first, LPCSTR second);

} // namespace tvx::afx
