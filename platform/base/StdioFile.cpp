#include "platform/base/StdioFile.h"

#include <cerrno>
#include <cstring>
#include <utility>

IMPLEMENT_DYNAMIC(CStdioFile, CFile)

namespace {

const char* streamMode(UINT openFlags) {
    switch (openFlags & 3) {
    case CFile::modeWrite:
        return "w";
    case CFile::modeReadWrite:
        return "r+";
    default:
        return "r";
    }
}

} // namespace

CStdioFile::CStdioFile(std::FILE* stream) : m_pStream(stream) {
    attach(::fileno(stream));
}

CStdioFile::CStdioFile(LPCTSTR fileName, UINT openFlags) {
    CFileException error;
    if (!CStdioFile::Open(fileName, openFlags, &error)) {
        AfxThrowFileException(error.m_cause, error.m_lOsError, error.m_strFileName);
    }
}

CStdioFile::~CStdioFile() {
    CStdioFile::Abort();
}

BOOL CStdioFile::Open(LPCTSTR fileName, UINT openFlags, CFileException* error) {
    CStdioFile::Abort();
    if (!CFile::Open(fileName, openFlags, error)) {
        return FALSE;
    }
    m_pStream = ::fdopen(descriptor(), streamMode(openFlags));
    if (!m_pStream) {
        CFile::Abort();
        AfxThrowMemoryException();
    }
    m_text = !(openFlags & typeBinary);
    m_direction = Direction::None;
    return TRUE;
}

CFile* CStdioFile::Duplicate() const {
    AfxThrowNotSupportedException();
}

void CStdioFile::Close() {
    if (!m_pStream) {
        return;
    }
    // The stream closes the file that the base knows.
    detach();
    if (std::fclose(std::exchange(m_pStream, nullptr)) != 0) {
        throwLastError();
    }
    CFile::Abort();
}

void CStdioFile::Abort() {
    if (m_pStream) {
        detach();
        std::fclose(std::exchange(m_pStream, nullptr));
    }
    CFile::Abort();
}

BOOL CStdioFile::ReadString(CString& line) {
    line.Empty();
    int character = nextCharacter();
    const bool any = character != EOF;
    for (; character != EOF && character != '\n'; character = nextCharacter()) {
        line.AppendChar(static_cast<char>(character));
    }
    checkReadError();
    return any;
}

LPTSTR CStdioFile::ReadString(LPTSTR buffer, UINT capacity) {
    if (capacity == 0) {
        return nullptr;
    }
    UINT length = 0;
    int character = 0;
    while (length + 1 < capacity && character != '\n' && (character = nextCharacter()) != EOF) {
        buffer[length++] = static_cast<char>(character);
    }
    buffer[length] = '\0';
    checkReadError();
    return length > 0 ? buffer : nullptr;
}

void CStdioFile::WriteString(LPCTSTR text) {
    Write(text, static_cast<UINT>(std::strlen(text)));
}

UINT CStdioFile::Read(void* buffer, UINT count) {
    turn(Direction::Reading);
    if (!m_text) {
        const auto read = static_cast<UINT>(std::fread(buffer, 1, count, stream()));
        checkReadError();
        return read;
    }
    UINT total = 0;
    for (int character = 0; total < count && (character = nextCharacter()) != EOF;) {
        static_cast<char*>(buffer)[total++] = static_cast<char>(character);
    }
    checkReadError();
    return total;
}

void CStdioFile::Write(const void* buffer, UINT count) {
    turn(Direction::Writing);
    if (std::fwrite(buffer, 1, count, stream()) != count) {
        throwLastError();
    }
}

void CStdioFile::Flush() {
    if (m_pStream && std::fflush(m_pStream) != 0) {
        throwLastError();
    }
}

ULONGLONG CStdioFile::Seek(LONGLONG offset, UINT from) {
    constexpr int origins[] = {SEEK_SET, SEEK_CUR, SEEK_END};
    if (from > end) {
        AfxThrowInvalidArgException();
    }
    if (::fseeko(stream(), offset, origins[from]) != 0) {
        // Before the beginning, or beyond what an offset can hold: the call is wrong, not the disk.
        if (errno == EINVAL || errno == EOVERFLOW) {
            AfxThrowFileException(CFileException::badSeek, errno, GetFilePath());
        }
        throwLastError();
    }
    m_direction = Direction::None;
    return GetPosition();
}

ULONGLONG CStdioFile::GetPosition() const {
    const off_t position = ::ftello(stream());
    if (position < 0) {
        throwLastError();
    }
    return static_cast<ULONGLONG>(position);
}

ULONGLONG CStdioFile::GetLength() const {
    // What waits in the stream is unknown to the system, which is asked for the length.
    if (std::fflush(stream()) != 0) {
        throwLastError();
    }
    return CFile::GetLength();
}

void CStdioFile::SetLength(ULONGLONG length) {
    Flush();
    CFile::SetLength(length);
}

/// Between reading and writing a stream must be repositioned.
void CStdioFile::turn(Direction direction) {
    if (m_direction != Direction::None && m_direction != direction) {
        std::fseek(stream(), 0, SEEK_CUR);
    }
    m_direction = direction;
}

int CStdioFile::nextCharacter() {
    turn(Direction::Reading);
    const int character = std::getc(stream());
    if (!m_text || character != '\r') {
        return character;
    }
    const int following = std::getc(stream());
    // Only the pair is a line end: a carriage return alone is text.
    if (following == '\n') {
        return following;
    }
    if (following != EOF) {
        std::ungetc(following, stream());
    }
    return character;
}

void CStdioFile::checkReadError() {
    if (std::ferror(stream())) {
        // Else every later read would report this error again.
        std::clearerr(stream());
        throwLastError();
    }
}

std::FILE* CStdioFile::stream() const {
    if (!m_pStream) {
        AfxThrowFileException(CFileException::invalidFile, EBADF);
    }
    return m_pStream;
}
