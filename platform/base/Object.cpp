#include "platform/base/Object.h"

#include "platform/base/Exception.h"
#include "platform/base/Text.h"

#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <new>

namespace {

// Plain pointer: it must be valid before any constructor of a static object has run.
constinit CRuntimeClass* firstClass = nullptr;

bool isTracing() {
    return std::getenv("TVX_TRACE") != nullptr;
}

void trace(const char* text) {
    if (isTracing()) {
        std::fputs(text, stderr);
    }
}

} // namespace

CDumpContext afxDump;

CRuntimeClass CObject::classCObject = {"CObject", static_cast<int>(sizeof(CObject)), 0xFFFF, nullptr, nullptr, nullptr};
static const AFX_CLASSINIT initCObject(&CObject::classCObject);

CObject* CRuntimeClass::CreateObject() {
    if (!m_pfnCreateObject) {
        AfxTrace("%s cannot be made by its class: it lacks DECLARE_DYNCREATE\n", m_lpszClassName);
        return nullptr;
    }
    try {
        return m_pfnCreateObject();
    } catch (const std::bad_alloc&) {
        AfxThrowMemoryException();
    }
}

BOOL CRuntimeClass::IsDerivedFrom(const CRuntimeClass* base) const {
    const CRuntimeClass* current = this;
    while (current && current != base) {
        current = current->m_pfnGetBaseClass ? current->m_pfnGetBaseClass() : nullptr;
    }
    return current ? TRUE : FALSE;
}

CRuntimeClass* CRuntimeClass::FromName(LPCSTR name) {
    if (!name) {
        return nullptr;
    }
    for (CRuntimeClass* current = firstClass; current; current = current->m_pNextClass) {
        if (std::strcmp(current->m_lpszClassName, name) == 0) {
            return current;
        }
    }
    return nullptr;
}

CObject* CRuntimeClass::CreateObject(LPCSTR name) {
    CRuntimeClass* found = FromName(name);
    return found ? found->CreateObject() : nullptr;
}

AFX_CLASSINIT::AFX_CLASSINIT(CRuntimeClass* newClass) : m_class(newClass) {
    newClass->m_pNextClass = firstClass;
    firstClass = newClass;
}

AFX_CLASSINIT::~AFX_CLASSINIT() {
    for (CRuntimeClass** link = &firstClass; *link; link = &(*link)->m_pNextClass) {
        if (*link == m_class) {
            *link = m_class->m_pNextClass;
            return;
        }
    }
}

CObject::~CObject() = default;

CRuntimeClass* CObject::GetRuntimeClass() const {
    return &classCObject;
}

CRuntimeClass* CObject::GetThisClass() {
    return &classCObject;
}

void CObject::Serialize(CArchive&) {}

void CObject::AssertValid() const {}

void CObject::Dump(CDumpContext& context) const {
    context << "a " << GetRuntimeClass()->m_lpszClassName << " at " << static_cast<const void*>(this) << "\n";
}

BOOL CObject::IsKindOf(const CRuntimeClass* runtimeClass) const {
    return GetRuntimeClass()->IsDerivedFrom(runtimeClass);
}

BOOL CObject::IsSerializable() const {
    return GetRuntimeClass()->m_wSchema != 0xFFFF;
}

CObject* AfxDynamicDownCast(CRuntimeClass* runtimeClass, CObject* object) {
    return object && object->IsKindOf(runtimeClass) ? object : nullptr;
}

CObject* AfxStaticDownCast(CRuntimeClass* runtimeClass, CObject* object) {
    ASSERT(!object || object->IsKindOf(runtimeClass));
    return object;
}

CDumpContext& CDumpContext::operator<<(LPCSTR text) {
    trace(text ? text : "(NULL)");
    return *this;
}

CDumpContext& CDumpContext::operator<<(int number) {
    return *this << tvx::text::format("%d", number).c_str();
}

CDumpContext& CDumpContext::operator<<(unsigned int number) {
    return *this << tvx::text::format("%u", number).c_str();
}

CDumpContext& CDumpContext::operator<<(double number) {
    return *this << tvx::text::formatDouble(number).c_str();
}

CDumpContext& CDumpContext::operator<<(const void* address) {
    return *this << tvx::text::format("%p", address).c_str();
}

CDumpContext& CDumpContext::operator<<(const CObject* object) {
    if (!object) {
        return *this << "NULL";
    }
    return *this << *object;
}

CDumpContext& CDumpContext::operator<<(const CObject& object) {
    object.Dump(*this);
    return *this;
}

int CDumpContext::GetDepth() const {
    return m_depth;
}

void CDumpContext::SetDepth(int depth) {
    m_depth = depth;
}

void AfxTrace(LPCSTR format, ...) {
    if (!isTracing()) {
        return;
    }
    std::va_list arguments;
    va_start(arguments, format);
    trace(tvx::text::formatV(format, arguments).c_str());
    va_end(arguments);
}

void AfxAssertFailed(LPCSTR condition, LPCSTR fileName, int line) {
    std::fprintf(stderr, "%s:%d: assertion failed: %s\n", fileName, line, condition);
    std::abort();
}

void AfxAssertValidObject(const CObject* object, LPCSTR fileName, int line) {
    if (!object) {
        AfxAssertFailed("the object is not null", fileName, line);
    }
    object->AssertValid();
}
