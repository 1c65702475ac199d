#include "platform/base/File.h"

#include "platform/base/Text.h"
#include "platform/base/detail/Locate.h"

#include <algorithm>
#include <cerrno>
#include <cstdio>
#include <fcntl.h>
#include <filesystem>
#include <limits>
#include <string>
#include <sys/stat.h>
#include <unistd.h>
#include <utility>

IMPLEMENT_DYNAMIC(CFile, CObject)

namespace {

constexpr int noDescriptor = -1;
constexpr mode_t newFileMode = 0666;

int systemFlags(UINT openFlags) {
    int flags = O_CLOEXEC;
    switch (openFlags & 3) {
    case CFile::modeWrite:
        flags |= O_WRONLY;
        break;
    case CFile::modeReadWrite:
        flags |= O_RDWR;
        break;
    default:
        flags |= O_RDONLY;
    }
    if (openFlags & CFile::modeCreate) {
        flags |= O_CREAT | (openFlags & CFile::modeNoTruncate ? 0 : O_TRUNC);
    }
    if (openFlags & CFile::osWriteThrough) {
        flags |= O_SYNC;
    }
    return flags;
}

/// Opens a file, but no folder, which the system would open for reading. -1 with errno set on failure.
int openFile(const std::string& path, int flags) {
    int opened = noDescriptor;
    do {
        opened = ::open(path.c_str(), flags, newFileMode);
    } while (opened == noDescriptor && errno == EINTR);
    struct stat state{};
    if (opened != noDescriptor && ::fstat(opened, &state) == 0 && S_ISDIR(state.st_mode)) {
        ::close(opened);
        errno = EISDIR;
        return noDescriptor;
    }
    return opened;
}

std::string requiredPath(LPCTSTR name, tvx::PathUse use = tvx::PathUse::Existing) {
    std::optional<std::string> path = tvx::systemPath(name ? name : "", use);
    if (!path) {
        AfxThrowFileException(CFileException::badPath, -1, name);
    }
    return *std::move(path);
}

std::size_t nameStart(std::string_view name) {
    const std::size_t separator = name.find_last_of("\\/");
    return separator == std::string_view::npos ? 0 : separator + 1;
}

/// A relative name with the current folder before it, in the form that the name has.
CString absoluteName(LPCTSTR name) {
    const std::string_view given(name);
    if (given.empty() || given.front() == '/' || given.front() == '\\' || tvx::hasDrive(given)) {
        return name;
    }
    const bool isSystemForm = given.find('\\') == std::string_view::npos;
    std::error_code error;
    const std::string folder = isSystemForm ? std::filesystem::current_path(error).string() : tvx::currentFolderName();
    if (folder.empty()) {
        return name;
    }
    const bool isRoot = folder.back() == '/' || folder.back() == '\\';
    return CString(std::string_view(folder)) + (isRoot ? "" : isSystemForm ? "/" : "\\") + name;
}

void fillStatus(CFileStatus& status, const struct stat& state, const CString& fullName) {
    status.m_ctime = state.st_ctime;
    status.m_mtime = state.st_mtime;
    status.m_atime = state.st_atime;
    status.m_size = static_cast<ULONGLONG>(state.st_size);
    status.m_attribute = tvx::attributesOf(state, fullName.View());
    status.m_szFullName = fullName;
}

int checkedOrigin(UINT from) {
    constexpr int origins[] = {SEEK_SET, SEEK_CUR, SEEK_END};
    if (from >= std::size(origins)) {
        AfxThrowInvalidArgException();
    }
    return origins[from];
}

} // namespace

BYTE tvx::attributesOf(const struct stat& state, std::string_view name) {
    BYTE attributes = CFile::normal;
    if (!(state.st_mode & (S_IWUSR | S_IWGRP | S_IWOTH))) {
        attributes |= CFile::readOnly;
    }
    if (S_ISDIR(state.st_mode)) {
        attributes |= CFile::directory;
    }
    const std::string_view last = name.substr(nameStart(name));
    if (last.starts_with('.') && last != "." && last != "..") {
        attributes |= CFile::hidden;
    }
    return attributes;
}

BOOL AfxComparePath(LPCTSTR first, LPCTSTR second) {
    return tvx::text::equalNoCase(first ? first : "", second ? second : "");
}

CFile::CFile(LPCTSTR fileName, UINT openFlags) {
    CFileException error;
    if (!CFile::Open(fileName, openFlags, &error)) {
        AfxThrowFileException(error.m_cause, error.m_lOsError, error.m_strFileName);
    }
}

CFile::~CFile() {
    CFile::Abort();
}

BOOL CFile::Open(LPCTSTR fileName, UINT openFlags, CFileException* error) {
    Abort();
    const auto use = openFlags & modeCreate ? tvx::PathUse::Creating : tvx::PathUse::Existing;
    const std::optional<std::string> path = tvx::systemPath(fileName ? fileName : "", use);
    m_descriptor = path ? openFile(*path, systemFlags(openFlags)) : noDescriptor;
    if (m_descriptor != noDescriptor) {
        m_fileName = absoluteName(fileName);
        return TRUE;
    }
    if (error) {
        error->m_lOsError = path ? errno : -1;
        error->m_cause = path ? CFileException::ErrnoToException(errno) : CFileException::badPath;
        error->m_strFileName = fileName;
    }
    return FALSE;
}

CFile* CFile::Duplicate() const {
    const int copied = ::fcntl(m_descriptor, F_DUPFD_CLOEXEC, 0);
    if (copied == noDescriptor) {
        throwLastError();
    }
    auto* const duplicate = new CFile;
    duplicate->m_descriptor = copied;
    duplicate->m_fileName = m_fileName;
    return duplicate;
}

