#pragma once

/// @file
/// Hash maps: the template CMap and the classes for the usual keys and values.

#include "platform/base/Archive.h"
#include "platform/base/Exception.h"
#include "platform/base/List.h"
#include "platform/base/Object.h"
#include "platform/base/String.h"

#include <functional>
#include <string_view>
#include <type_traits>
#include <unordered_map>

/// The hash number of a key. Hosts specialise it for keys of their own that have no std::hash.
template <typename ARG_KEY>
UINT HashKey(ARG_KEY key) {
    using Key = std::remove_cvref_t<ARG_KEY>;
    if constexpr (std::is_convertible_v<Key, LPCSTR>) {
        return static_cast<UINT>(std::hash<std::string_view>()(static_cast<LPCSTR>(key)));
    } else {
        return static_cast<UINT>(std::hash<Key>()(key));
    }
}

/// A hash map of values, held by whoever made it. Keys compare with ==. The order of its elements is arbitrary.
///
/// @code
/// for (POSITION at = map.GetStartPosition(); at;) {
///     map.GetNextAssoc(at, key, value); // removing `key` here is fine
/// }
/// @endcode
///
/// An exhausted heap raises CMemoryException.
///
/// @tparam ARG_KEY    how keys are passed, and what HashKey is called with
/// @tparam ARG_VALUE  how values are passed
template <typename KEY, typename ARG_KEY, typename VALUE, typename ARG_VALUE>
class CMap : public CObject {
public:
    /// @param blockSize  a hint that hosts give; elements are allocated one by one
    explicit CMap(INT_PTR blockSize = 10) {
        UNREFERENCED_PARAMETER(blockSize);
    }

    /// Number of elements.
    /// @{
    INT_PTR GetCount() const noexcept {
        return static_cast<INT_PTR>(m_items.size());
    }
    INT_PTR GetSize() const noexcept {
        return GetCount();
    }
    /// @}
    /// Whether there are no elements.
    BOOL IsEmpty() const noexcept {
        return m_items.empty();
    }
    /// Finds the value of a key.
    /// @param value  receives the value; left alone when the key is unknown
    /// @return whether the key is known
    BOOL Lookup(ARG_KEY key, VALUE& value) const {
        const auto found = m_items.find(key);
        if (found == m_items.end()) {
            return FALSE;
        }
        value = found->second;
        return TRUE;
    }
    /// The value of a key, which is added with a default value when it is unknown.
    VALUE& operator[](ARG_KEY key) {
        const auto found = m_items.find(key);
        if (found != m_items.end()) {
            return found->second;
        }
        VALUE* added = nullptr;
        tvx::allocating([&] { added = &m_items.emplace(key, VALUE()).first->second; });
        return *added;
    }
    /// Sets the value of a key, known or new.
    void SetAt(ARG_KEY key, ARG_VALUE value) {
        (*this)[key] = value;
    }
    /// @return whether the key was known
    BOOL RemoveKey(ARG_KEY key) {
        const auto found = m_items.find(key);
        if (found == m_items.end()) {
            return FALSE;
        }
        m_items.erase(found);
        return TRUE;
    }
    /// Removes all elements.
    void RemoveAll() noexcept {
        m_items.clear();
    }
    /// Prepares the map for so many elements.
    void InitHashTable(UINT size, BOOL allocateNow = TRUE) {
        if (allocateNow) {
            tvx::allocating([&] { m_items.reserve(size); });
        }
    }

    /// Where an iteration over all elements begins; null for an empty map. Adding elements ends an iteration.
    POSITION GetStartPosition() const {
        return positionOf(m_items.begin());
    }
    /// The key and value at a position, which moves to the next element, null behind the last.
    void GetNextAssoc(POSITION& position, KEY& key, VALUE& value) const {
        if (!position) {
            AfxThrowInvalidArgException();
        }
        auto current = m_items.find(reinterpret_cast<const typename Items::value_type*>(position)->first);
        key = current->first;
        value = current->second;
        position = positionOf(++current);
    }

    /// Stores the number of elements and each key and value, or loads them over the present ones; see
    /// SerializeElements.
    void Serialize(CArchive& archive) override {
        CObject::Serialize(archive);
        if (archive.IsStoring()) {
            archive.WriteCount(static_cast<DWORD_PTR>(GetCount()));
            for (auto& [key, value] : m_items) {
                SerializeElements(archive, const_cast<KEY*>(&key), 1);
                SerializeElements(archive, &value, 1);
            }
            return;
        }
        for (DWORD_PTR left = archive.ReadCount(); left > 0; --left) {
            KEY key{};
            VALUE value{};
            SerializeElements(archive, &key, 1);
            SerializeElements(archive, &value, 1);
            SetAt(key, value);
        }
    }

private:
    struct Hash {
        using is_transparent = void;
        template <typename AnyKey>
        std::size_t operator()(const AnyKey& key) const {
            return HashKey<ARG_KEY>(key);
        }
    };
    struct Equal {
        using is_transparent = void;
        template <typename Left, typename Right>
        bool operator()(const Left& left, const Right& right) const {
            return left == right;
        }
    };
    using Items = std::unordered_map<KEY, VALUE, Hash, Equal>;

    POSITION positionOf(typename Items::const_iterator at) const {
        if (at == m_items.end()) {
            return nullptr;
        }
        return reinterpret_cast<POSITION>(const_cast<typename Items::value_type*>(&*at));
    }

    Items m_items;
};

/// A map from addresses to 16-bit numbers. Archives cannot hold it: Serialize raises
/// CNotSupportedException.
class TVX_PLATFORM_API CMapPtrToWord : public CMap<void*, void*, WORD, WORD> {
    DECLARE_DYNAMIC(CMapPtrToWord)

public:
    using CMap::CMap;
};

/// A map from texts to pointers, which it does not own. Archives cannot hold it: Serialize raises
/// CNotSupportedException.
class TVX_PLATFORM_API CMapStringToPtr : public CMap<CString, LPCTSTR, void*, void*> {
    DECLARE_DYNAMIC(CMapStringToPtr)

public:
    using CMap::CMap;
};

/// A map from texts to texts.
class TVX_PLATFORM_API CMapStringToString : public CMap<CString, LPCTSTR, CString, LPCTSTR> {
    DECLARE_SERIAL(CMapStringToString)

public:
    using CMap::CMap;
};
