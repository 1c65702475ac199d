#pragma once

/// @file
/// Settings as text, in the exchange format of the platform: a first line "REGEDIT4", then keys in brackets with their
/// values below them. docs/settings.md describes it.

#include "tools/settings/Setting.h"

#include <string>
#include <string_view>
#include <vector>

namespace settings {

/// One thing that a text asks for.
struct Change {
    enum class Kind { MakeKey, DeleteKey, SetValue, DeleteValue };

    Kind kind = Kind::MakeKey;
    int line = 0; ///< where it stands, counted from 1
    KeyName key;
    Setting setting; ///< of the kinds with a value
};

/// What is wrong with a text.
struct TextFault {
    int line = 0;
    std::string message;
};

/// Reads a whole text. Throws TextFault at the first thing that is wrong. A text that is not in UTF-8 is taken to be in
/// the western code page.
[[nodiscard]] std::vector<Change> readExchangeText(std::string_view text);

/// The first line of every text, with the empty line below it.
[[nodiscard]] std::string writeHeader();
/// Whether a key's name can stand in a line: not with control characters or broken sequences in it.
[[nodiscard]] bool canWriteKey(const KeyName& key);
/// The line of a key.
[[nodiscard]] std::string writeKey(const KeyName& key);
/// The lines of a value. Reading them gives back the same name, type and bytes.
[[nodiscard]] std::string writeSetting(const Setting& setting);

} // namespace settings
