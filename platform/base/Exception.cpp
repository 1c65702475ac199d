#include "platform/base/Exception.h"

#include "platform/base/StringSource.h"
#include "platform/base/SystemPath.h"
#include "platform/base/Text.h"

#include <algorithm>
#include <cerrno>
#include <cstdio>
#include <cstring>
#include <string>

IMPLEMENT_DYNAMIC(CException, CObject)
IMPLEMENT_DYNAMIC(CSimpleException, CException)
IMPLEMENT_DYNAMIC(CMemoryException, CSimpleException)
IMPLEMENT_DYNAMIC(CNotSupportedException, CSimpleException)
IMPLEMENT_DYNAMIC(CResourceException, CSimpleException)
IMPLEMENT_DYNAMIC(CUserException, CSimpleException)
IMPLEMENT_DYNAMIC(CInvalidArgException, CSimpleException)
IMPLEMENT_DYNAMIC(CFileException, CException)
IMPLEMENT_DYNAMIC(CArchiveException, CException)

namespace {

constexpr int buttonOk = 1;

int reportToStandardError(const CString& text, UINT, UINT fallback) {
    CString shown(text);
    if (shown.IsEmpty() && (fallback == 0 || !shown.LoadString(fallback))) {
        return buttonOk;
    }
    std::fprintf(stderr, "%s\n", shown.GetString());
    return buttonOk;
}

constinit tvx::ExceptionReporter exceptionReporter = &reportToStandardError;

/// The exceptions thrown without an allocation. Never destroyed: one may be on its way while the process ends.
template <typename Exception>
Exception* sharedException() {
    alignas(Exception) static char storage[sizeof(Exception)];
    static Exception* const exception = new (storage) Exception(FALSE);
    return exception;
}

// Made while the library is loaded, when there is memory.
[[maybe_unused]] CMemoryException* const memoryException = sharedException<CMemoryException>();

struct ErrnoCause {
    int error;
    CFileException::Cause cause;
};

constexpr ErrnoCause errnoCauses[] = {
    {0, CFileException::none},
    {EPERM, CFileException::accessDenied},
    {ENOENT, CFileException::fileNotFound},
    {EIO, CFileException::hardIO},
    {ENXIO, CFileException::fileNotFound},
    {EBADF, CFileException::invalidFile},
    {EACCES, CFileException::accessDenied},
    {EBUSY, CFileException::sharingViolation},
    {EEXIST, CFileException::accessDenied},
    {ENODEV, CFileException::badPath},
    {ENOTDIR, CFileException::badPath},
    {EISDIR, CFileException::accessDenied},
    {ENFILE, CFileException::tooManyOpenFiles},
    {EMFILE, CFileException::tooManyOpenFiles},
    {ETXTBSY, CFileException::sharingViolation},
    {EFBIG, CFileException::diskFull},
    {ENOSPC, CFileException::diskFull},
    {EDQUOT, CFileException::diskFull},
    {ESPIPE, CFileException::badSeek},
    {EROFS, CFileException::accessDenied},
    {ENAMETOOLONG, CFileException::badPath},
    {ELOOP, CFileException::badPath},
    {EAGAIN, CFileException::lockViolation},
    {EDEADLK, CFileException::lockViolation},
};

LPCSTR fileCauseText(int cause) {
    switch (cause) {
    case CFileException::none:
        return "%1: no error occurred.";
    case CFileException::fileNotFound:
        return "%1 was not found.";
    case CFileException::badPath:
        return "%1 contains an invalid path.";
    case CFileException::tooManyOpenFiles:
        return "%1 could not be opened because too many files are open.";
    case CFileException::accessDenied:
        return "Access to %1 was denied.";
    case CFileException::invalidFile:
        return "%1 is not an open file.";
    case CFileException::removeCurrentDir:
        return "%1 cannot be removed because it is the current folder.";
    case CFileException::directoryFull:
        return "%1 could not be created because the folder is full.";
    case CFileException::badSeek:
        return "A position in %1 could not be reached.";
    case CFileException::hardIO:
        return "The device reported an error while accessing %1.";
    case CFileException::sharingViolation:
        return "%1 is in use by another program.";
    case CFileException::lockViolation:
        return "%1 is locked by another program.";
    case CFileException::diskFull:
        return "The disk is full while accessing %1.";
    case CFileException::endOfFile:
        return "%1 ended unexpectedly.";
    default:
        return "An error occurred while accessing %1.";
    }
}

LPCSTR archiveCauseText(int cause) {
    switch (cause) {
    case CArchiveException::none:
        return "%1: no error occurred.";
    case CArchiveException::readOnly:
        return "%1 is being read and cannot be written.";
    case CArchiveException::endOfFile:
        return "%1 ended unexpectedly.";
    case CArchiveException::writeOnly:
        return "%1 is being written and cannot be read.";
    case CArchiveException::badIndex:
    case CArchiveException::badClass:
        return "%1 is damaged.";
    case CArchiveException::badSchema:
        return "%1 was written by another version of the program.";
    default:
        return "An error occurred while accessing %1.";
    }
}

CString withFileName(LPCSTR format, const CString& fileName) {
    CString text(format);
    text.Replace("%1", fileName.IsEmpty() ? "An unnamed file" : tvx::shownName(fileName.GetString()).c_str());
    return text;
}

} // namespace

