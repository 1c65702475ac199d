#pragma once

#include "platform/base/File.h"

#include <cstdio>

/// A text file with a buffer, read and written line by line.
///
/// With `typeText` (the default where `typeBinary` is not given) a line end "\r\n" is read as "\n"; what is written
/// stays as it is. Errors of buffered writing appear in Flush() and Close().
///
/// @code
/// CStdioFile file("drawing.brd", CFile::modeRead);
/// CString line;
/// while (file.ReadString(line))
///     parse(line);
/// @endcode
class TVX_PLATFORM_API CStdioFile : public CFile {
    DECLARE_DYNAMIC(CStdioFile)

public:
    CStdioFile() = default;
    /// Uses a stream that is open already, such as stdout, and closes it.
    explicit CStdioFile(std::FILE* stream);
    /// Opens a file; raises CFileException when that fails.
    CStdioFile(LPCTSTR fileName, UINT openFlags);
    ~CStdioFile() override;

    /// Reads a line, of any length and with embedded zeros.
    /// @param line  receives the line without its end
    /// @return FALSE when there was nothing left to read
    virtual BOOL ReadString(CString& line);
    /// Reads a line, or as much of it as fits, with its end "\n".
    /// @param buffer    receives the line, always terminated
    /// @param capacity  size of the buffer, the terminator included
    /// @return `buffer`, or null when there was nothing left to read
    virtual LPTSTR ReadString(LPTSTR buffer, UINT capacity);
    /// Writes a text; add "\n" where a line ends.
    virtual void WriteString(LPCTSTR text);

    BOOL Open(LPCTSTR fileName, UINT openFlags, CFileException* error = nullptr) override;
    /// Not possible with a buffer: raises CNotSupportedException.
    CFile* Duplicate() const override;
    void Close() override;
    void Abort() override;
    UINT Read(void* buffer, UINT count) override;
    void Write(const void* buffer, UINT count) override;
    void Flush() override;
    ULONGLONG Seek(LONGLONG offset, UINT from) override;
    ULONGLONG GetPosition() const override;
    ULONGLONG GetLength() const override;
    void SetLength(ULONGLONG length) override;

    /// The stream behind the file; null when it is closed.
    std::FILE* m_pStream = nullptr;

private:
    enum class Direction { None, Reading, Writing };

    void turn(Direction direction);
    int nextCharacter();
    void checkReadError();
    std::FILE* stream() const;

    bool m_text = true;
    Direction m_direction = Direction::None;
};
