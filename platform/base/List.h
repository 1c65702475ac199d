#pragma once

/// @file
/// Doubly linked lists: the template CList and the classes for the usual element types.

#include "platform/base/Archive.h"
#include "platform/base/Exception.h"
#include "platform/base/Object.h"
#include "platform/base/String.h"

#include <utility>

/// A place in a list or map; null stands for "no more". It is valid until its element is removed.
DECLARE_HANDLE(POSITION);

/// A doubly linked list of values, held by whoever made it.
///
/// A null position and an empty list where an element is asked for raise CInvalidArgException. An exhausted heap raises
/// CMemoryException and leaves the list as it was.
///
/// @code
/// for (POSITION at = names.GetHeadPosition(); at;)
///     use(names.GetNext(at));
/// @endcode
///
/// @tparam TYPE      the element
/// @tparam ARG_TYPE  how elements are passed
template <typename TYPE, typename ARG_TYPE = const TYPE&>
class CList : public CObject {
public:
    /// @param blockSize  a hint that hosts give; elements are allocated one by one
    explicit CList(INT_PTR blockSize = 10) {
        UNREFERENCED_PARAMETER(blockSize);
    }
    ~CList() override {
        RemoveAll();
    }

    /// Number of elements.
    /// @{
    INT_PTR GetCount() const noexcept {
        return m_count;
    }
    INT_PTR GetSize() const noexcept {
        return m_count;
    }
    /// @}
    /// Whether there are no elements.
    BOOL IsEmpty() const noexcept {
        return m_count == 0;
    }

    /// The first and the last element; the list must not be empty.
    /// @{
    TYPE& GetHead() {
        return node(GetHeadPosition()).value;
    }
    const TYPE& GetHead() const {
        return node(GetHeadPosition()).value;
    }
    TYPE& GetTail() {
        return node(GetTailPosition()).value;
    }
    const TYPE& GetTail() const {
        return node(GetTailPosition()).value;
    }
    /// @}
    /// Removes the first element and returns it.
    TYPE RemoveHead() {
        return take(GetHeadPosition());
    }
    /// Removes the last element and returns it.
    TYPE RemoveTail() {
        return take(GetTailPosition());
    }
    /// Adds an element before the first one, and returns its position.
    POSITION AddHead(ARG_TYPE element) {
        return link(element, nullptr, m_head);
    }
    /// Adds an element behind the last one, and returns its position.
    POSITION AddTail(ARG_TYPE element) {
        return link(element, m_tail, nullptr);
    }
    /// Puts the elements of another list, in its order, before the first one.
    void AddHead(const CList* other) {
        POSITION at = other->GetTailPosition();
        for (INT_PTR left = other->GetCount(); left > 0; --left) {
            AddHead(other->GetPrev(at));
        }
    }
    /// Puts the elements of another list, in its order, behind the last one.
    void AddTail(const CList* other) {
        POSITION at = other->GetHeadPosition();
        for (INT_PTR left = other->GetCount(); left > 0; --left) {
            AddTail(other->GetNext(at));
        }
    }
    /// Removes all elements; all positions end.
    void RemoveAll() noexcept {
        while (m_head) {
            delete std::exchange(m_head, m_head->next);
        }
        m_tail = nullptr;
        m_count = 0;
    }

