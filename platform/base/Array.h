#pragma once

/// @file
/// Growable arrays: the template CArray and the classes for the usual element types.

#include "platform/base/Archive.h"
#include "platform/base/Exception.h"
#include "platform/base/Object.h"
#include "platform/base/String.h"

#include <algorithm>
#include <type_traits>
#include <vector>

/// A growable array of values, held by whoever made it. Elements lie one behind the other; a pointer or reference to
/// one is valid until the array grows, shrinks or is destroyed.
///
/// An index outside the array raises CInvalidArgException. An exhausted heap raises CMemoryException and leaves the
/// array as it was. Arrays are not copied by assignment: use Copy().
///
/// @code
/// CArray<CPoint> corners;
/// corners.Add(CPoint(1, 2));
/// for (INT_PTR i = 0; i < corners.GetSize(); ++i)
///     use(corners[i]);
/// @endcode
///
/// @tparam TYPE      the element, default-constructible; for truth values take BOOL, not bool
/// @tparam ARG_TYPE  how elements are passed
template <typename TYPE, typename ARG_TYPE = const TYPE&>
class CArray : public CObject {
    static_assert(!std::is_same_v<TYPE, bool>, "elements of type bool have no address of their own: use BOOL");

public:
    CArray() = default;

    /// Number of elements.
    /// @{
    INT_PTR GetSize() const noexcept {
        return static_cast<INT_PTR>(m_items.size());
    }
    INT_PTR GetCount() const noexcept {
        return GetSize();
    }
    /// @}
    /// Whether there are no elements.
    BOOL IsEmpty() const noexcept {
        return m_items.empty();
    }
    /// The largest index; -1 for an empty array.
    INT_PTR GetUpperBound() const noexcept {
        return GetSize() - 1;
    }
    /// Cuts the array or fills it up with default values.
    /// @param growBy  a hint that hosts give for later growth; growth is geometric in any case
    void SetSize(INT_PTR size, INT_PTR growBy = -1) {
        const std::size_t wanted = countOf(size);
        tvx::allocating([&] { m_items.resize(wanted); });
    }
    /// Gives back memory beyond the elements.
    void FreeExtra() {
        tvx::allocating([&] { m_items.shrink_to_fit(); });
    }
    /// Removes all elements and gives their memory back.
    void RemoveAll() {
        std::vector<TYPE>().swap(m_items);
    }

    /// The element with an index.
    /// @{
    const TYPE& GetAt(INT_PTR index) const {
        return m_items[checked(index)];
    }
    TYPE& GetAt(INT_PTR index) {
        return m_items[checked(index)];
    }
    /// @}
    /// Replaces the element with an index.
    void SetAt(INT_PTR index, ARG_TYPE element) {
        m_items[checked(index)] = element;
    }
    /// The element with an index, to be read or changed.
    /// @{
    TYPE& ElementAt(INT_PTR index) {
        return m_items[checked(index)];
    }
    const TYPE& ElementAt(INT_PTR index) const {
        return m_items[checked(index)];
    }
    TYPE& operator[](INT_PTR index) {
        return m_items[checked(index)];
    }
    const TYPE& operator[](INT_PTR index) const {
        return m_items[checked(index)];
    }
    /// @}
    /// The first element, with the others behind it; null for an empty array.
    TYPE* GetData() noexcept {
        return m_items.empty() ? nullptr : m_items.data();
    }
    const TYPE* GetData() const noexcept {
        return m_items.empty() ? nullptr : m_items.data();
    }

