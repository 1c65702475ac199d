#pragma once

/// @file
/// The drives, as data: which letters there are, which folders they stand for, which shares are behind them.

#include "platform/base/Export.h"

#include <functional>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

namespace tvx::win {

enum class DriveKind { Fixed, Removable, Optical, Remote };

struct Drive {
    char letter = 0;    ///< 'A' to 'Z'; 0 for a share for which no letter was left
    std::string folder; ///< in the system's form, without a separator at the end except for "/"
    DriveKind kind = DriveKind::Fixed;
    std::string remoteName; ///< "\\server\share" of a remote one
};

/// Whether a device ("/dev/sdb1") can be taken out of the machine.
using RemovableTest = std::function<bool(std::string_view device)>;

/// A table of drives. It does not change; another state of the system is another table.
class TVX_PLATFORM_API DriveTable {
public:
    /// The drives of a system: C: is "/"; removable media, optical discs and network folders get letters from D: up in
    /// the order of their mount points. Lines that make no sense are passed over.
    /// @param mountInfo  text of /proc/self/mountinfo
    static DriveTable fromMounts(std::string_view mountInfo, const RemovableTest& isRemovable);

    /// The drives that a text lists: "C=/;D=/srv/work;E=/media/stick|removable;X=/mnt/data|\\server\data". Behind the
    /// bar stands the kind: fixed (also without a bar), removable, cdrom, or the name of a share.
    /// @param mistakes  receives the entries that make no sense and were left out
    static DriveTable fromText(std::string_view text, std::vector<std::string>& mistakes);

    /// The drive with a letter in any case; null when there is none.
    [[nodiscard]] const Drive* find(char letter) const noexcept;
    /// The drive behind a share ("\\server\share" in any case); null when it is not connected.
    [[nodiscard]] const Drive* findShare(std::string_view remoteName) const noexcept;
    /// The drive with a letter on which an absolute path of the system's lies: that with the longest folder.
    [[nodiscard]] const Drive* holding(std::string_view path) const noexcept;

    [[nodiscard]] const std::vector<Drive>& drives() const noexcept {
        return m_drives;
    }

private:
    std::vector<Drive> m_drives;
};

/// The drives now, at most a fiftieth of a second ago. Asking costs next to nothing while nothing was mounted or taken
/// away. For any thread.
[[nodiscard]] std::shared_ptr<const DriveTable> currentDrives();

} // namespace tvx::win
