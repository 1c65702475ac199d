#pragma once

#include <string>
#include <string_view>

/// What the operations on file names do with texts.
namespace FileNameText {

constexpr char Separator = '\\';
/// How the name of a share begins.
constexpr std::string_view NetworkMark = "\\\\";

/// A text that may be null, which counts as empty.
inline std::string_view View(const char* text) {
    return text ? std::string_view(text) : std::string_view();
}

/// The name with backslashes for forward slashes.
std::string WithBackslashes(std::string_view name);

/// The name of a folder: separators turned, one at the end. The empty text becomes the root.
std::string AsFolder(std::string_view name);

/// Folders in the form of a path: as AsFolder, but the empty text stays empty.
std::string AsPath(std::string_view folders);

/// The extension with a dot in front. The empty text stays empty.
std::string WithDot(std::string_view extension);

/// Takes the first folder off a path, with one separator in front of it and the one behind it.
std::string_view PopFirst(std::string_view& path);

/// Whether a mount is a drive, such as "C:".
bool IsDrive(std::string_view mount);

} // namespace FileNameText
