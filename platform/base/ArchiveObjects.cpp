// The part of CArchive that stores and loads objects and their classes.

#include "platform/base/Archive.h"

#include <algorithm>
#include <cstring>
#include <memory>

namespace {

constexpr WORD nullTag = 0;
constexpr WORD newClassTag = 0xFFFF;
/// Marks the number of a class in a tag of 2 bytes; numbers from bigTag on take a tag of 2 + 4 bytes.
constexpr WORD classMark = 0x8000;
constexpr WORD bigTag = 0x7FFF;
constexpr DWORD bigClassMark = 0x80000000;
constexpr DWORD largestIndex = 0x3FFFFFFE;
constexpr WORD longestClassName = 63;
/// Objects inside of objects. Each takes stack, and a damaged archive could nest without end.
constexpr int deepestNesting = 5000;
constexpr UINT notSerial = 0xFFFF;

} // namespace

/// What stands before an object.
struct CArchive::ClassTag {
    enum Kind { object, oldClass, newClass } kind;
    DWORD index;
};

/// Counts the objects that are being stored or loaded inside of each other.
struct CArchive::Nesting {
    explicit Nesting(CArchive& owner) : archive(owner) {
        if (archive.m_depth >= deepestNesting) {
            archive.fail(CArchiveException::genericException);
        }
        ++archive.m_depth;
    }
    ~Nesting() {
        --archive.m_depth;
    }
    Nesting(const Nesting&) = delete;
    Nesting& operator=(const Nesting&) = delete;

    CArchive& archive;
};

void CArchive::WriteObject(const CObject* object) {
    requireStoring();
    if (!object) {
        *this << nullTag;
        return;
    }
    if (const DWORD index = known(object)) {
        writeTag(index, 0, 0);
        return;
    }
    const Nesting nesting(*this);
    WriteClass(object->GetRuntimeClass());
    remember(object);
    // Serialize serves both directions and so is not const; it does not change an object that it stores.
    const_cast<CObject*>(object)->Serialize(*this);
}

void CArchive::WriteClass(const CRuntimeClass* runtimeClass) {
    requireStoring();
    if (runtimeClass->m_wSchema == notSerial) {
        AfxThrowNotSupportedException();
    }
    if (const DWORD index = known(runtimeClass)) {
        writeTag(index, classMark, bigClassMark);
        return;
    }
    const auto length = static_cast<WORD>(std::strlen(runtimeClass->m_lpszClassName));
    if (length > longestClassName) {
        AfxThrowNotSupportedException();
    }
    *this << newClassTag << static_cast<WORD>(runtimeClass->m_wSchema) << length;
    Write(runtimeClass->m_lpszClassName, length);
    remember(runtimeClass);
}

CObject* CArchive::ReadObject(const CRuntimeClass* expected) {
    requireLoading();
    const ClassTag tag = readTag();
    if (tag.kind == ClassTag::object) {
        return loadedObject(tag.index, expected);
    }
    const Nesting nesting(*this);
    CRuntimeClass* const runtimeClass =
        tag.kind == ClassTag::newClass ? readNewClass() : m_loaded[tag.index].runtimeClass;
    if (expected && !runtimeClass->IsDerivedFrom(expected)) {
        fail(CArchiveException::badClass);
    }
    m_objectSchema = tag.kind == ClassTag::newClass ? m_loaded.back().schema : m_loaded[tag.index].schema;
    return loadNewObject(runtimeClass);
}

CRuntimeClass* CArchive::ReadClass(const CRuntimeClass* expected) {
    requireLoading();
    const ClassTag tag = readTag();
    if (tag.kind == ClassTag::object) {
        fail(CArchiveException::badClass);
    }
    CRuntimeClass* const runtimeClass =
        tag.kind == ClassTag::newClass ? readNewClass() : m_loaded[tag.index].runtimeClass;
    if (expected && !runtimeClass->IsDerivedFrom(expected)) {
        fail(CArchiveException::badClass);
    }
    m_objectSchema = tag.kind == ClassTag::newClass ? m_loaded.back().schema : m_loaded[tag.index].schema;
    return runtimeClass;
}

