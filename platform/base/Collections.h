#pragma once

/// @file
/// All collections, and the templates that give lists and arrays of pointers their element's type.

#include "platform/base/Array.h"
#include "platform/base/List.h"
#include "platform/base/Map.h"

/// An array of pointers that knows what they point to.
/// @tparam BASE_CLASS  CPtrArray, or CObArray for pointers to classes derived from CObject
/// @tparam TYPE        the pointer type, such as `CShape*`
template <typename BASE_CLASS, typename TYPE>
class CTypedPtrArray : public BASE_CLASS {
public:
    /// As in the base class, with elements of the pointer's type.
    /// @{
    TYPE GetAt(INT_PTR index) const {
        return static_cast<TYPE>(BASE_CLASS::GetAt(index));
    }
    TYPE ElementAt(INT_PTR index) const {
        return GetAt(index);
    }
    TYPE operator[](INT_PTR index) const {
        return GetAt(index);
    }
    void SetAt(INT_PTR index, TYPE element) {
        BASE_CLASS::SetAt(index, element);
    }
    void SetAtGrow(INT_PTR index, TYPE element) {
        BASE_CLASS::SetAtGrow(index, element);
    }
    INT_PTR Add(TYPE element) {
        return BASE_CLASS::Add(element);
    }
    INT_PTR Append(const CTypedPtrArray& other) {
        return BASE_CLASS::Append(other);
    }
    void Copy(const CTypedPtrArray& other) {
        BASE_CLASS::Copy(other);
    }
    void InsertAt(INT_PTR index, TYPE element, INT_PTR count = 1) {
        BASE_CLASS::InsertAt(index, element, count);
    }
    void InsertAt(INT_PTR index, const CTypedPtrArray* other) {
        BASE_CLASS::InsertAt(index, other);
    }
    /// @}
};

/// A list of pointers that knows what they point to.
/// @tparam BASE_CLASS  CPtrList, or CObList for pointers to classes derived from CObject
/// @tparam TYPE        the pointer type, such as `CShape*`
template <typename BASE_CLASS, typename TYPE>
class CTypedPtrList : public BASE_CLASS {
public:
    using BASE_CLASS::BASE_CLASS;

    /// As in the base class, with elements of the pointer's type.
    /// @{
    TYPE GetHead() const {
        return static_cast<TYPE>(BASE_CLASS::GetHead());
    }
    TYPE GetTail() const {
        return static_cast<TYPE>(BASE_CLASS::GetTail());
    }
    TYPE RemoveHead() {
        return static_cast<TYPE>(BASE_CLASS::RemoveHead());
    }
    TYPE RemoveTail() {
        return static_cast<TYPE>(BASE_CLASS::RemoveTail());
    }
    POSITION AddHead(TYPE element) {
        return BASE_CLASS::AddHead(element);
    }
    POSITION AddTail(TYPE element) {
        return BASE_CLASS::AddTail(element);
    }
    void AddHead(const CTypedPtrList* other) {
        BASE_CLASS::AddHead(other);
    }
    void AddTail(const CTypedPtrList* other) {
        BASE_CLASS::AddTail(other);
    }
    TYPE GetNext(POSITION& position) const {
        return static_cast<TYPE>(BASE_CLASS::GetNext(position));
    }
    TYPE GetPrev(POSITION& position) const {
        return static_cast<TYPE>(BASE_CLASS::GetPrev(position));
    }
    TYPE GetAt(POSITION position) const {
        return static_cast<TYPE>(BASE_CLASS::GetAt(position));
    }
    void SetAt(POSITION position, TYPE element) {
        BASE_CLASS::SetAt(position, element);
    }
    POSITION InsertBefore(POSITION position, TYPE element) {
        return BASE_CLASS::InsertBefore(position, element);
    }
    POSITION InsertAfter(POSITION position, TYPE element) {
        return BASE_CLASS::InsertAfter(position, element);
    }
    POSITION Find(TYPE value, POSITION startAfter = nullptr) const {
        return BASE_CLASS::Find(value, startAfter);
    }
    /// @}
};
