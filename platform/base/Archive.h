#pragma once

#include "platform/base/Exception.h"
#include "platform/base/File.h"
#include "platform/base/Geometry.h"
#include "platform/base/Object.h"
#include "platform/base/String.h"

#include <concepts>
#include <type_traits>
#include <unordered_map>
#include <vector>

class CDocument;

/// Stores values and objects in a file, or loads them, through a buffer. Made by whoever saves or loads, usually on the
/// stack; the file must outlive it. Call Close() when all went well: errors of the last writing appear there.
///
/// The format: numbers have the size their type had where the framework comes from (`long` 4 bytes), low byte first.
/// A text is its length (1 byte; 0xFF and 2 bytes; 0xFF, 0xFFFF and 4 bytes) and its bytes. An object is a tag, for the
/// first object of a class the class's schema and name, and what its Serialize writes; objects and classes stored again
/// are numbers of earlier ones, so that objects may point to each other in any way.
///
/// A damaged or truncated archive raises CArchiveException; nothing is read beyond its end, and memory is taken only
/// for what is really there.
///
/// @code
/// CFile file("drawing.bin", CFile::modeCreate | CFile::modeWrite);
/// CArchive archive(&file, CArchive::store);
/// archive << count << name << shape;
/// archive.Close();
/// @endcode
class TVX_PLATFORM_API CArchive {
public:
    /// The direction, and how the archive ends.
    enum Mode : UINT {
        store = 0,
        load = 1,
        bNoFlushOnDelete = 2, ///< the destructor does not write what Close() has not written
    };

    /// @param file        where to store or load, open; not owned
    /// @param mode        store or load
    /// @param bufferSize  size of the buffer in bytes, at least 128
    CArchive(CFile* file, UINT mode, int bufferSize = 4096);
    /// Closes the archive. An error of that is lost: call Close() before.
    ~CArchive();
    CArchive(const CArchive&) = delete;
    CArchive& operator=(const CArchive&) = delete;

    /// The direction.
    /// @{
    BOOL IsLoading() const noexcept;
    BOOL IsStoring() const noexcept;
    /// @}
    /// The file; null after Close().
    CFile* GetFile() const noexcept;
    /// Writes what is in the buffer; when loading, moves the file back to what was really read.
    void Flush();
    /// Flushes, and ends the use of the file, which stays open.
    void Close();
    /// Ends the use of the file without writing the buffer.
    void Abort() noexcept;

    /// Reads up to `count` bytes.
    /// @return how many were read: fewer only at the end of the file
    UINT Read(void* buffer, UINT count);
    /// Writes all `count` bytes.
    void Write(const void* buffer, UINT count);
    /// Reads `count` bytes; raises CArchiveException (`endOfFile`) when there are fewer.
    void EnsureRead(void* buffer, UINT count);
    /// Writes the bytes of a text, without its length.
    void WriteString(LPCTSTR text);
    /// Reads a line, without its end "\n" or "\r\n".
    /// @return FALSE when there was nothing left to read
    BOOL ReadString(CString& line);
    /// Writes a number of elements: 2 bytes; from 0xFFFF on 0xFFFF and 4 bytes, or 8 behind 0xFFFFFFFF.
    void WriteCount(DWORD_PTR count);
    /// Reads what WriteCount wrote.
    DWORD_PTR ReadCount();

    /// Store a value; raise CArchiveException (`readOnly`) in an archive that loads.
    /// @{
    CArchive& operator<<(char value);
    CArchive& operator<<(BYTE value);
    CArchive& operator<<(short value);
    CArchive& operator<<(WORD value);
    CArchive& operator<<(int value);
    CArchive& operator<<(unsigned int value);
    /// 4 bytes; a number beyond their range is stored as the nearest limit.
    CArchive& operator<<(long value);
    CArchive& operator<<(unsigned long value);
    CArchive& operator<<(LONGLONG value);
    CArchive& operator<<(ULONGLONG value);
    CArchive& operator<<(float value);
    CArchive& operator<<(double value);
    /// One byte. A template, so that pointers are not taken for truth values.
    template <std::same_as<bool> Bool>
    CArchive& operator<<(Bool value) {
        return *this << static_cast<BYTE>(value);
    }
    CArchive& operator<<(const CString& text);
    CArchive& operator<<(const CObject* object);
    CArchive& operator<<(SIZE size);
    CArchive& operator<<(POINT point);
    CArchive& operator<<(const RECT& rect);
    /// @}

    /// Load a value of the size that was stored; raise CArchiveException (`endOfFile`, or `writeOnly` in an archive
    /// that stores).
    /// @{
    CArchive& operator>>(char& value);
    CArchive& operator>>(BYTE& value);
    CArchive& operator>>(short& value);
    CArchive& operator>>(WORD& value);
    CArchive& operator>>(int& value);
    CArchive& operator>>(unsigned int& value);
    CArchive& operator>>(long& value);
    CArchive& operator>>(unsigned long& value);
    CArchive& operator>>(LONGLONG& value);
    CArchive& operator>>(ULONGLONG& value);
    CArchive& operator>>(float& value);
    CArchive& operator>>(double& value);
    CArchive& operator>>(bool& value);
    CArchive& operator>>(CString& text);
    /// The object is the caller's, unless it was loaded before. Null when a null pointer was stored.
    CArchive& operator>>(CObject*& object);
    CArchive& operator>>(SIZE& size);
    CArchive& operator>>(POINT& point);
    CArchive& operator>>(RECT& rect);
    /// @}

