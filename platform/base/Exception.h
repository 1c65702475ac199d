#pragma once

/// @file
/// The framework's exceptions. They are thrown by pointer and caught by pointer; whoever catches one for good calls
/// Delete() (the CATCH macros do it).
///
/// @code
/// try {
///     CFile file("drawing.brd", CFile::modeRead);
/// } catch (CFileException* e) {
///     e->ReportError();
///     e->Delete();
/// }
/// @endcode

#include "platform/base/Object.h"
#include "platform/base/String.h"

#include <new>
#include <stdexcept>

/// Base of the framework's exceptions. Made on the heap by the AfxThrow functions, or as a static object that survives
/// Delete(), which is what the ones do that must be thrown when no memory is left.
class TVX_PLATFORM_API CException : public CObject {
    DECLARE_DYNAMIC(CException)

public:
    CException() = default;
    /// @param autoDelete  whether Delete() deletes the object: FALSE for static objects
    explicit CException(BOOL autoDelete);
    /// Ends the life of a caught exception: deletes it if it was made on the heap.
    void Delete();
    /// Describes the exception for the user.
    /// @param text         receives the description, cut at `capacity`, always terminated
    /// @param capacity     size of `text` in bytes, the terminator included
    /// @param helpContext  receives the help context, 0 when there is none; may be null
    /// @return whether there is a description; when not, `text` is empty
    virtual BOOL GetErrorMessage(LPTSTR text, UINT capacity, UINT* helpContext = nullptr) const;
    /// Tells the user, in a message box where there is a display, else on standard error.
    /// @param type      style of the message box, 0 for plain OK
    /// @param fallback  string shown when the exception has no description, 0 for none
    /// @return the button that was pressed
    virtual int ReportError(UINT type = 0, UINT fallback = 0);

    /// Whether Delete() deletes the object.
    BOOL m_bAutoDelete = TRUE;

protected:
    /// The description as GetErrorMessage gives it, uncut; empty when there is none.
    virtual CString Describe() const;
};

/// Base of exceptions whose description is known when they are made.
class TVX_PLATFORM_API CSimpleException : public CException {
    DECLARE_DYNAMIC(CSimpleException)

public:
    CSimpleException() = default;
    /// As CException's.
    explicit CSimpleException(BOOL autoDelete);
};

/// No memory is left.
class TVX_PLATFORM_API CMemoryException : public CSimpleException {
    DECLARE_DYNAMIC(CMemoryException)

public:
    using CSimpleException::CSimpleException;

protected:
    CString Describe() const override;
};

/// An operation that the object cannot do.
class TVX_PLATFORM_API CNotSupportedException : public CSimpleException {
    DECLARE_DYNAMIC(CNotSupportedException)

public:
    using CSimpleException::CSimpleException;

protected:
    CString Describe() const override;
};

/// A resource is missing or damaged.
class TVX_PLATFORM_API CResourceException : public CSimpleException {
    DECLARE_DYNAMIC(CResourceException)

public:
    using CSimpleException::CSimpleException;

protected:
    CString Describe() const override;
};

/// The operation ends because of something the user has been told already; it is not reported again.
class TVX_PLATFORM_API CUserException : public CSimpleException {
    DECLARE_DYNAMIC(CUserException)

public:
    using CSimpleException::CSimpleException;
};

/// An argument that makes no sense, such as an index outside an array.
class TVX_PLATFORM_API CInvalidArgException : public CSimpleException {
    DECLARE_DYNAMIC(CInvalidArgException)

public:
    using CSimpleException::CSimpleException;

protected:
    CString Describe() const override;
};

/// A file operation failed.
class TVX_PLATFORM_API CFileException : public CException {
    DECLARE_DYNAMIC(CFileException)

public:
    /// Why it failed. The numbers are those hosts know.
    enum Cause {
        none = 0,
        genericException = 1,
        fileNotFound = 2,
        badPath = 3,
        tooManyOpenFiles = 4,
        accessDenied = 5,
        invalidFile = 6,
        removeCurrentDir = 7,
        directoryFull = 8,
        badSeek = 9,
        hardIO = 10,
        sharingViolation = 11,
        lockViolation = 12,
        diskFull = 13,
        endOfFile = 14,
    };

    /// @param cause     one of Cause
    /// @param osError   the system's error number (errno), -1 when there is none
    /// @param fileName  the file, null when it is not known
    explicit CFileException(int cause = none, LONG osError = -1, LPCSTR fileName = nullptr);

