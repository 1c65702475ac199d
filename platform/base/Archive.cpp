#include "platform/base/Archive.h"

#include "platform/base/Text.h"

#include <algorithm>
#include <bit>
#include <cstring>
#include <string>

namespace {

constexpr int smallestBuffer = 128;
constexpr UINT textBlock = 64 * 1024;

} // namespace

CArchive::CArchive(CFile* file, UINT mode, int bufferSize)
    : m_strFileName(file->GetFilePath()), m_file(file), m_mode(mode) {
    tvx::allocating([&] { m_buffer.resize(static_cast<std::size_t>(std::max(bufferSize, smallestBuffer))); });
    // Number 0 is the null pointer.
    m_loaded.resize(1);
}

CArchive::~CArchive() {
    if (m_mode & bNoFlushOnDelete) {
        return;
    }
    try {
        Close();
    } catch (CException* e) {
        e->Delete();
    }
}

BOOL CArchive::IsLoading() const noexcept {
    return (m_mode & load) != 0;
}

BOOL CArchive::IsStoring() const noexcept {
    return !IsLoading();
}

CFile* CArchive::GetFile() const noexcept {
    return m_file;
}

void CArchive::Flush() {
    if (!m_file) {
        return;
    }
    if (IsStoring()) {
        const auto count = static_cast<UINT>(std::exchange(m_position, 0));
        if (count > 0) {
            m_file->Write(m_buffer.data(), count);
        }
        return;
    }
    const auto unread = static_cast<LONGLONG>(m_end - m_position);
    m_position = m_end = 0;
    if (unread > 0) {
        m_file->Seek(-unread, CFile::current);
    }
}

void CArchive::Close() {
    Flush();
    m_file = nullptr;
}

void CArchive::Abort() noexcept {
    m_file = nullptr;
}

UINT CArchive::Read(void* buffer, UINT count) {
    requireLoading();
    UINT total = 0;
    while (total < count && (m_position < m_end || fill())) {
        const std::size_t part = std::min<std::size_t>(count - total, m_end - m_position);
        std::memcpy(static_cast<BYTE*>(buffer) + total, m_buffer.data() + m_position, part);
        m_position += part;
        total += static_cast<UINT>(part);
    }
    return total;
}

void CArchive::EnsureRead(void* buffer, UINT count) {
    if (Read(buffer, count) != count) {
        fail(CArchiveException::endOfFile);
    }
}

void CArchive::Write(const void* buffer, UINT count) {
    requireStoring();
    if (count > m_buffer.size() - m_position) {
        Flush();
    }
    // What is no smaller than the buffer would only be copied once more on its way through it.
    if (count >= m_buffer.size()) {
        m_file->Write(buffer, count);
        return;
    }
    // Hosts write nothing from a null pointer, which memcpy may not be given.
    if (count > 0) {
        std::memcpy(m_buffer.data() + m_position, buffer, count);
    }
    m_position += count;
}

void CArchive::WriteString(LPCTSTR text) {
    Write(text, static_cast<UINT>(std::strlen(text)));
}

BOOL CArchive::ReadString(CString& line) {
    line.Empty();
    char character = 0;
    BOOL any = FALSE;
    while (Read(&character, 1) == 1) {
        any = TRUE;
        if (character == '\n') {
            break;
        }
        line.AppendChar(character);
    }
    // Texts were written on systems with either line end; a carriage return elsewhere is part of the line.
    if (character == '\n' && line.Right(1) == "\r") {
        line.Truncate(line.GetLength() - 1);
    }
    return any;
}

void CArchive::WriteCount(DWORD_PTR count) {
    // The largest number of each form says that a larger form follows, so it cannot be written in its own.
    if (count < 0xFFFF) {
        *this << static_cast<WORD>(count);
        return;
    }
    *this << WORD{0xFFFF};
    if (count < 0xFFFFFFFF) {
        *this << static_cast<DWORD>(count);
    } else {
        *this << DWORD{0xFFFFFFFF} << static_cast<ULONGLONG>(count);
    }
}

DWORD_PTR CArchive::ReadCount() {
    const WORD small = get<WORD>();
    if (small != 0xFFFF) {
        return small;
    }
    const DWORD large = get<DWORD>();
    return large != 0xFFFFFFFF ? large : get<ULONGLONG>();
}

