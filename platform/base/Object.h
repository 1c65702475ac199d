#pragma once

/// @file
/// The root of the framework's classes and their run-time class information, with the macros that declare it, and the
/// diagnostic macros ASSERT, VERIFY and TRACE.
///
/// @code
/// class CShape : public CObject {          // in the header
///     DECLARE_DYNCREATE(CShape)
///     ...
/// };
/// IMPLEMENT_DYNCREATE(CShape, CObject)     // in the source
///
/// CObject* object = RUNTIME_CLASS(CShape)->CreateObject();
/// if (auto* shape = DYNAMIC_DOWNCAST(CShape, object)) ...
/// @endcode

#include "platform/base/Export.h"
#include "platform/base/FormatArgument.h"
#include "platform/base/Types.h"

class CArchive;
class CDumpContext;
class CObject;

/// What is known of a class at run time. One object for each class, made by the IMPLEMENT_ macros; hosts only read it.
/// All classes of the process are in one list, a class of an unloaded library leaves it.
struct TVX_PLATFORM_API CRuntimeClass {
    /// The class's name as written in the source.
    LPCSTR m_lpszClassName;
    /// Size of an object in bytes.
    int m_nObjectSize;
    /// Version that archives store with the class; 0xFFFF for a class that archives cannot hold.
    UINT m_wSchema;
    /// Makes an object with the default constructor; null for a class that cannot be made by its class.
    CObject* (*m_pfnCreateObject)();
    /// Gives the base class; null for CObject. A function, so that it is right before any static object is made.
    CRuntimeClass* (*m_pfnGetBaseClass)();
    /// The next class of the list of all classes.
    CRuntimeClass* m_pNextClass;

    /// Makes an object on the heap, which the caller owns. Null when the class cannot be made this way. Raises
    /// CMemoryException.
    CObject* CreateObject();
    /// Whether the class is `base` or derives from it.
    BOOL IsDerivedFrom(const CRuntimeClass* base) const;
    /// The class with this name (exact spelling), or null.
    static CRuntimeClass* FromName(LPCSTR name);
    /// Makes an object of the class with this name; null when there is no such class or it cannot be made.
    static CObject* CreateObject(LPCSTR name);
};

/// Keeps a class in the list of all classes. Made by the IMPLEMENT_ macros, one beside each class.
class TVX_PLATFORM_API AFX_CLASSINIT {
public:
    /// Puts the class into the list; the destructor takes it out.
    explicit AFX_CLASSINIT(CRuntimeClass* newClass);
    ~AFX_CLASSINIT();
    AFX_CLASSINIT(const AFX_CLASSINIT&) = delete;
    AFX_CLASSINIT& operator=(const AFX_CLASSINIT&) = delete;

private:
    CRuntimeClass* m_class;
};

/// Root of the framework's classes: run-time class information, storing in archives, diagnostics. Objects are not
/// copied.
class TVX_PLATFORM_API CObject {
public:
    /// The object's class.
    virtual CRuntimeClass* GetRuntimeClass() const;
    virtual ~CObject();
    /// Stores the object in an archive or loads it. The base does nothing; an override calls its base first.
    virtual void Serialize(CArchive& archive);
    /// Checks the object's invariants with ASSERT. An override calls its base first.
    virtual void AssertValid() const;
    /// Writes the object's state to a diagnostic context. An override calls its base first.
    virtual void Dump(CDumpContext& context) const;

    /// Whether the object's class is `runtimeClass` or derives from it.
    BOOL IsKindOf(const CRuntimeClass* runtimeClass) const;
    /// Whether archives can hold the object.
    BOOL IsSerializable() const;
    /// What RUNTIME_CLASS(CObject) gives.
    static CRuntimeClass* GetThisClass();

    CObject(const CObject&) = delete;
    CObject& operator=(const CObject&) = delete;

    static CRuntimeClass classCObject;

protected:
    CObject() = default;
};

/// The run-time class information of a class.
#define RUNTIME_CLASS(class_name) (class_name::GetThisClass())

/// Declares run-time class information: IsKindOf and DYNAMIC_DOWNCAST work.
#define DECLARE_DYNAMIC(class_name)                                                                                    \
public:                                                                                                                \
    static CRuntimeClass class##class_name;                                                                            \
    static CRuntimeClass* GetThisClass();                                                                              \
    CRuntimeClass* GetRuntimeClass() const override;

/// As DECLARE_DYNAMIC, and objects can be made by their class.
#define DECLARE_DYNCREATE(class_name)                                                                                  \
    DECLARE_DYNAMIC(class_name)                                                                                        \
    static CObject* CreateObject();

/// As DECLARE_DYNCREATE, and archives can hold objects of the class.
#define DECLARE_SERIAL(class_name)                                                                                     \
    DECLARE_DYNCREATE(class_name)                                                                                      \
    friend CArchive& operator>>(CArchive& archive, class_name*& object) {                                              \
        object = static_cast<class_name*>(AfxReadObject(archive, GetThisClass()));                                     \
        return archive;                                                                                                \
    }

#define TVX_IMPLEMENT_RUNTIMECLASS(class_name, base_class_name, schema, create)                                        \
    CRuntimeClass class_name::class##class_name = {#class_name, static_cast<int>(sizeof(class_name)), schema,          \
                                                   create,      &base_class_name::GetThisClass,       nullptr};        \
    static const AFX_CLASSINIT init##class_name(&class_name::class##class_name);                                       \
    CRuntimeClass* class_name::GetThisClass() {                                                                        \
        return &class##class_name;                                                                                     \
    }                                                                                                                  \
    CRuntimeClass* class_name::GetRuntimeClass() const {                                                               \
        return &class##class_name;                                                                                     \
    }

