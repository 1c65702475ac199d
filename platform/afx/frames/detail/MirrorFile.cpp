#include "platform/afx/frames/detail/MirrorFile.h"

#include "platform/base/SystemPath.h"

#include <cerrno>
#include <cstdlib>
#include <fcntl.h>
#include <filesystem>
#include <fstream>
#include <sys/stat.h>
#include <unistd.h>
#include <vector>

namespace tvx::afx {

namespace {

namespace fs = std::filesystem;

/// What a file made by this process is allowed, by its mask.
mode_t defaultMode() {
    // The mask can be read by setting it only.
    const mode_t mask = umask(0);
    umask(mask);
    return 0666 & ~mask;
}

/// A new file of a name that did not exist; -1 when none can be made there.
int makeTemporary(const fs::path& folder, const fs::path& name, std::string& made) {
    std::string pattern = (folder / ("." + name.string() + ".XXXXXX")).string();
    const int descriptor = mkostemp(pattern.data(), O_CLOEXEC);
    if (descriptor >= 0) {
        made = pattern;
    }
    return descriptor;
}

bool writeAll(int descriptor, const std::vector<char>& bytes) {
    std::size_t done = 0;
    while (done < bytes.size()) {
        const ssize_t count = pwrite(descriptor, bytes.data() + done, bytes.size() - done, static_cast<off_t>(done));
        if (count < 0 && errno != EINTR) {
            return false;
        }
        done += count > 0 ? static_cast<std::size_t>(count) : 0;
    }
    return ftruncate(descriptor, static_cast<off_t>(bytes.size())) == 0;
}

std::vector<char> readAll(const std::string& path) {
    std::ifstream file(path, std::ios::binary);
    return {std::istreambuf_iterator<char>(file), {}};
}

/// Writes one file's contents over another's. When that fails, the old contents are put back: their room is still
/// there, since nothing is cut off before all is written.
int copyOver(const std::string& from, const std::string& to) {
    const std::vector<char> fresh = readAll(from);
    const std::vector<char> old = readAll(to);
    const int descriptor = ::open(to.c_str(), O_WRONLY | O_CLOEXEC);
    if (descriptor < 0) {
        return errno;
    }
    int error = 0;
    if (!writeAll(descriptor, fresh) || fsync(descriptor) != 0) {
        error = errno;
        writeAll(descriptor, old);
    }
    if (::close(descriptor) != 0 && error == 0) {
        error = errno;
    }
    return error;
}

bool fail(CFileException* error, int number, LPCTSTR fileName) {
    if (error) {
        error->m_cause = CFileException::ErrnoToException(number);
        error->m_lOsError = number;
        error->m_strFileName = fileName;
    }
    return false;
}

} // namespace

MirrorFile::~MirrorFile() {
    if (IsOpen()) {
        Abort();
    }
    forget();
}

void MirrorFile::forget() {
    if (!m_temporary.empty()) {
        ::unlink(m_temporary.c_str());
    }
    m_temporary.clear();
    m_target.clear();
}

BOOL MirrorFile::Open(LPCTSTR fileName, UINT openFlags, CFileException* error) {
    forget();
    if (isNamedPipe(fileName ? fileName : "")) {
        fail(error, ESPIPE, fileName);
        return FALSE;
    }
    if ((openFlags & modeCreate) == 0 || (openFlags & modeNoTruncate) != 0) {
        return CFile::Open(fileName, openFlags, error);
    }
    return openBeside(fileName, error) ? TRUE : FALSE;
}

bool MirrorFile::openBeside(LPCTSTR fileName, CFileException* error) {
    const auto named = systemPath(fileName, PathUse::Creating);
    if (!named) {
        return fail(error, ENOENT, fileName);
    }
    std::error_code ignored;
    const fs::path resolved = fs::weakly_canonical(*named, ignored);
    const fs::path target = ignored ? fs::path(*named) : resolved;
    struct stat status{};
    const bool exists = ::stat(target.c_str(), &status) == 0;
    if (exists && !S_ISREG(status.st_mode)) {
        return CFile::Open(fileName, modeCreate | modeReadWrite, error) != FALSE; // a device or the like
    }
    if (exists && ::access(target.c_str(), W_OK) != 0) {
        return fail(error, errno, fileName);
    }
    const int descriptor = makeBeside(target, exists ? &status : nullptr);
    if (descriptor < 0) {
        return fail(error, errno, fileName);
    }
    m_target = target.string();
    attach(descriptor);
    SetFilePath(fileName);
    return true;
}

/// Makes the temporary file with the rights of the file that it will replace, and tells whether its name can be moved.
/// @param replaced that file's status; null when there is none
int MirrorFile::makeBeside(const fs::path& target, const struct stat* replaced) {
    int descriptor = makeTemporary(target.parent_path(), target.filename(), m_temporary);
    m_copies = replaced && replaced->st_nlink > 1;
    if (descriptor < 0 && replaced && errno != ENOENT) {
        std::error_code ignored;
        m_copies = true;
        descriptor = makeTemporary(fs::temp_directory_path(ignored), target.filename(), m_temporary);
    }
    if (descriptor < 0) {
        return -1;
    }
    ::fchmod(descriptor, replaced ? replaced->st_mode & 07777 : defaultMode());
    if (replaced && ::fchown(descriptor, replaced->st_uid, replaced->st_gid) != 0) {
        m_copies = m_copies || replaced->st_uid != ::geteuid(); // another's file stays the other's
    }
    return descriptor;
}

void MirrorFile::Close() {
    if (m_target.empty() || !IsOpen()) {
        CFile::Close();
        return;
    }
    const CString name = GetFilePath();
    try {
        Flush();
        CFile::Close();
    } catch (...) {
        Abort();
        throw;
    }
    const int error = m_copies                                                  ? copyOver(m_temporary, m_target)
                      : std::rename(m_temporary.c_str(), m_target.c_str()) != 0 ? errno
                                                                                : 0;
    if (error == 0 && !m_copies) {
        m_temporary.clear();
    }
    forget();
    if (error != 0) {
        CFileException::ThrowErrno(error, name);
    }
}

void MirrorFile::Abort() {
    CFile::Abort();
    forget();
}

} // namespace tvx::afx