template <typename Unsigned>
CArchive& CArchive::put(Unsigned value) {
    // Byte by byte: files have the low byte first on every machine.
    BYTE bytes[sizeof(Unsigned)];
    for (std::size_t i = 0; i < sizeof bytes; ++i) {
        bytes[i] = static_cast<BYTE>(value >> (8 * i));
    }
    Write(bytes, sizeof bytes);
    return *this;
}

template <typename Unsigned>
Unsigned CArchive::get() {
    BYTE bytes[sizeof(Unsigned)];
    EnsureRead(bytes, sizeof bytes);
    Unsigned value = 0;
    for (std::size_t i = 0; i < sizeof bytes; ++i) {
        value = static_cast<Unsigned>(value | static_cast<Unsigned>(Unsigned{bytes[i]} << (8 * i)));
    }
    return value;
}

// Used by ArchiveObjects.cpp too, where only their declarations are seen.
template CArchive& CArchive::put(BYTE);
template CArchive& CArchive::put(WORD);
template CArchive& CArchive::put(DWORD);
template CArchive& CArchive::put(ULONGLONG);
template BYTE CArchive::get();
template WORD CArchive::get();
template DWORD CArchive::get();
template ULONGLONG CArchive::get();

CArchive& CArchive::operator<<(char value) {
    return put(static_cast<BYTE>(value));
}

CArchive& CArchive::operator<<(BYTE value) {
    return put(value);
}

CArchive& CArchive::operator<<(short value) {
    return put(static_cast<WORD>(value));
}

CArchive& CArchive::operator<<(WORD value) {
    return put(value);
}

CArchive& CArchive::operator<<(int value) {
    return put(static_cast<DWORD>(value));
}

CArchive& CArchive::operator<<(unsigned int value) {
    return put(value);
}

CArchive& CArchive::operator<<(long value) {
    return *this << tvx::text::clampToInt32(value);
}

CArchive& CArchive::operator<<(unsigned long value) {
    return put(static_cast<DWORD>(std::min<unsigned long>(value, UINT32_MAX)));
}

CArchive& CArchive::operator<<(LONGLONG value) {
    return put(static_cast<ULONGLONG>(value));
}

CArchive& CArchive::operator<<(ULONGLONG value) {
    return put(value);
}

CArchive& CArchive::operator<<(float value) {
    return put(std::bit_cast<DWORD>(value));
}

CArchive& CArchive::operator<<(double value) {
    return put(ULONGLONG{std::bit_cast<std::uint64_t>(value)});
}

CArchive& CArchive::operator<<(const CString& text) {
    AfxWriteStringLength(*this, static_cast<UINT_PTR>(text.GetLength()), FALSE);
    Write(text.GetString(), static_cast<UINT>(text.GetLength()));
    return *this;
}

CArchive& CArchive::operator<<(const CObject* object) {
    WriteObject(object);
    return *this;
}

CArchive& CArchive::operator<<(SIZE size) {
    return *this << size.cx << size.cy;
}

CArchive& CArchive::operator<<(POINT point) {
    return *this << point.x << point.y;
}

CArchive& CArchive::operator<<(const RECT& rect) {
    return *this << rect.left << rect.top << rect.right << rect.bottom;
}

CArchive& CArchive::operator>>(char& value) {
    value = static_cast<char>(get<BYTE>());
    return *this;
}

CArchive& CArchive::operator>>(BYTE& value) {
    value = get<BYTE>();
    return *this;
}

CArchive& CArchive::operator>>(short& value) {
    value = static_cast<short>(get<WORD>());
    return *this;
}

CArchive& CArchive::operator>>(WORD& value) {
    value = get<WORD>();
    return *this;
}

CArchive& CArchive::operator>>(int& value) {
    value = static_cast<int>(get<DWORD>());
    return *this;
}

CArchive& CArchive::operator>>(unsigned int& value) {
    value = get<DWORD>();
    return *this;
}

CArchive& CArchive::operator>>(long& value) {
    value = static_cast<LONG>(get<DWORD>());
    return *this;
}

CArchive& CArchive::operator>>(unsigned long& value) {
    value = get<DWORD>();
    return *this;
}

