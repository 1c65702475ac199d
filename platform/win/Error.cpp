#include "platform/win/Error.h"

#include <algorithm>
#include <array>
#include <cerrno>

namespace {

thread_local DWORD lastError = ERROR_SUCCESS;

struct ErrnoEntry {
    int errnoValue;
    DWORD error;
};

constexpr ErrnoEntry errnoTable[] = {
    {ENOENT, ERROR_FILE_NOT_FOUND},
    {ENOTDIR, ERROR_PATH_NOT_FOUND},
    {ELOOP, ERROR_PATH_NOT_FOUND},
    {EMFILE, ERROR_TOO_MANY_OPEN_FILES},
    {ENFILE, ERROR_TOO_MANY_OPEN_FILES},
    {EACCES, ERROR_ACCESS_DENIED},
    {EPERM, ERROR_ACCESS_DENIED},
    {EISDIR, ERROR_ACCESS_DENIED},
    {EBADF, ERROR_INVALID_HANDLE},
    {ESRCH, ERROR_INVALID_PARAMETER},
    {ECHILD, ERROR_INVALID_HANDLE},
    {ENOMEM, ERROR_NOT_ENOUGH_MEMORY},
    {EAGAIN, ERROR_NOT_ENOUGH_MEMORY},
    {E2BIG, ERROR_FILENAME_EXCED_RANGE},
    {ENAMETOOLONG, ERROR_FILENAME_EXCED_RANGE},
    {EXDEV, ERROR_NOT_SAME_DEVICE},
    {EROFS, ERROR_WRITE_PROTECT},
    {ENXIO, ERROR_NOT_READY},
    {ENODEV, ERROR_NOT_READY},
    {EIO, ERROR_GEN_FAILURE},
    {ETXTBSY, ERROR_SHARING_VIOLATION},
    {EDEADLK, ERROR_LOCK_VIOLATION},
    {ENOLCK, ERROR_LOCK_VIOLATION},
    {ENOSYS, ERROR_NOT_SUPPORTED},
    {ENOTSUP, ERROR_NOT_SUPPORTED},
    {EEXIST, ERROR_FILE_EXISTS},
    {EINVAL, ERROR_INVALID_PARAMETER},
    {EDOM, ERROR_INVALID_PARAMETER},
    {EPIPE, ERROR_BROKEN_PIPE},
    {ENOSPC, ERROR_DISK_FULL},
    {EDQUOT, ERROR_DISK_FULL},
    {ERANGE, ERROR_INSUFFICIENT_BUFFER},
    {ENOTEMPTY, ERROR_DIR_NOT_EMPTY},
    {EBUSY, ERROR_BUSY},
    {ENOEXEC, ERROR_BAD_EXE_FORMAT},
    {EFBIG, ERROR_FILE_TOO_LARGE},
    {EOVERFLOW, ERROR_FILE_TOO_LARGE},
    {EINTR, ERROR_OPERATION_ABORTED},
    {EFAULT, ERROR_NOACCESS},
    {ECANCELED, ERROR_CANCELLED},
    {ETIMEDOUT, ERROR_TIMEOUT},
};

struct TextEntry {
    DWORD error;
    const char* text;
};

constexpr TextEntry textTable[] = {
    {ERROR_SUCCESS, "The operation succeeded."},
    {ERROR_INVALID_FUNCTION, "The operation makes no sense here."},
    {ERROR_FILE_NOT_FOUND, "The file does not exist."},
    {ERROR_PATH_NOT_FOUND, "The folder does not exist."},
    {ERROR_TOO_MANY_OPEN_FILES, "Too many files are open."},
    {ERROR_ACCESS_DENIED, "Access is denied."},
    {ERROR_INVALID_HANDLE, "The handle is not valid."},
    {ERROR_NOT_ENOUGH_MEMORY, "There is not enough memory."},
    {ERROR_BAD_ENVIRONMENT, "The environment is not valid."},
    {ERROR_BAD_FORMAT, "The file has a wrong format."},
    {ERROR_INVALID_DATA, "The data is damaged."},
    {ERROR_NOT_SAME_DEVICE, "The file cannot be moved to another file system."},
    {ERROR_NO_MORE_FILES, "There are no more files."},
    {ERROR_WRITE_PROTECT, "The medium is write-protected."},
    {ERROR_NOT_READY, "The device is not ready."},
    {ERROR_GEN_FAILURE, "The device does not work."},
    {ERROR_SHARING_VIOLATION, "The file is in use by another program."},
    {ERROR_LOCK_VIOLATION, "Another program has locked a part of the file."},
    {ERROR_HANDLE_EOF, "The end of the file was reached."},
    {ERROR_NOT_SUPPORTED, "The operation is not supported."},
    {ERROR_FILE_EXISTS, "The file exists already."},
    {ERROR_INVALID_PARAMETER, "A parameter is wrong."},
    {ERROR_BROKEN_PIPE, "The other end of the pipe was closed."},
    {ERROR_DISK_FULL, "The disk is full."},
    {ERROR_INSUFFICIENT_BUFFER, "The buffer is too small."},
    {ERROR_INVALID_NAME, "The name is not valid."},
    {ERROR_MOD_NOT_FOUND, "The library or one that it needs was not found."},
    {ERROR_PROC_NOT_FOUND, "The library has no such function."},
    {ERROR_DIR_NOT_EMPTY, "The folder is not empty."},
    {ERROR_BUSY, "The resource is in use."},
    {ERROR_ALREADY_EXISTS, "The object exists already."},
    {ERROR_BAD_EXE_FORMAT, "The file is not a valid program."},
    {ERROR_FILENAME_EXCED_RANGE, "The file name is too long."},
    {ERROR_FILE_TOO_LARGE, "The file is too large."},
    {ERROR_NO_DATA, "The pipe is being closed."},
    {ERROR_MORE_DATA, "There is more data."},
    {WAIT_TIMEOUT, "The time to wait has passed."},
    {ERROR_NO_MORE_ITEMS, "There are no more entries."},
    {ERROR_DIRECTORY, "The name is not that of a folder."},
    {ERROR_OPERATION_ABORTED, "The operation was interrupted."},
    {ERROR_NOACCESS, "The memory address is not valid."},
    {ERROR_INVALID_FLAGS, "A flag is wrong."},
    {ERROR_BADKEY, "The settings key is not valid."},
    {ERROR_REGISTRY_CORRUPT, "The file of the settings is damaged."},
    {ERROR_REGISTRY_IO_FAILED, "The file of the settings could not be read or written."},
    {ERROR_KEY_DELETED, "The settings key has been deleted."},
    {ERROR_CANCELLED, "The user cancelled the operation."},
    {ERROR_INVALID_WINDOW_HANDLE, "The window does not exist."},
    {ERROR_INVALID_MENU_HANDLE, "The menu does not exist."},
    {ERROR_TIMEOUT, "The operation took too long."},
    {ERROR_RESOURCE_DATA_NOT_FOUND, "The module has no resources, or its resources are damaged."},
    {ERROR_RESOURCE_TYPE_NOT_FOUND, "The module has no resource of this type."},
    {ERROR_RESOURCE_NAME_NOT_FOUND, "The module has no resource of this name."},
    {ERROR_RESOURCE_LANG_NOT_FOUND, "The module does not have the resource in this language."},
};

} // namespace

DWORD GetLastError() {
    return lastError;
}

void SetLastError(DWORD error) {
    lastError = error;
}

namespace tvx {

DWORD errorFromErrno(int errnoValue) {
    if (errnoValue == 0) {
        return ERROR_SUCCESS;
    }
    const auto* found = std::ranges::find(errnoTable, errnoValue, &ErrnoEntry::errnoValue);
    return found == std::end(errnoTable) ? ERROR_GEN_FAILURE : found->error;
}

DWORD setLastErrorFromErrno() {
    lastError = errorFromErrno(errno);
    return lastError;
}

std::string errorText(DWORD error) {
    const auto* found = std::ranges::find(textTable, error, &TextEntry::error);
    return found == std::end(textTable) ? "Error " + std::to_string(error) + "." : found->text;
}

} // namespace tvx