    /// Stores an object, or the number of one stored before; null is fine. Raises CNotSupportedException for an object
    /// whose class lacks DECLARE_SERIAL.
    void WriteObject(const CObject* object);
    /// Loads an object.
    /// @param expected  the class it must have or derive from; null for any. Else CArchiveException (`badClass`)
    /// @return the object, which is the caller's unless it was loaded before; null when a null pointer was stored
    CObject* ReadObject(const CRuntimeClass* expected);
    /// Makes an object known that is stored or loaded by other means, so that pointers to it can be.
    void MapObject(const CObject* object);
    /// Stores a class.
    void WriteClass(const CRuntimeClass* runtimeClass);
    /// Loads a class.
    /// @param expected  the class it must be or derive from; null for any
    CRuntimeClass* ReadClass(const CRuntimeClass* expected);
    /// Stores a class, or loads it and checks that it is this one: for objects stored without pointers.
    void SerializeClass(const CRuntimeClass* runtimeClass);
    /// The schema of the object that is being loaded; 0xFFFFFFFF when there is none. A second call for the same object
    /// gives 0xFFFFFFFF.
    UINT GetObjectSchema() noexcept;
    /// Gives a Serialize function that reads another class's data the schema that it asks for.
    void SetObjectSchema(UINT schema) noexcept;

    /// The document that is being stored or loaded, for Serialize functions that need it; null when there is none.
    CDocument* m_pDocument = nullptr;
    /// The file's name, for messages.
    CString m_strFileName;

private:
    struct ClassTag;
    struct Nesting;

    template <typename Unsigned>
    CArchive& put(Unsigned value);
    template <typename Unsigned>
    Unsigned get();
    void requireStoring() const;
    void requireLoading() const;
    BOOL fill();
    [[noreturn]] void fail(int cause) const;
    DWORD known(const void* address);
    DWORD remember(const void* address);
    void writeTag(DWORD index, WORD smallMark, DWORD bigMark);
    ClassTag readTag();
    CRuntimeClass* readNewClass();
    CObject* loadedObject(DWORD index, const CRuntimeClass* expected) const;
    CObject* loadNewObject(CRuntimeClass* runtimeClass);

    /// What a number in the file stands for while loading.
    struct Loaded {
        CObject* object = nullptr;
        CRuntimeClass* runtimeClass = nullptr;
        UINT schema = 0;
    };

    CFile* m_file;
    UINT m_mode;
    std::vector<BYTE> m_buffer;
    /// Loading: the bytes of the buffer from m_position to m_end are still to be read. Storing: those before m_position
    /// are still to be written.
    std::size_t m_position = 0;
    std::size_t m_end = 0;
    std::unordered_map<const void*, DWORD> m_stored;
    DWORD m_storedCount = 1;
    std::vector<Loaded> m_loaded;
    UINT m_objectSchema = 0xFFFFFFFF;
    int m_depth = 0;
};

/// Writes the length of a text as operator<< does before its bytes.
/// @param isWide  marks text of 16-bit characters; their number is the length
TVX_PLATFORM_API void AfxWriteStringLength(CArchive& archive, UINT_PTR length, BOOL isWide);
/// Reads the length of a text.
/// @param characterSize  receives 1, or 2 for text of 16-bit characters
TVX_PLATFORM_API UINT_PTR AfxReadStringLength(CArchive& archive, int& characterSize);

/// Stores elements of a collection, or loads them into their place. Types that have archive operators use these, other
/// plain data go byte by byte: whatever has neither virtual functions nor anything to do at its end. Addresses and
/// other types raise CNotSupportedException. Hosts specialise it for their own.
template <typename TYPE>
void SerializeElements(CArchive& archive, TYPE* elements, INT_PTR count) {
    if constexpr (requires {
                      archive << *elements;
                      archive >> *elements;
                  }) {
        for (TYPE* element = elements; element != elements + count; ++element) {
            if (archive.IsStoring()) {
                archive << *element;
            } else {
                archive >> *element;
            }
        }
    } else if constexpr (std::is_trivially_destructible_v<TYPE> && !std::is_polymorphic_v<TYPE> &&
                         !std::is_pointer_v<TYPE>) {
        for (TYPE* element = elements; element != elements + count; ++element) {
            if (archive.IsStoring()) {
                archive.Write(element, sizeof(TYPE));
            } else {
                archive.EnsureRead(element, sizeof(TYPE));
            }
        }
    } else {
        AfxThrowNotSupportedException();
    }
}
