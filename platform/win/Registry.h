#pragma once

/// @file
/// The settings store: a tree of keys, each with named values, shared by all programs of the user.
///
/// Names of keys and values compare without case and keep the spelling they were first written with. A value is written
/// when the call that writes it returns, and other processes see it from then on; nothing a reader gets is half
/// written. Several processes that write at once wait for each other, for at most five seconds.
///
/// @code
/// HKEY key;
/// if (RegCreateKeyExA(HKEY_CURRENT_USER, "Software\\Tarvex\\Common", 0, nullptr, REG_OPTION_NON_VOLATILE,
///                     KEY_READ | KEY_WRITE, nullptr, &key, nullptr) == ERROR_SUCCESS) {
///     const char editor[] = "gedit %1";
///     RegSetValueExA(key, "TextEditor", 0, REG_SZ, reinterpret_cast<const BYTE*>(editor), sizeof editor);
///     RegCloseKey(key);
/// }
/// @endcode
///
/// Every call answers `ERROR_SUCCESS` (0) or what is wrong:
///
/// | number | when |
/// |---|---|
/// | `ERROR_FILE_NOT_FOUND` (2) | there is no such key or value |
/// | `ERROR_ACCESS_DENIED` (5) | the key was not opened for this, the store may not be written or cannot be used |
/// | `ERROR_INVALID_HANDLE` (6) | the key is closed or never was open |
/// | `ERROR_INVALID_PARAMETER` (87) | a required argument is null, a name too long |
/// | `ERROR_DISK_FULL` (112) | the value could not be kept |
/// | `ERROR_BUSY` (170) | another process has been writing for five seconds |
/// | `ERROR_MORE_DATA` (234) | the buffer is too small |
/// | `ERROR_NO_MORE_ITEMS` (259) | the enumeration is at its end |
/// | `ERROR_KEY_DELETED` (1018) | the open key has been deleted meanwhile |
///
/// All calls may be used from any thread. docs/settings.md tells where the files are and what happens to damaged ones.

#include "platform/base/Export.h"
#include "platform/base/Types.h"
#include "platform/win/Error.h"

/// An open key, or one of the roots.
DECLARE_HANDLE(HKEY);
using PHKEY = HKEY*;
using LPBYTE = BYTE*;
using LPDWORD = DWORD*;
using LSTATUS = LONG;
/// A combination of KEY_ rights.
using REGSAM = DWORD;
/// Descriptions of who may do what with a new object; they are not looked at.
using LPSECURITY_ATTRIBUTES = struct SECURITY_ATTRIBUTES*;
/// A moment in units of 100 ns since 1601. The store does not keep when a key was changed.
using PFILETIME = struct FILETIME*;

/// The roots. They are always open and need not be closed.
/// `HKEY_CLASSES_ROOT` is `Software\Classes` of the user, then of the machine, then what the desktop knows of the
/// programs that open documents (docs/programs.md); `HKEY_LOCAL_MACHINE`, which can be read only, is the machine's
/// settings, then what the desktop knows. Each value is that of the first source which has it; what is written goes
/// into the first.
#define HKEY_CLASSES_ROOT (reinterpret_cast<HKEY>(std::uintptr_t{0x80000000}))
#define HKEY_CURRENT_USER (reinterpret_cast<HKEY>(std::uintptr_t{0x80000001}))
#define HKEY_LOCAL_MACHINE (reinterpret_cast<HKEY>(std::uintptr_t{0x80000002}))

/// Types of values. The store keeps any number as type; these are the ones with a meaning.
inline constexpr DWORD REG_NONE = 0;
inline constexpr DWORD REG_SZ = 1;        ///< text with its terminating zero
inline constexpr DWORD REG_EXPAND_SZ = 2; ///< text with names of environment variables in it
inline constexpr DWORD REG_BINARY = 3;
inline constexpr DWORD REG_DWORD = 4; ///< a number of 32 bits, lowest byte first
inline constexpr DWORD REG_DWORD_BIG_ENDIAN = 5;
inline constexpr DWORD REG_LINK = 6;
inline constexpr DWORD REG_MULTI_SZ = 7; ///< texts, each with its zero, and a zero at the end
inline constexpr DWORD REG_QWORD = 11;   ///< a number of 64 bits, lowest byte first

