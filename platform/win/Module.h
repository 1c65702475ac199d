#pragma once

/// @file
/// Modules: the application, every shared library that brought resources, and what was loaded by name
/// (ResourceLibrary.h): resource libraries and libraries of code. A module's handle is valid from the moment its file
/// is loaded until it is unloaded; only what was loaded by name is freed.

#include "platform/base/Export.h"
#include "platform/base/Types.h"

#include <cstddef>
#include <cstdint>
#include <span>
#include <string>
#include <string_view>

/// The module whose file has this name; null asks for the application. Only the last part of a path counts, with or
/// without "lib" in front and an extension behind ("GuiUtilities" finds libGuiUtilities.so.1), in any case.
/// Null with `ERROR_MOD_NOT_FOUND` when no such module registered itself.
TVX_PLATFORM_API HMODULE GetModuleHandleA(LPCSTR name);

/// Copies the full name of a module's file (links resolved), such as "C:\usr\bin\board", into `buffer` of `size` bytes,
/// always ended by NUL. A null module is the application. The result is the length without the NUL; a path that does
/// not fit is cut, the result is then `size` and the last error `ERROR_INSUFFICIENT_BUFFER`. 0 when the module is
/// unknown.
TVX_PLATFORM_API DWORD GetModuleFileNameA(HMODULE module, LPSTR buffer, DWORD size);

/// A function that some module exports, to be converted to the type that it has. Compilers convert this one to any
/// other without a warning.
using FARPROC = void (*)();

/// The function `name` of a module, which it must export itself; a null module is the application.
/// Null with `ERROR_PROC_NOT_FOUND` when it has none, and for resource libraries, which have no code. Functions have no
/// numbers here.
TVX_PLATFORM_API FARPROC GetProcAddress(HMODULE module, LPCSTR name);

/// @copydoc GetModuleHandleA
inline HMODULE GetModuleHandle(LPCSTR name) {
    return GetModuleHandleA(name);
}
/// @copydoc GetModuleFileNameA
inline DWORD GetModuleFileName(HMODULE module, LPSTR buffer, DWORD size) {
    return GetModuleFileNameA(module, buffer, size);
}

namespace tvx {

/// Bytes of a resource: a view into the module, never owned.
using ResourceBytes = std::span<const std::uint8_t>;

/// Hands a module's compiled resources to the layer. Called by the constructor that the build generates for each
/// script, before `main` or while a shared object is being loaded; nothing is read or checked yet.
/// @param anchor any address inside the module: it tells which file the resources belong to
/// @param data   standard `.res` data, which stays in place until `unregisterResources`
/// @param size   its length in bytes
TVX_PLATFORM_API void registerResources(const void* anchor, const void* data, std::size_t size);

/// Takes resources back before their module is unloaded. Handles into them are invalid afterwards.
TVX_PLATFORM_API void unregisterResources(const void* data);

/// The module that holds `address`, a function or a variable of it. Null when that file registered no resources.
[[nodiscard]] TVX_PLATFORM_API HMODULE moduleFromAddress(const void* address);

/// The full path of a module's file in the system's form, links resolved, whatever its length. A null module is the
/// application; empty when the module is unknown.
[[nodiscard]] TVX_PLATFORM_API std::string moduleFileName(HMODULE module);

/// A module's path without what this system adds to the names of shared libraries: "/opt/lib/GuiUtilities" for
/// "/opt/lib/libGuiUtilities.so.1.0.0". Other names stay as they are.
[[nodiscard]] TVX_PLATFORM_API std::string plainModuleName(std::string_view path);

/// The application's module. It exists even when the application has no resources.
[[nodiscard]] TVX_PLATFORM_API HMODULE applicationModule();

} // namespace tvx