    /// The places of the first and last element; null for an empty list.
    /// @{
    POSITION GetHeadPosition() const noexcept {
        return positionOf(m_head);
    }
    POSITION GetTailPosition() const noexcept {
        return positionOf(m_tail);
    }
    /// @}
    /// The element at a position, which moves to the next one, null behind the last.
    TYPE& GetNext(POSITION& position) {
        Node& current = node(position);
        position = positionOf(current.next);
        return current.value;
    }
    const TYPE& GetNext(POSITION& position) const {
        return const_cast<CList*>(this)->GetNext(position);
    }
    /// The element at a position, which moves to the one before, null before the first.
    TYPE& GetPrev(POSITION& position) {
        Node& current = node(position);
        position = positionOf(current.previous);
        return current.value;
    }
    const TYPE& GetPrev(POSITION& position) const {
        return const_cast<CList*>(this)->GetPrev(position);
    }
    /// The element at a position.
    /// @{
    TYPE& GetAt(POSITION position) {
        return node(position).value;
    }
    const TYPE& GetAt(POSITION position) const {
        return node(position).value;
    }
    /// @}
    /// Replaces the element at a position.
    void SetAt(POSITION position, ARG_TYPE element) {
        node(position).value = element;
    }
    /// Removes the element at a position, which ends; others stay.
    void RemoveAt(POSITION position) {
        unlink(node(position));
    }
    /// A null position means before the first element.
    POSITION InsertBefore(POSITION position, ARG_TYPE element) {
        return position ? link(element, node(position).previous, &node(position)) : AddHead(element);
    }
    /// A null position means behind the last element.
    POSITION InsertAfter(POSITION position, ARG_TYPE element) {
        return position ? link(element, &node(position), node(position).next) : AddTail(element);
    }
    /// The first element equal to `value` behind `startAfter` (null: from the beginning), or null.
    POSITION Find(ARG_TYPE value, POSITION startAfter = nullptr) const {
        for (Node* at = startAfter ? node(startAfter).next : m_head; at; at = at->next) {
            if (at->value == value) {
                return positionOf(at);
            }
        }
        return nullptr;
    }
    /// The element with a number, from 0; null when there are not so many.
    POSITION FindIndex(INT_PTR index) const {
        if (index < 0) {
            return nullptr;
        }
        Node* at = m_head;
        while (at && index-- > 0) {
            at = at->next;
        }
        return positionOf(at);
    }

    /// Stores the number of elements and the elements, or loads them behind the present ones; see SerializeElements.
    void Serialize(CArchive& archive) override {
        CObject::Serialize(archive);
        if (archive.IsStoring()) {
            archive.WriteCount(static_cast<DWORD_PTR>(m_count));
            for (Node* at = m_head; at; at = at->next) {
                SerializeElements(archive, &at->value, 1);
            }
            return;
        }
        for (DWORD_PTR left = archive.ReadCount(); left > 0; --left) {
            TYPE element{};
            SerializeElements(archive, &element, 1);
            AddTail(element);
        }
    }

private:
    struct Node {
        TYPE value;
        Node* previous;
        Node* next;
    };

    static POSITION positionOf(Node* at) noexcept {
        return reinterpret_cast<POSITION>(at);
    }
    static Node& node(POSITION position) {
        if (!position) {
            AfxThrowInvalidArgException();
        }
        return *reinterpret_cast<Node*>(position);
    }
    POSITION link(ARG_TYPE element, Node* previous, Node* next) {
        Node* added = nullptr;
        tvx::allocating([&] { added = new Node{element, previous, next}; });
        (previous ? previous->next : m_head) = added;
        (next ? next->previous : m_tail) = added;
        ++m_count;
        return positionOf(added);
    }
    void unlink(Node& removed) {
        (removed.previous ? removed.previous->next : m_head) = removed.next;
        (removed.next ? removed.next->previous : m_tail) = removed.previous;
        --m_count;
        delete &removed;
    }
    TYPE take(POSITION position) {
        TYPE value = std::move(node(position).value);
        unlink(node(position));
        return value;
    }

    Node* m_head = nullptr;
    Node* m_tail = nullptr;
    INT_PTR m_count = 0;
};

/// A list of texts.
class TVX_PLATFORM_API CStringList : public CList<CString, const CString&> {
    DECLARE_SERIAL(CStringList)

public:
    using CList::CList;
};

/// A list of pointers, which it does not own. Archives cannot hold it: Serialize raises
/// CNotSupportedException.
class TVX_PLATFORM_API CPtrList : public CList<void*, void*> {
    DECLARE_DYNAMIC(CPtrList)

public:
    using CList::CList;
};

/// A list of objects, which it does not own; an archive that it is loaded from makes new ones, which are the caller's.
class TVX_PLATFORM_API CObList : public CList<CObject*, CObject*> {
    DECLARE_SERIAL(CObList)

public:
    using CList::CList;
};
