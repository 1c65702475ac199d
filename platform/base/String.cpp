#include "platform/base/String.h"

#include "platform/base/Exception.h"
#include "platform/base/Text.h"

#include <algorithm>
#include <atomic>
#include <climits>
#include <cstdlib>
#include <cstring>
#include <new>

namespace {

/// Stands before the text in each buffer.
struct Header {
    /// Strings that share the buffer; `locked` when it must not be shared.
    std::atomic<int> owners;
    int length;
    int capacity;
};

constexpr int locked = -1;
constexpr std::size_t smallestCapacity = 16;

/// The buffer of all empty strings; never counted, never freed, never written to.
struct EmptyBuffer {
    Header header{1, 0, 0};
    char text[1] = {};
};
static_assert(offsetof(EmptyBuffer, text) == sizeof(Header));

constinit EmptyBuffer emptyBuffer;

char* emptyText() noexcept {
    return emptyBuffer.text;
}

Header& headerOf(const char* text) noexcept {
    return *reinterpret_cast<Header*>(const_cast<char*>(text) - sizeof(Header));
}

constexpr std::size_t largestLength = INT_MAX - sizeof(Header) - 1;

int checkedLength(std::size_t length) {
    if (length > largestLength) {
        AfxThrowMemoryException();
    }
    return static_cast<int>(length);
}

char* newBuffer(std::size_t length, std::size_t capacity) {
    const int checked = checkedLength(std::max(length, capacity));
    void* const memory = std::malloc(sizeof(Header) + static_cast<std::size_t>(checked) + 1);
    if (!memory) {
        AfxThrowMemoryException();
    }
    auto* const header = new (memory) Header{1, static_cast<int>(length), checked};
    char* const text = reinterpret_cast<char*>(header) + sizeof(Header);
    text[length] = '\0';
    return text;
}

char* newText(std::string_view content) {
    if (content.empty()) {
        return emptyText();
    }
    char* const text = newBuffer(content.size(), content.size());
    std::memcpy(text, content.data(), content.size());
    return text;
}

char* share(char* text) {
    if (text == emptyText()) {
        return text;
    }
    Header& header = headerOf(text);
    // Whoever locked it writes to it unseen, so the copy cannot live on it.
    if (header.owners.load(std::memory_order_relaxed) == locked) {
        return newText({text, static_cast<std::size_t>(header.length)});
    }
    header.owners.fetch_add(1, std::memory_order_relaxed);
    return text;
}

void release(char* text) noexcept {
    if (text == emptyText()) {
        return;
    }
    Header& header = headerOf(text);
    // An only owner need not subtract: nobody else is there who could copy meanwhile.
    const int owners = header.owners.load(std::memory_order_acquire);
    if (owners == 1 || owners == locked || header.owners.fetch_sub(1, std::memory_order_acq_rel) == 1) {
        std::free(&header);
    }
}

/// Frees a buffer at the end of a scope, so that text which points into it can still be copied.
class BufferKeeper {
public:
    explicit BufferKeeper(char* text) noexcept : m_text(text) {}
    ~BufferKeeper() {
        release(m_text);
    }
    BufferKeeper(const BufferKeeper&) = delete;
    BufferKeeper& operator=(const BufferKeeper&) = delete;

private:
    char* m_text;
};

bool isShared(const char* text) noexcept {
    return text == emptyText() || headerOf(text).owners.load(std::memory_order_acquire) > 1;
}

int nonNegative(int length) {
    if (length < 0) {
        AfxThrowInvalidArgException();
    }
    return length;
}

} // namespace

CStringT<char>::CStringT() noexcept : m_text(emptyText()) {}

CStringT<char>::CStringT(const CStringT& other) : m_text(share(other.m_text)) {}

CStringT<char>::CStringT(CStringT&& other) noexcept : m_text(std::exchange(other.m_text, emptyText())) {}

CStringT<char>::~CStringT() {
    release(m_text);
}

CStringT<char>::CStringT(const char* text) : m_text(newText(viewOf(text))) {}

CStringT<char>::CStringT(const char* text, int length) : CStringT() {
    SetString(text, length);
}

CStringT<char>::CStringT(char character, int repeat) : CStringT() {
    if (repeat > 0) {
        std::memset(GetBufferSetLength(repeat), character, static_cast<std::size_t>(repeat));
    }
}

CStringT<char>::CStringT(const unsigned char* text) : CStringT(reinterpret_cast<const char*>(text)) {}

CStringT<char>::CStringT(const wchar_t* text)
    : m_text(newText(tvx::text::narrow(text ? std::wstring_view(text) : std::wstring_view()))) {}

CStringT<char>::CStringT(const wchar_t* text, int length)
    : m_text(newText(tvx::text::narrow(std::wstring_view(text, text ? nonNegative(length) : 0)))) {}

CStringT<char>::CStringT(std::string_view text) : m_text(newText(text)) {}

CStringT<char>& CStringT<char>::operator=(const CStringT& other) {
    if (m_text != other.m_text) {
        const BufferKeeper old(std::exchange(m_text, share(other.m_text)));
    }
    return *this;
}

CStringT<char>& CStringT<char>::operator=(CStringT&& other) noexcept {
    std::swap(m_text, other.m_text);
    return *this;
}

CStringT<char>& CStringT<char>::operator=(const char* text) {
    assign(viewOf(text));
    return *this;
}