void CFile::Close() {
    if (m_descriptor == noDescriptor) {
        return;
    }
    // The system releases the number even when closing fails, so it is never closed twice.
    const bool closed = ::close(std::exchange(m_descriptor, noDescriptor)) == 0 || errno == EINTR;
    if (!closed) {
        throwLastError();
    }
    m_fileName.Empty();
}

void CFile::Abort() {
    if (m_descriptor != noDescriptor) {
        ::close(std::exchange(m_descriptor, noDescriptor));
    }
    m_fileName.Empty();
}

UINT CFile::Read(void* buffer, UINT count) {
    UINT total = 0;
    while (total < count) {
        const ssize_t got = ::read(m_descriptor, static_cast<BYTE*>(buffer) + total, count - total);
        if (got < 0 && errno == EINTR) {
            continue;
        }
        if (got < 0) {
            throwLastError();
        }
        if (got == 0) {
            break;
        }
        total += static_cast<UINT>(got);
    }
    return total;
}

void CFile::Write(const void* buffer, UINT count) {
    UINT total = 0;
    while (total < count) {
        const ssize_t put = ::write(m_descriptor, static_cast<const BYTE*>(buffer) + total, count - total);
        if (put < 0 && errno == EINTR) {
            continue;
        }
        if (put < 0) {
            throwLastError();
        }
        total += static_cast<UINT>(put);
    }
}

void CFile::Flush() {
    // Pipes and terminals cannot be flushed and need not be.
    if (m_descriptor != noDescriptor && ::fsync(m_descriptor) != 0 && errno != EINVAL && errno != EROFS) {
        throwLastError();
    }
}

ULONGLONG CFile::Seek(LONGLONG offset, UINT from) {
    const off_t position = ::lseek(m_descriptor, offset, checkedOrigin(from));
    if (position >= 0) {
        return static_cast<ULONGLONG>(position);
    }
    if (errno == EINVAL || errno == EOVERFLOW) {
        AfxThrowFileException(CFileException::badSeek, errno, m_fileName);
    }
    throwLastError();
}

ULONGLONG CFile::SeekToEnd() {
    return Seek(0, end);
}

void CFile::SeekToBegin() {
    Seek(0, begin);
}

ULONGLONG CFile::GetPosition() const {
    const off_t position = ::lseek(m_descriptor, 0, SEEK_CUR);
    if (position < 0) {
        throwLastError();
    }
    return static_cast<ULONGLONG>(position);
}

ULONGLONG CFile::GetLength() const {
    struct stat state{};
    if (::fstat(m_descriptor, &state) != 0) {
        throwLastError();
    }
    return static_cast<ULONGLONG>(state.st_size);
}

void CFile::SetLength(ULONGLONG length) {
    if (length > static_cast<ULONGLONG>(std::numeric_limits<off_t>::max())) {
        AfxThrowFileException(CFileException::diskFull, EFBIG, m_fileName);
    }
    if (::ftruncate(m_descriptor, static_cast<off_t>(length)) != 0) {
        throwLastError();
    }
}

CString CFile::GetFilePath() const {
    return m_fileName;
}

CString CFile::GetFileName() const {
    return m_fileName.Mid(static_cast<int>(nameStart(m_fileName.View())));
}

CString CFile::GetFileTitle() const {
    const CString name = GetFileName();
    const int dot = name.ReverseFind('.');
    return dot > 0 ? name.Left(dot) : name;
}

void CFile::SetFilePath(LPCTSTR name) {
    m_fileName = name;
}

BOOL CFile::GetStatus(CFileStatus& status) const {
    struct stat state{};
    if (::fstat(m_descriptor, &state) != 0) {
        return FALSE;
    }
    fillStatus(status, state, m_fileName);
    return TRUE;
}

BOOL CFile::GetStatus(LPCTSTR fileName, CFileStatus& status) {
    const std::optional<std::string> path = tvx::systemPath(fileName ? fileName : "");
    struct stat state{};
    if (!path || ::stat(path->c_str(), &state) != 0) {
        return FALSE;
    }
    fillStatus(status, state, absoluteName(fileName));
    return TRUE;
}

void CFile::Rename(LPCTSTR oldName, LPCTSTR newName) {
    const std::string from = requiredPath(oldName);
    const std::string to = requiredPath(newName, tvx::PathUse::Creating);
    int result = ::renameat2(AT_FDCWD, from.c_str(), AT_FDCWD, to.c_str(), RENAME_NOREPLACE);
    // Some network file systems cannot refuse to replace; there the name is asked for first.
    if (result != 0 && errno == EINVAL) {
        if (::access(to.c_str(), F_OK) == 0) {
            errno = EEXIST;
        } else {
            result = ::rename(from.c_str(), to.c_str());
        }
    }
    if (result != 0) {
        CFileException::ThrowErrno(errno, oldName);
    }
}

void CFile::Remove(LPCTSTR fileName) {
    if (::unlink(requiredPath(fileName).c_str()) != 0) {
        CFileException::ThrowErrno(errno, fileName);
    }
}

BOOL CFile::IsOpen() const noexcept {
    return m_descriptor != noDescriptor;
}

int CFile::descriptor() const noexcept {
    return m_descriptor;
}

void CFile::attach(int descriptor) noexcept {
    m_descriptor = descriptor;
}

int CFile::detach() noexcept {
    return std::exchange(m_descriptor, noDescriptor);
}

void CFile::throwLastError() const {
    CFileException::ThrowErrno(errno, m_fileName);
}
