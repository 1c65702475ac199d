#pragma once

/// @file
/// Programs that the desktop opens documents with, and what keeps them from opening one. Which program that is for a
/// kind of document stands in the settings: `HKEY_CLASSES_ROOT`, ".htm", ".pdf", ".txt" (docs/programs.md).

#include "platform/base/Export.h"

#include <string>

namespace tvx {

/// Why a program cannot open a document, empty when nothing speaks against it.
///
/// - "snap": it runs in the sandbox of a snap, which sees the user's files outside of hidden folders, removable media
///   and /usr/share/doc
/// - "flatpak": it runs in the sandbox of a flatpak, which sees the folders that its permissions name, never /usr
/// - "files only": it takes names of files only, and the document is a web address
///
/// A program that is missing has no obstacle: starting it says what is wrong. Links, Debian's alternatives, `env`,
/// `sensible-browser` and start scripts of sandboxed programs are looked through.
///
/// @param commandLine  as the settings hold it: a program with or without arguments and "%1"
/// @param address      a web address, a file address ("file:///...") or a file name
/// @return a short name of the obstacle for messages, e.g. "snap", "flatpak"
[[nodiscard]] TVX_PLATFORM_API std::string obstacleTo(const std::string& commandLine, const std::string& address);

} // namespace tvx