CException::CException(BOOL autoDelete) : m_bAutoDelete(autoDelete) {}

void CException::Delete() {
    if (m_bAutoDelete) {
        delete this;
    }
}

BOOL CException::GetErrorMessage(LPTSTR text, UINT capacity, UINT* helpContext) const {
    if (helpContext) {
        *helpContext = 0;
    }
    const CString description = Describe();
    if (text && capacity > 0) {
        tvx::text::copyCut(description.View(), text, capacity);
    }
    return !description.IsEmpty();
}

int CException::ReportError(UINT type, UINT fallback) {
    return exceptionReporter(Describe(), type, fallback);
}

CString CException::Describe() const {
    return {};
}

CSimpleException::CSimpleException(BOOL autoDelete) : CException(autoDelete) {}

CString CMemoryException::Describe() const {
    return "Out of memory.";
}

CString CNotSupportedException::Describe() const {
    return "An operation was attempted that is not supported.";
}

CString CResourceException::Describe() const {
    return "A required resource is not available.";
}

CString CInvalidArgException::Describe() const {
    return "An invalid argument was encountered.";
}

CFileException::CFileException(int cause, LONG osError, LPCSTR fileName)
    : m_cause(cause), m_lOsError(osError), m_strFileName(fileName) {}

int CFileException::ErrnoToException(int error) {
    const auto* found = std::find_if(std::begin(errnoCauses), std::end(errnoCauses),
                                     [error](const ErrnoCause& entry) { return entry.error == error; });
    return found == std::end(errnoCauses) ? genericException : found->cause;
}

void CFileException::ThrowErrno(int error, LPCSTR fileName) {
    AfxThrowFileException(ErrnoToException(error), error, fileName);
}

CString CFileException::Describe() const {
    return withFileName(fileCauseText(m_cause), m_strFileName);
}

CArchiveException::CArchiveException(int cause, LPCSTR fileName) : m_cause(cause), m_strFileName(fileName) {}

CString CArchiveException::Describe() const {
    return withFileName(archiveCauseText(m_cause), m_strFileName);
}

void AfxThrowMemoryException() {
    throw sharedException<CMemoryException>();
}

void AfxThrowNotSupportedException() {
    throw sharedException<CNotSupportedException>();
}

void AfxThrowResourceException() {
    throw sharedException<CResourceException>();
}

void AfxThrowUserException() {
    throw sharedException<CUserException>();
}

void AfxThrowInvalidArgException() {
    throw sharedException<CInvalidArgException>();
}

void AfxThrowFileException(int cause, LONG osError, LPCSTR fileName) {
    throw new CFileException(cause, osError, fileName);
}

void AfxThrowArchiveException(int cause, LPCSTR fileName) {
    throw new CArchiveException(cause, fileName);
}

namespace tvx {

void setExceptionReporter(ExceptionReporter reporter) noexcept {
    exceptionReporter = reporter ? reporter : &reportToStandardError;
}

ExceptionLink::~ExceptionLink() {
    if (m_exception) {
        m_exception->Delete();
    }
}

void ExceptionLink::hold(CException* exception) {
    m_exception = exception;
}

void ExceptionLink::release() {
    m_exception = nullptr;
}

} // namespace tvx