#define IMPLEMENT_DYNAMIC(class_name, base_class_name)                                                                 \
    TVX_IMPLEMENT_RUNTIMECLASS(class_name, base_class_name, 0xFFFF, nullptr)

#define IMPLEMENT_DYNCREATE(class_name, base_class_name)                                                               \
    CObject* class_name::CreateObject() {                                                                              \
        return new class_name;                                                                                         \
    }                                                                                                                  \
    TVX_IMPLEMENT_RUNTIMECLASS(class_name, base_class_name, 0xFFFF, &class_name::CreateObject)

/// The schema is the version that archives store with the class: 0 to 0x7FFF, or'ed with VERSIONABLE_SCHEMA when
/// Serialize reads older versions itself.
#define IMPLEMENT_SERIAL(class_name, base_class_name, schema)                                                          \
    CObject* class_name::CreateObject() {                                                                              \
        return new class_name;                                                                                         \
    }                                                                                                                  \
    TVX_IMPLEMENT_RUNTIMECLASS(class_name, base_class_name, schema, &class_name::CreateObject)

/// Marks a schema as one whose Serialize reads older versions itself.
#define VERSIONABLE_SCHEMA (0x80000000u)

/// Reads an object that must be of a class or one derived from it; what DECLARE_SERIAL's operator>> does. The caller
/// owns it. Null when a null pointer was stored. Raises CArchiveException.
TVX_PLATFORM_API CObject* AfxReadObject(CArchive& archive, CRuntimeClass* expected);

/// The object as a pointer to a class, or null when it is null or of another class.
TVX_PLATFORM_API CObject* AfxDynamicDownCast(CRuntimeClass* runtimeClass, CObject* object);
/// The object as a pointer to a class that the caller knows it has; checked with ASSERT.
TVX_PLATFORM_API CObject* AfxStaticDownCast(CRuntimeClass* runtimeClass, CObject* object);

#define DYNAMIC_DOWNCAST(class_name, object)                                                                           \
    (static_cast<class_name*>(AfxDynamicDownCast(RUNTIME_CLASS(class_name), (CObject*)(object))))
#define STATIC_DOWNCAST(class_name, object)                                                                            \
    (static_cast<class_name*>(AfxStaticDownCast(RUNTIME_CLASS(class_name), (CObject*)(object))))

/// Where Dump writes: standard error, and only when the environment variable TVX_TRACE is set.
class TVX_PLATFORM_API CDumpContext {
public:
    /// Writes a value as text.
    CDumpContext& operator<<(LPCSTR text);
    CDumpContext& operator<<(int number);
    CDumpContext& operator<<(unsigned int number);
    CDumpContext& operator<<(double number);
    CDumpContext& operator<<(const void* address);
    /// Writes what the object's Dump says; "NULL" for a null pointer.
    CDumpContext& operator<<(const CObject* object);
    CDumpContext& operator<<(const CObject& object);
    /// How deep Dump follows pointers: 0 not at all. Kept for Dump overrides, which read it.
    int GetDepth() const;
    void SetDepth(int depth);

private:
    int m_depth = 0;
};

/// The diagnostic context that hosts dump to.
extern TVX_PLATFORM_API CDumpContext afxDump;

/// Writes a formatted line to standard error when the environment variable TVX_TRACE is set; see TRACE.
TVX_PLATFORM_API void AfxTrace(LPCSTR format, ...) __attribute__((format(printf, 1, 2)));
/// The same with strings among the arguments.
template <class... Arguments>
    requires(tvx::FormattedText<Arguments> || ...)
void AfxTrace(LPCSTR format, Arguments... arguments) {
    AfxTrace(format, tvx::formatArgument(arguments)...);
}
/// Reports a broken assertion on standard error and ends the process; see ASSERT.
[[noreturn]] TVX_PLATFORM_API void AfxAssertFailed(LPCSTR condition, LPCSTR fileName, int line);
/// Checks an object as ASSERT_VALID does: not null, and its own AssertValid.
TVX_PLATFORM_API void AfxAssertValidObject(const CObject* object, LPCSTR fileName, int line);

/// Diagnostics follow the build: they are on unless NDEBUG is defined; _DEBUG turns them on in any case.
#if defined(_DEBUG) || !defined(NDEBUG)
#define ASSERT(condition) ((condition) ? static_cast<void>(0) : AfxAssertFailed(#condition, __FILE__, __LINE__))
#define VERIFY(condition) ASSERT(condition)
#define ASSERT_VALID(object) (AfxAssertValidObject((object), __FILE__, __LINE__))
#define DEBUG_ONLY(expression) (expression)
#else
#define ASSERT(condition) (static_cast<void>(0))
#define VERIFY(condition) (static_cast<void>(condition))
#define ASSERT_VALID(object) (static_cast<void>(0))
#define DEBUG_ONLY(expression) (static_cast<void>(0))
#endif
#define ASSERT_KINDOF(class_name, object) ASSERT((object)->IsKindOf(RUNTIME_CLASS(class_name)))

#define TRACE AfxTrace
#define TRACE0(text) AfxTrace("%s", text)
#define TRACE1(format, p1) AfxTrace(format, p1)
#define TRACE2(format, p1, p2) AfxTrace(format, p1, p2)
#define TRACE3(format, p1, p2, p3) AfxTrace(format, p1, p2, p3)

/// Allocation is checked by the build's sanitizers here, so hosts' debug form of new is new.
#define DEBUG_NEW new
