#include "platform/win/Drives.h"

#include "platform/base/SystemPath.h"
#include "platform/win/detail/DriveTable.h"

#include <algorithm>
#include <cerrno>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <ctime>
#include <fcntl.h>
#include <filesystem>
#include <fstream>
#include <mutex>
#include <optional>
#include <poll.h>
#include <unistd.h>

namespace tvx::win {
namespace {

/// The kernel's mark of a whole disk, which its partitions share.
bool isRemovableDevice(std::string_view device) {
    std::error_code error;
    const std::filesystem::path name = std::filesystem::canonical(device, error).filename();
    const auto entry = std::filesystem::canonical("/sys/class/block" / name, error);
    for (const auto& folder : {entry, entry.parent_path()}) {
        if (char mark = 0; std::ifstream(folder / "removable").get(mark)) {
            return mark == '1';
        }
    }
    return false;
}

/// The list of mounts, held open: the kernel tells on it when something was mounted or taken away.
class MountList {
public:
    /// The list's text, when it is another than at the last call.
    std::optional<std::string> changed() {
        if (m_descriptor >= 0 && !(isDue() && isSignalled())) {
            return std::nullopt;
        }
        if (m_descriptor < 0) {
            m_descriptor = ::open("/proc/self/mountinfo", O_RDONLY | O_CLOEXEC);
        }
        if (m_descriptor < 0) {
            return std::nullopt;
        }
        return read();
    }

private:
    /// Asking is a call of the system, and names come in thousands: a table may be so old.
    bool isDue() {
        constexpr long milliseconds = 20;
        timespec now{};
        ::clock_gettime(CLOCK_MONOTONIC_COARSE, &now);
        const long time = now.tv_sec * 1000 + now.tv_nsec / 1000000;
        if (time - m_asked < milliseconds) {
            return false;
        }
        m_asked = time;
        return true;
    }

    bool isSignalled() const {
        pollfd entry{m_descriptor, POLLPRI, 0};
        return ::poll(&entry, 1, 0) > 0;
    }

    std::string read() const {
        std::string text;
        char part[8192];
        ::lseek(m_descriptor, 0, SEEK_SET);
        for (;;) {
            const ssize_t count = ::read(m_descriptor, part, sizeof(part));
            const bool isInterrupted = count < 0 && errno == EINTR;
            if (count <= 0 && !isInterrupted) {
                return text;
            }
            text.append(part, static_cast<std::size_t>(std::max<ssize_t>(count, 0)));
        }
    }

    int m_descriptor = -1;
    long m_asked = 0;
};

class LiveDrives {
public:
    static LiveDrives& instance() {
        // Never destroyed: static objects of hosts may close files while the process ends.
        static auto* drives = new LiveDrives;
        return *drives;
    }

    std::shared_ptr<const DriveTable> table() {
        const std::lock_guard lock(m_mutex);
        if (const char* text = std::getenv("TVX_DRIVES")) {
            takeText(text);
        } else {
            takeMounts();
        }
        return m_table;
    }

private:
    void takeText(const char* text) {
        if (m_text == text) {
            return;
        }
        std::vector<std::string> mistakes;
        m_table = std::make_shared<const DriveTable>(DriveTable::fromText(text, mistakes));
        m_text = text;
        for (const std::string& mistake : mistakes) {
            std::fprintf(stderr,
                         "TVX_DRIVES: \"%s\" is left out. An entry is LETTER=/FOLDER, each letter once, with "
                         "|removable, |cdrom or |\\\\SERVER\\SHARE behind it where it is one.\n",
                         mistake.c_str());
        }
    }

    void takeMounts() {
        const std::optional<std::string> mounts = m_mounts.changed();
        if (mounts) {
            m_mountText = *mounts;
        }
        if (!mounts && !m_text && m_table) {
            return;
        }
        m_table = std::make_shared<const DriveTable>(DriveTable::fromMounts(m_mountText, isRemovableDevice));
        m_text.reset();
    }