/// What a key is opened for.
inline constexpr REGSAM KEY_QUERY_VALUE = 0x0001;
inline constexpr REGSAM KEY_SET_VALUE = 0x0002;
inline constexpr REGSAM KEY_CREATE_SUB_KEY = 0x0004;
inline constexpr REGSAM KEY_ENUMERATE_SUB_KEYS = 0x0008;
inline constexpr REGSAM KEY_NOTIFY = 0x0010;
inline constexpr REGSAM KEY_READ = 0x20019;
inline constexpr REGSAM KEY_WRITE = 0x20006;
inline constexpr REGSAM KEY_ALL_ACCESS = 0xF003F;

inline constexpr DWORD REG_OPTION_NON_VOLATILE = 0;
inline constexpr DWORD REG_CREATED_NEW_KEY = 1;
inline constexpr DWORD REG_OPENED_EXISTING_KEY = 2;

/// Opens a key, after creating it and the keys above it where they are missing.
/// @param key          a root or an open key
/// @param subKey       path below `key`, parts joined with a backslash; empty or null: `key` itself
/// @param access       KEY_ rights. An existing key is opened even where the store cannot be written; writing to it
///                     then fails.
/// @param result       receives the open key; close it with RegCloseKey
/// @param disposition  receives `REG_CREATED_NEW_KEY` or `REG_OPENED_EXISTING_KEY`; may be null
TVX_PLATFORM_API LSTATUS RegCreateKeyExA(HKEY key, LPCSTR subKey, DWORD reserved, LPSTR className, DWORD options,
                                         REGSAM access, LPSECURITY_ATTRIBUTES security, PHKEY result,
                                         LPDWORD disposition);
/// Opens an existing key; `result` stays as it is when that fails. Arguments as in RegCreateKeyExA.
TVX_PLATFORM_API LSTATUS RegOpenKeyExA(HKEY key, LPCSTR subKey, DWORD options, REGSAM access, PHKEY result);
/// Closes a key. Roots stay open.
TVX_PLATFORM_API LSTATUS RegCloseKey(HKEY key);

/// Reads a value.
/// @param name      empty or null: the key's default value
/// @param reserved  null
/// @param type      receives the type; may be null
/// @param data      receives the bytes as they were written, for a text usually with its zero; null to ask for the size
/// @param size      bytes of room in `data`; receives those of the value, also when there is too little room. May be
///                  null when `data` is.
TVX_PLATFORM_API LSTATUS RegQueryValueExA(HKEY key, LPCSTR name, LPDWORD reserved, LPDWORD type, LPBYTE data,
                                          LPDWORD size);
/// Writes a value, which is safe from a crash or power failure when the call returns.
/// @param name  empty or null: the key's default value
/// @param size  bytes of `data`, for a text with its terminating zero
TVX_PLATFORM_API LSTATUS RegSetValueExA(HKEY key, LPCSTR name, DWORD reserved, DWORD type, const BYTE* data,
                                        DWORD size);
/// Deletes a value.
TVX_PLATFORM_API LSTATUS RegDeleteValueA(HKEY key, LPCSTR name);
/// Deletes a key with its values. One that has keys below it is refused with `ERROR_ACCESS_DENIED`.
TVX_PLATFORM_API LSTATUS RegDeleteKeyA(HKEY key, LPCSTR subKey);