CArchive& CArchive::operator>>(LONGLONG& value) {
    value = static_cast<LONGLONG>(get<ULONGLONG>());
    return *this;
}

CArchive& CArchive::operator>>(ULONGLONG& value) {
    value = get<ULONGLONG>();
    return *this;
}

CArchive& CArchive::operator>>(float& value) {
    value = std::bit_cast<float>(get<DWORD>());
    return *this;
}

CArchive& CArchive::operator>>(double& value) {
    value = std::bit_cast<double>(get<ULONGLONG>());
    return *this;
}

CArchive& CArchive::operator>>(bool& value) {
    value = get<BYTE>() != 0;
    return *this;
}

CArchive& CArchive::operator>>(CString& text) {
    int characterSize = 1;
    UINT_PTR left = AfxReadStringLength(*this, characterSize);
    if (left > static_cast<UINT_PTR>(INT_MAX) / static_cast<UINT_PTR>(characterSize)) {
        fail(CArchiveException::genericException);
    }
    left *= static_cast<UINT_PTR>(characterSize);
    // Never more at once than was there before: a damaged length takes no more memory than the archive has bytes.
    CString bytes;
    while (left > 0) {
        const int before = bytes.GetLength();
        const auto part = static_cast<UINT>(std::min<UINT_PTR>(left, std::max(textBlock, static_cast<UINT>(before))));
        EnsureRead(bytes.GetBufferSetLength(before + static_cast<int>(part)) + before, part);
        left -= part;
    }
    if (characterSize == 1) {
        text = std::move(bytes);
        return *this;
    }
    std::u16string wide;
    for (int i = 0; i + 1 < bytes.GetLength(); i += 2) {
        wide += static_cast<char16_t>(MAKEWORD(bytes[i], bytes[i + 1]));
    }
    text = CString(std::string_view(tvx::text::narrow(wide)));
    return *this;
}

CArchive& CArchive::operator>>(CObject*& object) {
    object = ReadObject(nullptr);
    return *this;
}

CArchive& CArchive::operator>>(SIZE& size) {
    return *this >> size.cx >> size.cy;
}

CArchive& CArchive::operator>>(POINT& point) {
    return *this >> point.x >> point.y;
}

CArchive& CArchive::operator>>(RECT& rect) {
    return *this >> rect.left >> rect.top >> rect.right >> rect.bottom;
}

void CArchive::requireStoring() const {
    if (!IsStoring() || !m_file) {
        fail(CArchiveException::readOnly);
    }
}

void CArchive::requireLoading() const {
    if (!IsLoading() || !m_file) {
        fail(CArchiveException::writeOnly);
    }
}

BOOL CArchive::fill() {
    m_position = 0;
    m_end = 0;
    m_end = m_file->Read(m_buffer.data(), static_cast<UINT>(m_buffer.size()));
    return m_end > 0;
}

void CArchive::fail(int cause) const {
    AfxThrowArchiveException(cause, m_strFileName);
}

void AfxWriteStringLength(CArchive& archive, UINT_PTR length, BOOL isWide) {
    if (isWide) {
        archive << BYTE{0xFF} << WORD{0xFFFE};
    }
    if (length < 0xFF) {
        archive << static_cast<BYTE>(length);
        return;
    }
    archive << BYTE{0xFF};
    if (length < 0xFFFE) {
        archive << static_cast<WORD>(length);
        return;
    }
    archive << WORD{0xFFFF};
    if (length < 0xFFFFFFFF) {
        archive << static_cast<DWORD>(length);
    } else {
        archive << DWORD{0xFFFFFFFF} << static_cast<ULONGLONG>(length);
    }
}

UINT_PTR AfxReadStringLength(CArchive& archive, int& characterSize) {
    characterSize = 1;
    BYTE small = 0;
    WORD medium = 0;
    archive >> small;
    if (small < 0xFF) {
        return small;
    }
    archive >> medium;
    if (medium == 0xFFFE) {
        characterSize = 2;
        archive >> small;
        if (small < 0xFF) {
            return small;
        }
        archive >> medium;
    }
    if (medium < 0xFFFF) {
        return medium;
    }
    DWORD large = 0;
    archive >> large;
    if (large < 0xFFFFFFFF) {
        return large;
    }
    ULONGLONG huge = 0;
    archive >> huge;
    return huge;
}