CStringT<char>& CStringT<char>::operator=(char character) {
    assign({&character, 1});
    return *this;
}

CStringT<char>& CStringT<char>::operator=(const unsigned char* text) {
    return *this = reinterpret_cast<const char*>(text);
}

CStringT<char>& CStringT<char>::operator=(const wchar_t* text) {
    return *this = CStringT(text);
}

void CStringT<char>::SetString(const char* text) {
    assign(viewOf(text));
}

void CStringT<char>::SetString(const char* text, int length) {
    assign({text, text ? static_cast<std::size_t>(nonNegative(length)) : 0});
}

char CStringT<char>::GetAt(int index) const {
    return (*this)[index];
}

char CStringT<char>::operator[](INT_PTR index) const {
    if (index < 0 || index > GetLength()) {
        AfxThrowInvalidArgException();
    }
    return m_text[index];
}

void CStringT<char>::SetAt(int index, char character) {
    if (index < 0 || index >= GetLength()) {
        AfxThrowInvalidArgException();
    }
    GetBuffer()[index] = character;
}

void CStringT<char>::Empty() noexcept {
    release(std::exchange(m_text, emptyText()));
}

int CStringT<char>::GetAllocLength() const noexcept {
    return headerOf(m_text).capacity;
}

char* CStringT<char>::GetBuffer() {
    return GetBuffer(0);
}

char* CStringT<char>::GetBuffer(int minimum) {
    makeOwn(nonNegative(minimum));
    return m_text;
}

char* CStringT<char>::GetBufferSetLength(int length) {
    makeOwn(nonNegative(length));
    setLength(length);
    return m_text;
}

void CStringT<char>::ReleaseBuffer(int length) {
    if (length < 0) {
        // A host that wrote over the zero is stopped by the end of the buffer.
        length = static_cast<int>(std::find(m_text, m_text + GetAllocLength(), '\0') - m_text);
    }
    ReleaseBufferSetLength(length);
}

void CStringT<char>::ReleaseBufferSetLength(int length) {
    if (length < 0 || length > GetAllocLength()) {
        AfxThrowInvalidArgException();
    }
    if (m_text != emptyText()) {
        setLength(length);
    }
}

char* CStringT<char>::LockBuffer() {
    makeOwn(0);
    headerOf(m_text).owners = locked;
    return m_text;
}

void CStringT<char>::UnlockBuffer() noexcept {
    if (headerOf(m_text).owners == locked) {
        headerOf(m_text).owners = 1;
    }
}

void CStringT<char>::Preallocate(int length) {
    makeOwn(length);
}

void CStringT<char>::FreeExtra() {
    if (GetLength() != GetAllocLength()) {
        *this = CStringT(View());
    }
}

void CStringT<char>::Truncate(int length) {
    if (length < GetLength()) {
        GetBufferSetLength(nonNegative(length));
    }
}

CStringT<char> CStringT<char>::join(std::string_view left, std::string_view right) {
    const std::size_t length = left.size() + right.size();
    if (length == 0) {
        return {};
    }
    char* const text = newBuffer(length, length);
    std::copy(left.begin(), left.end(), text);
    std::copy(right.begin(), right.end(), text + left.size());
    return CStringT(text, nullptr);
}

void CStringT<char>::assign(std::string_view text) {
    if (isShared(m_text) || text.size() > static_cast<std::size_t>(GetAllocLength())) {
        const BufferKeeper old(std::exchange(m_text, newText(text)));
        return;
    }
    if (!text.empty()) {
        // Not memcpy: the text may be a part of this one.
        std::memmove(m_text, text.data(), text.size());
    }
    setLength(static_cast<int>(text.size()));
}

void CStringT<char>::append(std::string_view text) {
    if (text.empty()) {
        return;
    }
    const std::size_t oldLength = static_cast<std::size_t>(GetLength());
    const int length = checkedLength(oldLength + text.size());
    if (isShared(m_text) || length > GetAllocLength()) {
        // Growing by half keeps appending linear; the text may lie in the old buffer, so that goes last.
        const std::size_t roomy = std::min(std::max(smallestCapacity, oldLength + oldLength / 2), largestLength);
        char* const grown = newBuffer(oldLength, std::max(static_cast<std::size_t>(length), roomy));
        std::memcpy(grown, m_text, oldLength);
        const BufferKeeper old(std::exchange(m_text, grown));
        std::memcpy(m_text + oldLength, text.data(), text.size());
        setLength(length);
        return;
    }
    std::memmove(m_text + oldLength, text.data(), text.size());
    setLength(length);
}

/// Makes the buffer this string's alone, with room for at least `capacity` bytes. The text stays.
void CStringT<char>::makeOwn(int capacity) {
    if (!isShared(m_text) && capacity <= GetAllocLength()) {
        return;
    }
    const auto length = static_cast<std::size_t>(GetLength());
    char* const own = newBuffer(length, static_cast<std::size_t>(std::max(capacity, GetLength())));
    std::memcpy(own, m_text, length);
    release(std::exchange(m_text, own));
}

void CStringT<char>::setLength(int length) noexcept {
    static_assert(sizeof(Header) - offsetof(Header, length) == lengthBeforeText, "GetLength reads it there");
    headerOf(m_text).length = length;
    m_text[length] = '\0';
}