    std::mutex m_mutex;
    MountList m_mounts;
    std::string m_mountText;
    std::optional<std::string> m_text; ///< what the table was made from, unless from the mounts
    std::shared_ptr<const DriveTable> m_table;
};

/// C: is there whatever is mounted, and asked for more often than all the others.
bool isFixedDrive(std::string_view root) {
    return (root == "C:" || root == "c:") && !std::getenv("TVX_DRIVES");
}

/// The drive that a name begins with, or whose share it does; null for an unknown one and for none.
/// @param root  "D:", "\\server\share", "\\server/share" or empty
const Drive* findRoot(const DriveTable& table, std::string root) {
    std::ranges::replace(root, '/', '\\');
    return hasDrive(root) ? table.find(root.front()) : table.findShare(root);
}

std::optional<std::string> folderOf(std::string_view root) {
    if (isFixedDrive(root)) {
        return "/";
    }
    const auto table = currentDrives();
    const Drive* drive = findRoot(*table, std::string(root));
    return drive ? std::optional(drive->folder) : std::nullopt;
}

std::optional<DriveRoot> driveOf(std::string_view path) {
    const auto table = currentDrives();
    const Drive* drive = table->holding(path);
    return drive ? std::optional(DriveRoot{std::string(1, drive->letter) + ":", drive->folder}) : std::nullopt;
}

constexpr RootResolver resolver{&folderOf, &driveOf};

__attribute__((constructor)) void installResolver() {
    setRootResolver(&resolver);
}

UINT typeOf(DriveKind kind) {
    switch (kind) {
    case DriveKind::Removable:
        return DRIVE_REMOVABLE;
    case DriveKind::Optical:
        return DRIVE_CDROM;
    case DriveKind::Remote:
        return DRIVE_REMOTE;
    case DriveKind::Fixed:
        break;
    }
    return DRIVE_FIXED;
}

/// The current folder of a drive; empty when there is no such drive.
std::string folderOnDrive(int number) {
    std::string folder = currentFolderName();
    if (number == 0) {
        return hasDrive(folder) ? folder : std::string();
    }
    const auto letter = static_cast<char>('A' + number - 1);
    if (number < 1 || number > 26 || !currentDrives()->find(letter)) {
        return {};
    }
    return hasDrive(folder) && folder.front() == letter ? folder : std::string(1, letter) + ":\\";
}

} // namespace

std::shared_ptr<const DriveTable> currentDrives() {
    return LiveDrives::instance().table();
}

} // namespace tvx::win

using namespace tvx::win;

DWORD GetLogicalDrives() {
    DWORD letters = 0;
    for (const auto table = currentDrives(); const Drive& drive : table->drives()) {
        letters |= drive.letter ? 1u << (drive.letter - 'A') : 0;
    }
    return letters;
}

UINT GetDriveTypeA(LPCSTR root) {
    const std::string name = root ? root : tvx::currentFolderName();
    const auto table = currentDrives();
    const Drive* drive = findRoot(*table, name.substr(0, tvx::rootLength(name)));
    return drive ? typeOf(drive->kind) : DRIVE_NO_ROOT_DIR;
}

int _getdrive() {
    const std::string folder = tvx::currentFolderName();
    return tvx::hasDrive(folder) ? folder.front() - 'A' + 1 : 0;
}

char* _getdcwd(int drive, char* buffer, int size) {
    const std::string folder = folderOnDrive(drive);
    const std::size_t needed = folder.size() + 1;
    if (folder.empty() || (buffer && needed > static_cast<std::size_t>(std::max(size, 0)))) {
        errno = folder.empty() ? EACCES : ERANGE;
        return nullptr;
    }
    if (!buffer) {
        buffer = static_cast<char*>(std::malloc(std::max(needed, static_cast<std::size_t>(std::max(size, 0)))));
    }
    return buffer ? static_cast<char*>(std::memcpy(buffer, folder.c_str(), needed)) : nullptr;
}
