#pragma once

/// @file
/// Libraries that are loaded by name while the program runs.
///
/// Resource libraries are files of compiled resources (`.res` data) that hold a module's dialogs, menus and strings in
/// another language. They are named after the module and the language: "board.DEU", "GuiUtilities.JPN".
/// docs/languages.md tells how they are made.
///
/// Libraries of code are this system's shared objects. Their functions are found by `GetProcAddress` (Module.h).

#include "platform/base/Export.h"
#include "platform/base/Types.h"

#include <string>

/// Loads a library. The resources that it holds are then found through its handle, as in any module.
///
/// A name without a folder that has no ending, or ".dll" or ".so", means code: "plot" and "plot.dll" are `plot.so` or
/// `libplot.so`. It is searched in the folder `tarvex` beside this layer's own file, which has the layer's own modules;
/// in the application's folder; beside the layer's own file; and in `lib` of the installation's roots.
///
/// Other names without a folder mean resource libraries. They are searched, with regard to case first and then without,
/// in
/// 1. the folder of the module that the name begins with ("GuiUtilities.DEU": where libGuiUtilities.so is),
/// 2. the application's folder,
/// 3. `lib` and `share/locale` of the installation's roots (`MYTARVEX`, `TARVEX`),
/// 4. the folders of `TVX_RESOURCE_PATH`, separated by colons.
/// The current directory is never searched, and neither are relative folders in those variables. The first file of that
/// name is taken; when it is refused, no other is looked for. A name with a folder must be absolute; its file may be of
/// either kind, whatever its ending.
/// @return the handle, the same one for a file that is loaded already; null with `ERROR_MOD_NOT_FOUND`,
///     `ERROR_BAD_EXE_FORMAT` (damaged, neither code nor compiled resources, or refused by the system's loader, to
///     which something that the library needs may be missing), `ERROR_FILE_TOO_LARGE` (resources of more than 64 MB),
///     or why it cannot be read
TVX_PLATFORM_API HMODULE LoadLibraryA(LPCSTR name);

/// Takes back one LoadLibraryA. With the last one the handle and all functions and resources found through it become
/// invalid: take the library out of the search (`AfxSetResourceHandle`) before.
/// @return FALSE with `ERROR_INVALID_HANDLE` when `library` was not loaded by name
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