/// Names a key below `key`: ask for 0, 1, 2, ... until `ERROR_NO_MORE_ITEMS`. The order is that of the names without
/// case. Keys that come and go meanwhile may be named or not, the others are named once.
/// @param name        receives the name with its zero
/// @param nameSize    bytes of room in `name`, the zero included; receives the length of the name without it
/// @param className   not filled; null
/// @param lastWrite   not filled; null
TVX_PLATFORM_API LSTATUS RegEnumKeyExA(HKEY key, DWORD index, LPSTR name, LPDWORD nameSize, LPDWORD reserved,
                                       LPSTR className, LPDWORD classSize, PFILETIME lastWrite);
/// Names a value of `key` and reads it, counted as in RegEnumKeyExA. The default value's name is empty. The last three
/// arguments are those of RegQueryValueExA.
TVX_PLATFORM_API LSTATUS RegEnumValueA(HKEY key, DWORD index, LPSTR name, LPDWORD nameSize, LPDWORD reserved,
                                       LPDWORD type, LPBYTE data, LPDWORD size);

/// @{
/// The calls by their unsuffixed names.
inline LSTATUS RegCreateKeyEx(HKEY key, LPCSTR subKey, DWORD reserved, LPSTR className, DWORD options, REGSAM access,
                              LPSECURITY_ATTRIBUTES security, PHKEY result, LPDWORD disposition) {
    return RegCreateKeyExA(key, subKey, reserved, className, options, access, security, result, disposition);
}
inline LSTATUS RegOpenKeyEx(HKEY key, LPCSTR subKey, DWORD options, REGSAM access, PHKEY result) {
    return RegOpenKeyExA(key, subKey, options, access, result);
}
inline LSTATUS RegQueryValueEx(HKEY key, LPCSTR name, LPDWORD reserved, LPDWORD type, LPBYTE data, LPDWORD size) {
    return RegQueryValueExA(key, name, reserved, type, data, size);
}
inline LSTATUS RegSetValueEx(HKEY key, LPCSTR name, DWORD reserved, DWORD type, const BYTE* data, DWORD size) {
    return RegSetValueExA(key, name, reserved, type, data, size);
}
inline LSTATUS RegDeleteValue(HKEY key, LPCSTR name) {
    return RegDeleteValueA(key, name);
}
inline LSTATUS RegDeleteKey(HKEY key, LPCSTR subKey) {
    return RegDeleteKeyA(key, subKey);
}
inline LSTATUS RegEnumKeyEx(HKEY key, DWORD index, LPSTR name, LPDWORD nameSize, LPDWORD reserved, LPSTR className,
                            LPDWORD classSize, PFILETIME lastWrite) {
    return RegEnumKeyExA(key, index, name, nameSize, reserved, className, classSize, lastWrite);
}
inline LSTATUS RegEnumValue(HKEY key, DWORD index, LPSTR name, LPDWORD nameSize, LPDWORD reserved, LPDWORD type,
                            LPBYTE data, LPDWORD size) {
    return RegEnumValueA(key, index, name, nameSize, reserved, type, data, size);
}
/// @}

namespace tvx {

/// Keeps all that the calling thread writes to the user's settings together: other processes see all of it from
/// commit() on, or none. Other writers wait meanwhile (and give up after five seconds), so keep it short and show no
/// windows. One at a time.
///
/// @code
/// tvx::RegistryTransaction transaction;
/// if (transaction.begin() == ERROR_SUCCESS && writeAll() && transaction.commit() == ERROR_SUCCESS)
///     ...
/// @endcode
class TVX_PLATFORM_API RegistryTransaction {
public:
    RegistryTransaction() = default;
    /// Takes everything back unless commit() has succeeded.
    ~RegistryTransaction();
    RegistryTransaction(const RegistryTransaction&) = delete;
    RegistryTransaction& operator=(const RegistryTransaction&) = delete;

    /// Begins; the result codes are those of the calls.
    [[nodiscard]] LSTATUS begin();
    /// Keeps what was written. When that fails nothing was written.
    [[nodiscard]] LSTATUS commit();

private:
    bool m_isOpen = false;
};

} // namespace tvx
