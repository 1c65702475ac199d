#pragma once

/// @file
/// Resource libraries: files of compiled resources (`.res` data) that hold a module's dialogs, menus and strings in
/// another language. They are named after the module and the language: "board.DEU", "GuiUtilities.JPN".
/// docs/languages.md tells how they are made.

#include "platform/base/Export.h"
#include "platform/base/Types.h"

#include <string>

/// Loads a resource library. What it holds is then found through its handle, as in any module.
///
/// A name without a folder is searched, with regard to case first and then without, in
/// 1. the folder of the module that the name begins with ("GuiUtilities.DEU": where libGuiUtilities.so is),
/// 2. the application's folder,
/// 3. `lib` and `share/locale` of the installation's roots (`MYTARVEX`, `TARVEX`),
/// 4. the folders of `TVX_RESOURCE_PATH`, separated by colons.
/// The current directory is never searched, and neither are relative folders in those variables. The first file of that
/// name is taken; when it is refused, no other is looked for. A name with a folder must be absolute.
/// @return the handle, the same one for a file that is loaded already; null with `ERROR_MOD_NOT_FOUND`,
///     `ERROR_BAD_EXE_FORMAT` (damaged, or no compiled resources), `ERROR_FILE_TOO_LARGE` (more than 64 MB), or why it
///     cannot be read
TVX_PLATFORM_API HMODULE LoadLibraryA(LPCSTR name);

/// Takes back one LoadLibraryA. With the last one the handle and all resources found through it become invalid: take
/// the library out of the search (`AfxSetResourceHandle`) before.
/// @return FALSE with `ERROR_INVALID_HANDLE` when `library` is no resource library
TVX_PLATFORM_API BOOL FreeLibrary(HMODULE library);

/// @copydoc LoadLibraryA
inline HMODULE LoadLibrary(LPCSTR name) {
    return LoadLibraryA(name);
}

namespace tvx {

/// The resource library of a module's own in the user's language; null when the language is English, or as
/// `LoadLibraryA`.
[[nodiscard]] TVX_PLATFORM_API HMODULE loadTranslation(HMODULE module);

} // namespace tvx
