#pragma once

/// @file
/// Finding resources in a module. `FindResourceA` and its relatives look into exactly one module; the search that goes
/// on to the application and the extension modules is in ExtensionModule.h.
///
/// Names and types are texts, compared without case, or 16-bit numbers made with `MAKEINTRESOURCE`; the text "#123" is
/// the number 123. Where a resource exists in several languages, the calls without a language take the neutral one,
/// else the one that stands first in the script.

#include "platform/base/Export.h"
#include "platform/base/Types.h"
#include "platform/win/Locale.h"
#include "platform/win/Module.h"

#include <optional>
#include <string>

/// Resource types, as numbers that fit `FindResourceA`.
#define RT_CURSOR MAKEINTRESOURCE(1)
#define RT_BITMAP MAKEINTRESOURCE(2)
#define RT_ICON MAKEINTRESOURCE(3)
#define RT_MENU MAKEINTRESOURCE(4)
#define RT_DIALOG MAKEINTRESOURCE(5)
#define RT_STRING MAKEINTRESOURCE(6)
#define RT_ACCELERATOR MAKEINTRESOURCE(9)
#define RT_RCDATA MAKEINTRESOURCE(10)
#define RT_GROUP_CURSOR MAKEINTRESOURCE(12)
#define RT_GROUP_ICON MAKEINTRESOURCE(14)
#define RT_VERSION MAKEINTRESOURCE(16)
#define RT_HTML MAKEINTRESOURCE(23)
#define RT_MANIFEST MAKEINTRESOURCE(24)
/// First contents of list and combo boxes, by dialog.
#define RT_DLGINIT MAKEINTRESOURCE(240)
/// Tool bars.
#define RT_TOOLBAR MAKEINTRESOURCE(241)

/// A resource of `module` (null: the application). The handle needs no freeing. Null with
/// `ERROR_RESOURCE_DATA_NOT_FOUND` (the module has no resources, or damaged ones), `ERROR_RESOURCE_TYPE_NOT_FOUND` or
/// `ERROR_RESOURCE_NAME_NOT_FOUND`.
TVX_PLATFORM_API HRSRC FindResourceA(HMODULE module, LPCSTR name, LPCSTR type);

/// As `FindResourceA`, in exactly this language; language 0 takes the same one as `FindResourceA`.
/// `ERROR_RESOURCE_LANG_NOT_FOUND` when the resource exists in other languages only.
TVX_PLATFORM_API HRSRC FindResourceExA(HMODULE module, LPCSTR type, LPCSTR name, WORD language);

/// The found resource's data, to be given to `LockResource`. Nothing is copied and nothing is to be freed.
TVX_PLATFORM_API HGLOBAL LoadResource(HMODULE module, HRSRC resource);

/// The address of the first byte of the data that `LoadResource` answered.
TVX_PLATFORM_API LPVOID LockResource(HGLOBAL data);

/// Length of a found resource in bytes; 0 with `ERROR_INVALID_HANDLE` for a null handle.
TVX_PLATFORM_API DWORD SizeofResource(HMODULE module, HRSRC resource);

/// Nothing has to be freed; kept for hosts that do. Answers FALSE, as the call always did.
TVX_PLATFORM_API BOOL FreeResource(HGLOBAL data);

/// Copies a string of the module's string table (null: the application) into `buffer`, ended by NUL and cut before the
/// UTF-8 sequence that does not fit. The result is the length copied, 0 when there is no such string.
/// With `size` 0 nothing is copied and the result is the length of the whole string.
TVX_PLATFORM_API int LoadStringA(HINSTANCE module, UINT id, LPSTR buffer, int size);

// The names without a letter behind them, as functions: macros would rename CString::LoadString too.

/// @copydoc FindResourceA
inline HRSRC FindResource(HMODULE module, LPCSTR name, LPCSTR type) {
    return FindResourceA(module, name, type);
}
/// @copydoc FindResourceExA
inline HRSRC FindResourceEx(HMODULE module, LPCSTR type, LPCSTR name, WORD language) {
    return FindResourceExA(module, type, name, language);
}
/// @copydoc LoadStringA
inline int LoadString(HINSTANCE module, UINT id, LPSTR buffer, int size) {
    return LoadStringA(module, id, buffer, size);
}

namespace tvx {

/// The data of a resource of one module, empty when it has none of that name. Sets the last error as `FindResourceA`.
[[nodiscard]] TVX_PLATFORM_API ResourceBytes resourceBytes(HMODULE module, LPCSTR name, LPCSTR type);

/// The name of the module's first resource of a type, as FindResourceA takes it: of named ones the first in the order
/// of the alphabet, else that of the lowest number ("#128"). Empty when the module has none.
[[nodiscard]] TVX_PLATFORM_API std::string firstResource(HMODULE module, LPCSTR type);

/// A string of one module's string table in UTF-8, nothing when it has none (an empty one counts as none).
[[nodiscard]] TVX_PLATFORM_API std::optional<std::string> resourceString(HMODULE module, UINT id);

/// Why the module's resource data was refused as a whole, empty when all is well. Reads the data's index if needed.
[[nodiscard]] TVX_PLATFORM_API std::string resourceDamage(HMODULE module);

} // namespace tvx
