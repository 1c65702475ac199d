#pragma once

#include <filesystem>
#include <string>
#include <vector>

namespace tvx::win {

/// What keeps a program from reading the files that its user may read.
enum class SandboxKind { None, Snap, Flatpak };

/// A sandbox and who is in it.
struct Sandbox {
    SandboxKind kind = SandboxKind::None;
    std::string application; ///< the snap's name, or the flatpak's identifier
    bool forwards = false;   ///< the document itself is handed into it, without what stands beside it
};

/// The sandbox that a call runs in.
/// @param words  the program's file, absolute, and its arguments
[[nodiscard]] Sandbox sandboxOf(const std::vector<std::string>& words);

/// Whether what runs in the sandbox sees a file of the user's.
/// @param file  absolute, with links resolved
[[nodiscard]] bool canRead(const Sandbox& sandbox, const std::filesystem::path& file);

} // namespace tvx::win
