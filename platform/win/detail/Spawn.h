#pragma once

#include "platform/base/Export.h"
#include "platform/win/detail/KernelObject.h"

#include <array>
#include <sys/types.h>

namespace tvx::win {

/// Stands for the null device where a descriptor for a child is asked for.
inline constexpr int nullDevice = -1;

/// A child to start. The texts are used before spawn() returns.
struct SpawnRequest {
    const char* program = nullptr;        ///< absolute
    char* const* arguments = nullptr;     ///< ended by null
    char* const* environment = nullptr;   ///< ended by null
    const char* directory = nullptr;      ///< null: the current one
    std::array<int, 3> standard{0, 1, 2}; ///< what its three descriptors are, or nullDevice
};

/// What a start can fail in.
enum class SpawnStep { Start, Directory, Program };

/// A started child, or why there is none.
struct SpawnResult {
    Descriptor process; ///< none: it failed
    pid_t id = 0;
    SpawnStep failedStep = SpawnStep::Start;
    int error = 0; ///< an `errno` value
};

/// Starts a program in a session of its own. Nothing of this process is copied: it runs on when the new program has
/// taken over, or has failed to. The child has the three standard descriptors and no other, no signal blocked, and
/// every signal handled by default save those that the process was itself started to ignore.
[[nodiscard]] SpawnResult spawn(const SpawnRequest& request);

} // namespace tvx::win
