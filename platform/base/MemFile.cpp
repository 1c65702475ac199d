#include "platform/base/MemFile.h"

#include <algorithm>
#include <cstdlib>
#include <cstring>
#include <limits>

IMPLEMENT_DYNAMIC(CMemFile, CFile)

namespace {

constexpr ULONGLONG largestFile = std::numeric_limits<std::ptrdiff_t>::max() / 2;

} // namespace

void CMemFile::Free::operator()(BYTE* memory) const noexcept {
    std::free(memory);
}

CMemFile::CMemFile(UINT growBytes) {
    UNREFERENCED_PARAMETER(growBytes);
}

CMemFile::CMemFile(BYTE* buffer, UINT size) {
    Attach(buffer, size);
}

CMemFile::~CMemFile() = default;

void CMemFile::Attach(BYTE* buffer, UINT size) {
    CMemFile::Abort();
    m_data = buffer;
    m_capacity = m_length = size;
    m_attached = true;
}

BYTE* CMemFile::Detach() {
    BYTE* const data = m_data;
    static_cast<void>(m_own.release());
    CMemFile::Abort();
    return data;
}

BOOL CMemFile::Open(LPCTSTR, UINT, CFileException*) {
    AfxThrowNotSupportedException();
}

CFile* CMemFile::Duplicate() const {
    AfxThrowNotSupportedException();
}

void CMemFile::Close() {
    Abort();
}

void CMemFile::Abort() {
    m_own.reset();
    m_data = nullptr;
    m_capacity = m_length = m_position = 0;
    m_attached = false;
}

UINT CMemFile::Read(void* buffer, UINT count) {
    const ULONGLONG left = m_position < m_length ? m_length - m_position : 0;
    const auto read = static_cast<UINT>(std::min<ULONGLONG>(count, left));
    if (read > 0) {
        std::memcpy(buffer, m_data + m_position, read);
    }
    m_position += read;
    return read;
}

void CMemFile::Write(const void* buffer, UINT count) {
    if (count == 0) {
        return;
    }
    if (m_position + count > m_length) {
        SetLength(m_position + count);
    }
    std::memcpy(m_data + m_position, buffer, count);
    m_position += count;
}

void CMemFile::Flush() {}

ULONGLONG CMemFile::Seek(LONGLONG offset, UINT from) {
    if (from > end) {
        AfxThrowInvalidArgException();
    }
    const ULONGLONG base = from == begin ? 0 : from == current ? m_position : m_length;
    const ULONGLONG position = base + static_cast<ULONGLONG>(offset);
    // A position before the beginning wraps round to a huge number, so one comparison refuses both.
    if (position > largestFile) {
        AfxThrowFileException(CFileException::badSeek);
    }
    return m_position = position;
}

ULONGLONG CMemFile::GetPosition() const {
    return m_position;
}

ULONGLONG CMemFile::GetLength() const {
    return m_length;
}

void CMemFile::SetLength(ULONGLONG length) {
    reserve(length);
    if (length > m_length) {
        std::memset(m_data + m_length, 0, length - m_length);
    }
    m_length = length;
}

BOOL CMemFile::IsOpen() const noexcept {
    return TRUE;
}

void CMemFile::reserve(ULONGLONG size) {
    if (size <= m_capacity) {
        return;
    }
    if (m_attached || size > largestFile) {
        AfxThrowMemoryException();
    }
    const ULONGLONG capacity = std::max<ULONGLONG>({size, m_capacity + m_capacity / 2, 1024});
    void* const grown = std::realloc(m_own.get(), capacity);
    if (!grown) {
        AfxThrowMemoryException();
    }
    static_cast<void>(m_own.release());
    m_own.reset(static_cast<BYTE*>(grown));
    m_data = m_own.get();
    m_capacity = capacity;
}