void CArchive::MapObject(const CObject* object) {
    if (!object) {
        return;
    }
    if (IsStoring()) {
        remember(object);
    } else {
        tvx::allocating([&] { m_loaded.push_back({.object = const_cast<CObject*>(object)}); });
    }
}

void CArchive::SerializeClass(const CRuntimeClass* runtimeClass) {
    if (IsStoring()) {
        WriteClass(runtimeClass);
    } else if (ReadClass(runtimeClass) != runtimeClass) {
        fail(CArchiveException::badClass);
    }
}

UINT CArchive::GetObjectSchema() noexcept {
    return std::exchange(m_objectSchema, 0xFFFFFFFF);
}

void CArchive::SetObjectSchema(UINT schema) noexcept {
    m_objectSchema = schema;
}

/// The number of an object or class stored before, or 0.
DWORD CArchive::known(const void* address) {
    const auto found = m_stored.find(address);
    return found == m_stored.end() ? 0 : found->second;
}

DWORD CArchive::remember(const void* address) {
    if (m_storedCount > largestIndex) {
        fail(CArchiveException::badIndex);
    }
    tvx::allocating([&] { m_stored.emplace(address, m_storedCount); });
    return m_storedCount++;
}

void CArchive::writeTag(DWORD index, WORD smallMark, DWORD bigMark) {
    if (index < bigTag) {
        *this << static_cast<WORD>(smallMark | index);
    } else {
        *this << bigTag << (bigMark | index);
    }
}

/// Reads a tag. The number of a class is checked here; an object's class is not known yet.
CArchive::ClassTag CArchive::readTag() {
    WORD small = 0;
    *this >> small;
    if (small == newClassTag) {
        return {ClassTag::newClass, 0};
    }
    DWORD index = small & ~classMark;
    bool isClass = (small & classMark) != 0;
    if (small == bigTag) {
        DWORD big = 0;
        *this >> big;
        isClass = (big & bigClassMark) != 0;
        index = big & ~bigClassMark;
    }
    if (index >= m_loaded.size() || (isClass && !m_loaded[index].runtimeClass)) {
        fail(CArchiveException::badIndex);
    }
    return {isClass ? ClassTag::oldClass : ClassTag::object, index};
}

CRuntimeClass* CArchive::readNewClass() {
    WORD schema = 0;
    WORD length = 0;
    *this >> schema >> length;
    char name[longestClassName + 1] = {};
    if (length > longestClassName) {
        fail(CArchiveException::badClass);
    }
    EnsureRead(name, length);
    CRuntimeClass* const runtimeClass = CRuntimeClass::FromName(name);
    // Only classes that were made for archives: a file must not choose among all others.
    if (!runtimeClass || runtimeClass->m_wSchema == notSerial) {
        fail(CArchiveException::badClass);
    }
    const bool readsOthers = (runtimeClass->m_wSchema & VERSIONABLE_SCHEMA) != 0;
    if (!readsOthers && schema != static_cast<WORD>(runtimeClass->m_wSchema)) {
        fail(CArchiveException::badSchema);
    }
    tvx::allocating([&] { m_loaded.push_back({.runtimeClass = runtimeClass, .schema = schema}); });
    return runtimeClass;
}

CObject* CArchive::loadedObject(DWORD index, const CRuntimeClass* expected) const {
    CObject* const object = m_loaded[index].object;
    if (index != 0 && !object) {
        fail(CArchiveException::badIndex);
    }
    if (object && expected && !object->IsKindOf(expected)) {
        fail(CArchiveException::badClass);
    }
    return object;
}

/// Makes an object and lets it load itself. Its number is known before, since its parts may point back to it.
CObject* CArchive::loadNewObject(CRuntimeClass* runtimeClass) {
    const UINT schema = m_objectSchema;
    std::unique_ptr<CObject> object(runtimeClass->CreateObject());
    if (!object) {
        fail(CArchiveException::badClass);
    }
    const std::size_t index = m_loaded.size();
    MapObject(object.get());
    m_objectSchema = schema;
    try {
        object->Serialize(*this);
    } catch (...) {
        m_loaded[index].object = nullptr;
        throw;
    }
    m_objectSchema = 0xFFFFFFFF;
    return object.release();
}

CObject* AfxReadObject(CArchive& archive, CRuntimeClass* expected) {
    return archive.ReadObject(expected);
}