    /// The cause that a system error number (errno) means; genericException for those without one of their own.
    static int ErrnoToException(int error);
    /// Throws the exception that a system error number means.
    [[noreturn]] static void ThrowErrno(int error, LPCSTR fileName = nullptr);

    /// One of Cause; the system's error number, -1 when there is none; the file, empty when it is not known.
    int m_cause;
    LONG m_lOsError;
    CString m_strFileName;

protected:
    CString Describe() const override;
};

/// An archive is damaged, of an unknown version, or used in the wrong direction.
class TVX_PLATFORM_API CArchiveException : public CException {
    DECLARE_DYNAMIC(CArchiveException)

public:
    /// Why it failed. The numbers are those hosts know.
    enum Cause {
        none = 0,
        genericException = 1,
        readOnly = 2,
        endOfFile = 3,
        writeOnly = 4,
        badIndex = 5,
        badClass = 6,
        badSchema = 7,
    };

    /// @param cause     one of Cause
    /// @param fileName  the archive's file, null when it is not known
    explicit CArchiveException(int cause = none, LPCSTR fileName = nullptr);

    /// One of Cause; the archive's file, empty when it is not known.
    int m_cause;
    CString m_strFileName;

protected:
    CString Describe() const override;
};

/// Throw the exception named. The memory, not-supported, resource, user and argument exceptions are static objects.
/// @{
[[noreturn]] TVX_PLATFORM_API void AfxThrowMemoryException();
[[noreturn]] TVX_PLATFORM_API void AfxThrowNotSupportedException();
[[noreturn]] TVX_PLATFORM_API void AfxThrowResourceException();
[[noreturn]] TVX_PLATFORM_API void AfxThrowUserException();
[[noreturn]] TVX_PLATFORM_API void AfxThrowInvalidArgException();
[[noreturn]] TVX_PLATFORM_API void AfxThrowFileException(int cause, LONG osError = -1, LPCSTR fileName = nullptr);
[[noreturn]] TVX_PLATFORM_API void AfxThrowArchiveException(int cause, LPCSTR fileName = nullptr);
/// @}

namespace tvx {

/// Calls a function that allocates; where the standard library reports an exhausted heap or an impossible size, the
/// framework's memory exception is raised.
/// @return what the function returns
template <typename Function>
auto allocating(Function function) {
    try {
        return function();
    } catch (const std::bad_alloc&) {
        AfxThrowMemoryException();
    } catch (const std::length_error&) {
        AfxThrowMemoryException();
    }
}

/// Shows an exception's text to the user: CException::ReportError calls it.
/// @param text      the exception's description, empty when it has none
/// @param type      style of the message box
/// @param fallback  number of the string to show when `text` is empty, 0 for none
/// @return the button that was pressed
using ExceptionReporter = int (*)(const CString& text, UINT type, UINT fallback);

/// Installs the function that shows exceptions; null goes back to standard error. Called once by the floor that has
/// message boxes.
TVX_PLATFORM_API void setExceptionReporter(ExceptionReporter reporter) noexcept;

/// Deletes the exception that a TRY block has caught when the block is left, unless THROW_LAST passes it on.
class TVX_PLATFORM_API ExceptionLink {
public:
    ExceptionLink() = default;
    ~ExceptionLink();
    ExceptionLink(const ExceptionLink&) = delete;
    ExceptionLink& operator=(const ExceptionLink&) = delete;
    /// Takes the caught exception.
    void hold(CException* exception);
    /// Lets it go, alive.
    void release();

private:
    CException* m_exception = nullptr;
};

} // namespace tvx

// Catching as hosts of before C++ exceptions wrote it. A block deletes what it has caught.

#define TRY                                                                                                            \
    {                                                                                                                  \
        ::tvx::ExceptionLink afxExceptionLink;                                                                         \
        try {
#define CATCH(class_name, exception)                                                                                   \
    }                                                                                                                  \
    catch (class_name * exception) {                                                                                   \
        afxExceptionLink.hold(exception);
#define AND_CATCH(class_name, exception) CATCH(class_name, exception)
#define END_CATCH                                                                                                      \
    }                                                                                                                  \
    }
#define CATCH_ALL(exception) CATCH(CException, exception)
#define AND_CATCH_ALL(exception) CATCH(CException, exception)
#define END_CATCH_ALL END_CATCH
#define END_TRY                                                                                                        \
    }                                                                                                                  \
    catch (CException * exception) {                                                                                   \
        afxExceptionLink.hold(exception);                                                                              \
    }                                                                                                                  \
    }
#define THROW(exception) throw exception
/// Passes the caught exception on, from inside a CATCH block.
#define THROW_LAST() (afxExceptionLink.release(), throw)
