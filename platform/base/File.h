#pragma once

#include "platform/base/Exception.h"
#include "platform/base/Object.h"
#include "platform/base/String.h"

#include <ctime>

/// What CFile::GetStatus tells about a file.
struct TVX_PLATFORM_API CFileStatus {
    /// When the file's entry last changed, its contents last changed, it was last read: seconds since 1970, UTC.
    std::time_t m_ctime = 0;
    std::time_t m_mtime = 0;
    std::time_t m_atime = 0;
    /// Size in bytes.
    ULONGLONG m_size = 0;
    /// Bits of CFile::Attribute.
    BYTE m_attribute = 0;
    /// The whole name.
    CString m_szFullName;
};

/// A file, read and written without a buffer of its own. Hosts make one on the stack; the destructor closes it.
///
/// Names come in the framework's form (`C:\a\b`) or the system's (`/a/b`); see SystemPath.h. Operations raise
/// CFileException, except Open, which reports its failure. Errors that are found only while closing are lost in the
/// destructor: call Close() after writing.
///
/// @code
/// CFile file;
/// CFileException error;
/// if (!file.Open("drawing.brd", CFile::modeCreate | CFile::modeWrite, &error))
///     error.ReportError();
/// @endcode
class TVX_PLATFORM_API CFile : public CObject {
    DECLARE_DYNAMIC(CFile)

public:
    /// How to open a file: one mode, or'ed with the others. Sharing is not restricted on this platform; the share flags
    /// are accepted. Files are never inherited by child processes.
    enum OpenFlags : UINT {
        modeRead = 0x0000,
        modeWrite = 0x0001,
        modeReadWrite = 0x0002,
        shareCompat = 0x0000,
        shareExclusive = 0x0010,
        shareDenyWrite = 0x0020,
        shareDenyRead = 0x0030,
        shareDenyNone = 0x0040,
        modeNoInherit = 0x0080,
        modeCreate = 0x1000,     ///< make the file, or empty an existing one
        modeNoTruncate = 0x2000, ///< with modeCreate: keep the contents of an existing file
        typeText = 0x4000,       ///< for CStdioFile: "\r\n" is read as "\n"
        typeBinary = 0x8000,
        osNoBuffer = 0x10000,
        osWriteThrough = 0x20000,
        osRandomAccess = 0x40000,
        osSequentialScan = 0x80000,
    };
    /// What a file is like. `hidden` is a name that begins with a dot.
    enum Attribute : BYTE {
        normal = 0,
        readOnly = 0x01,
        hidden = 0x02,
        system = 0x04,
        directory = 0x10,
        archive = 0x20
    };
    /// Where Seek counts from.
    enum SeekPosition : UINT { begin = 0, current = 1, end = 2 };

    CFile() = default;
    /// Opens a file; raises CFileException when that fails.
    CFile(LPCTSTR fileName, UINT openFlags);
    ~CFile() override;

    /// Opens a file. An open one is closed first.
    /// @param error  receives the reason of a failure; may be null
    /// @return whether the file is open
    virtual BOOL Open(LPCTSTR fileName, UINT openFlags, CFileException* error = nullptr);
    /// Another object for the same open file, with the same position. The caller owns it.
    virtual CFile* Duplicate() const;
    /// Closes the file; one that is not open stays closed. Raises CFileException when what was written cannot be kept.
    virtual void Close();
    /// Closes the file whatever happens, and raises nothing.
    virtual void Abort();

    /// Reads up to `count` bytes.
    /// @return how many were read: fewer only at the end of the file
    virtual UINT Read(void* buffer, UINT count);
    /// Writes all `count` bytes, or raises CFileException (`diskFull` where that is the reason).
    virtual void Write(const void* buffer, UINT count);
    /// Brings what was written to the device.
    virtual void Flush();
    /// Moves to a position, which may lie behind the end but not before the beginning (`badSeek`).
    /// @param offset  bytes, negative ones towards the beginning
    /// @param from    one of SeekPosition
    /// @return the new position from the beginning
    virtual ULONGLONG Seek(LONGLONG offset, UINT from);
    /// Moves to the end and returns the length.
    ULONGLONG SeekToEnd();
    /// Moves to the beginning.
    void SeekToBegin();
    /// Bytes from the beginning to where the next Read or Write takes place.
    virtual ULONGLONG GetPosition() const;
    /// Size in bytes.
    virtual ULONGLONG GetLength() const;
    /// Cuts the file, or fills it up with zeros.
    virtual void SetLength(ULONGLONG length);

    /// The whole name, in the form it was opened with; empty for a file without a name.
    virtual CString GetFilePath() const;
    /// The last part of the name.
    virtual CString GetFileName() const;
    /// The last part of the name without its extension.
    virtual CString GetFileTitle() const;
    /// Names a file that was not opened by name, for messages.
    virtual void SetFilePath(LPCTSTR name);
    /// @return whether the file is open and its state could be read
    BOOL GetStatus(CFileStatus& status) const;
    /// @return whether the file exists and its state could be read
    static BOOL GetStatus(LPCTSTR fileName, CFileStatus& status);
    /// Renames a file; an existing one under the new name is not overwritten (`accessDenied`).
    static void Rename(LPCTSTR oldName, LPCTSTR newName);
    /// Removes a file, not a folder.
    static void Remove(LPCTSTR fileName);

    /// Whether a file is open.
    [[nodiscard]] virtual BOOL IsOpen() const noexcept;

protected:
    /// The system's number of the open file, or -1.
    [[nodiscard]] int descriptor() const noexcept;
    /// Takes an open file of the system's; it is closed with this object.
    void attach(int descriptor) noexcept;
    /// Gives the open file away: the caller closes it.
    int detach() noexcept;
    /// Raises what the system's last error number means.
    [[noreturn]] void throwLastError() const;

private:
    int m_descriptor = -1;
    CString m_fileName;
};

/// Whether two names are written alike without regard to case. Neither is completed or looked for.
TVX_PLATFORM_API BOOL AfxComparePath(LPCTSTR first, LPCTSTR second);
