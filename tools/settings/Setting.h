#pragma once

#include "platform/win/Registry.h"

#include <string>
#include <string_view>

namespace settings {

/// A key by its root and the path below it.
struct KeyName {
    HKEY root = HKEY_CURRENT_USER;
    std::string path;
};

/// A value with its name; the default value's name is empty.
struct Setting {
    std::string name;
    DWORD type = REG_SZ;
    std::string data; ///< as the store holds it, a text with its zero
};

/// The key that a text names: a root ("HKEY_CURRENT_USER", "HKEY_LOCAL_MACHINE", "HKEY_CLASSES_ROOT", or "HKCU",
/// "HKLM", "HKCR") and a path, joined with a backslash.
/// @return whether the text begins with a root
[[nodiscard]] bool readKeyName(std::string_view text, KeyName& key);
/// The same text with the root's long name.
[[nodiscard]] std::string writeKeyName(const KeyName& key);

} // namespace settings
