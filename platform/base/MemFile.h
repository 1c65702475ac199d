#pragma once

#include "platform/base/File.h"

#include <memory>

/// A file in memory. Growing raises CMemoryException when no memory is left.
///
/// @code
/// CMemFile file;
/// CArchive archive(&file, CArchive::store);
/// @endcode
class TVX_PLATFORM_API CMemFile : public CFile {
    DECLARE_DYNAMIC(CMemFile)

public:
    /// An empty file.
    /// @param growBytes  a hint that hosts give; growth is geometric
    explicit CMemFile(UINT growBytes = 1024);
    /// A file over memory of the caller's, see Attach.
    CMemFile(BYTE* buffer, UINT size);
    ~CMemFile() override;

    /// Uses memory of the caller's, which must outlive the file, as its contents. The file cannot grow beyond it.
    void Attach(BYTE* buffer, UINT size);
    /// Ends the file and gives its memory away: memory of its own is the caller's then, to be released with free().
    /// Null for an empty file.
    BYTE* Detach();

    /// Not possible by name: raises CNotSupportedException.
    BOOL Open(LPCTSTR fileName, UINT openFlags, CFileException* error = nullptr) override;
    /// Raises CNotSupportedException.
    CFile* Duplicate() const override;
    void Close() override;
    void Abort() override;
    UINT Read(void* buffer, UINT count) override;
    void Write(const void* buffer, UINT count) override;
    void Flush() override;
    ULONGLONG Seek(LONGLONG offset, UINT from) override;
    ULONGLONG GetPosition() const override;
    ULONGLONG GetLength() const override;
    void SetLength(ULONGLONG length) override;
    [[nodiscard]] BOOL IsOpen() const noexcept override;

private:
    struct Free {
        void operator()(BYTE* memory) const noexcept;
    };

    void reserve(ULONGLONG size);

    std::unique_ptr<BYTE, Free> m_own;
    /// The contents: memory of its own or the caller's.
    BYTE* m_data = nullptr;
    ULONGLONG m_capacity = 0;
    ULONGLONG m_length = 0;
    ULONGLONG m_position = 0;
    bool m_attached = false;
};