    /// Sets an element; the array grows to hold it, with default values between.
    void SetAtGrow(INT_PTR index, ARG_TYPE element) {
        TYPE kept(element);
        if (index >= GetSize()) {
            SetSize(index < INTPTR_MAX ? index + 1 : index);
        }
        m_items[checked(index)] = std::move(kept);
    }
    /// Adds an element at the end.
    /// @return its index
    INT_PTR Add(ARG_TYPE element) {
        tvx::allocating([&] { m_items.push_back(element); });
        return GetUpperBound();
    }
    /// Adds the elements of another array, or of this one, at the end.
    /// @return the index of the first one added
    INT_PTR Append(const CArray& other) {
        const INT_PTR first = GetSize();
        const std::size_t count = other.m_items.size();
        tvx::allocating([&] {
            m_items.reserve(m_items.size() + count);
            std::copy_n(other.m_items.begin(), count, std::back_inserter(m_items));
        });
        return first;
    }
    /// Becomes a copy of another array.
    void Copy(const CArray& other) {
        tvx::allocating([&] { m_items = std::vector<TYPE>(other.m_items); });
    }
    /// Inserts `count` copies of an element; behind the end, default values fill the gap.
    void InsertAt(INT_PTR index, ARG_TYPE element, INT_PTR count = 1) {
        const std::size_t place = countOf(index);
        const std::size_t copies = countOf(count);
        const TYPE kept(element);
        if (place > m_items.size()) {
            SetSize(index);
        }
        tvx::allocating([&] { m_items.insert(m_items.begin() + index, copies, kept); });
    }
    /// Inserts the elements of another array.
    void InsertAt(INT_PTR index, const CArray* other) {
        const std::vector<TYPE> items(other->m_items);
        if (countOf(index) > m_items.size()) {
            SetSize(index);
        }
        tvx::allocating([&] { m_items.insert(m_items.begin() + index, items.begin(), items.end()); });
    }
    /// Removes `count` elements, all of which must exist.
    void RemoveAt(INT_PTR index, INT_PTR count = 1) {
        if (index < 0 || count < 0 || index > GetSize() || count > GetSize() - index) {
            AfxThrowInvalidArgException();
        }
        m_items.erase(m_items.begin() + index, m_items.begin() + index + count);
    }

    /// Stores the number of elements and the elements, or loads them in place of the present ones; see
    /// SerializeElements.
    void Serialize(CArchive& archive) override {
        CObject::Serialize(archive);
        if (archive.IsStoring()) {
            archive.WriteCount(static_cast<DWORD_PTR>(GetSize()));
            SerializeElements(archive, GetData(), GetSize());
            return;
        }
        RemoveAll();
        // A damaged archive may promise any number: memory is taken only for what really comes.
        constexpr DWORD_PTR atOnce = 1024;
        for (DWORD_PTR left = archive.ReadCount(); left > 0;) {
            const INT_PTR begin = GetSize();
            const auto count = static_cast<INT_PTR>(std::min(left, atOnce));
            SetSize(begin + count);
            SerializeElements(archive, GetData() + begin, count);
            left -= static_cast<DWORD_PTR>(count);
        }
    }

    /// For range-based loops and algorithms.
    auto begin() noexcept {
        return m_items.begin();
    }
    auto begin() const noexcept {
        return m_items.begin();
    }
    auto end() noexcept {
        return m_items.end();
    }
    auto end() const noexcept {
        return m_items.end();
    }

private:
    static std::size_t countOf(INT_PTR number) {
        if (number < 0) {
            AfxThrowInvalidArgException();
        }
        return static_cast<std::size_t>(number);
    }
    std::size_t checked(INT_PTR index) const {
        if (index < 0 || index >= GetSize()) {
            AfxThrowInvalidArgException();
        }
        return static_cast<std::size_t>(index);
    }

    std::vector<TYPE> m_items;
};

/// An array of texts.
class TVX_PLATFORM_API CStringArray : public CArray<CString, const CString&> {
    DECLARE_SERIAL(CStringArray)
};

/// An array of pointers, which it does not own. Archives cannot hold it: Serialize raises
/// CNotSupportedException.
class TVX_PLATFORM_API CPtrArray : public CArray<void*, void*> {
    DECLARE_DYNAMIC(CPtrArray)
};

/// An array of objects, which it does not own; an archive that it is loaded from makes new ones, which are the
/// caller's.
class TVX_PLATFORM_API CObArray : public CArray<CObject*, CObject*> {
    DECLARE_SERIAL(CObArray)
};

/// An array of 8-bit numbers.
class TVX_PLATFORM_API CByteArray : public CArray<BYTE, BYTE> {
    DECLARE_SERIAL(CByteArray)
};

/// An array of 16-bit numbers.
class TVX_PLATFORM_API CWordArray : public CArray<WORD, WORD> {
    DECLARE_SERIAL(CWordArray)
};

/// An array of 32-bit numbers.
class TVX_PLATFORM_API CDWordArray : public CArray<DWORD, DWORD> {
    DECLARE_SERIAL(CDWordArray)
};

/// An array of numbers of the natural size.
class TVX_PLATFORM_API CUIntArray : public CArray<UINT, UINT> {
    DECLARE_DYNAMIC(CUIntArray)
};
