#include "platform/win/Network.h"

#include "platform/base/Text.h"
#include "platform/win/Error.h"
#include "platform/win/detail/DriveTable.h"
#include "platform/win/detail/NumberTable.h"

#include <algorithm>
#include <cstring>

namespace {

using tvx::win::Drive;
using tvx::win::NumberTable;

struct Enumeration {
    std::shared_ptr<const tvx::win::DriveTable> table;
    std::size_t next = 0; ///< of the table's drives
};

NumberTable<Enumeration>& enumerations() {
    static auto* open = new NumberTable<Enumeration>;
    return *open;
}

/// Fills the caller's buffer: records from its beginning, texts from its end.
class ResourceBuffer {
public:
    ResourceBuffer(void* buffer, std::size_t size)
        : m_records(static_cast<NETRESOURCEA*>(buffer)), m_text(static_cast<char*>(buffer) + (buffer ? size : 0)) {}

    static std::size_t sizeOf(const Drive& drive) {
        return sizeof(NETRESOURCEA) + (drive.letter ? sizeof("X:") : 0) + drive.remoteName.size() + 1;
    }
    bool hasRoomFor(const Drive& drive) const {
        const char* const end = reinterpret_cast<const char*>(m_records + m_count);
        return static_cast<std::size_t>(m_text - end) >= sizeOf(drive);
    }
    void add(const Drive& drive) {
        NETRESOURCEA record{};
        record.dwScope = RESOURCE_CONNECTED;
        record.dwType = RESOURCETYPE_DISK;
        record.lpRemoteName = put(drive.remoteName);
        record.lpLocalName = drive.letter ? put({drive.letter, ':'}) : nullptr;
        std::memcpy(m_records + m_count++, &record, sizeof(record));
    }
    DWORD count() const {
        return m_count;
    }

private:
    char* put(const std::string& text) {
        m_text -= text.size() + 1;
        std::memcpy(m_text, text.c_str(), text.size() + 1);
        return m_text;
    }

    NETRESOURCEA* m_records;
    char* m_text;
    DWORD m_count = 0;
};

/// The enumeration's next connection; null at the end.
const Drive* nextConnection(Enumeration& enumeration) {
    const auto& drives = enumeration.table->drives();
    while (enumeration.next < drives.size() && drives[enumeration.next].remoteName.empty()) {
        ++enumeration.next;
    }
    return enumeration.next < drives.size() ? &drives[enumeration.next] : nullptr;
}

DWORD fill(Enumeration& enumeration, DWORD& count, void* buffer, DWORD& size) {
    const DWORD wanted = count;
    const Drive* drive = nextConnection(enumeration);
    ResourceBuffer resources(buffer, size);
    for (; drive && resources.count() < wanted && resources.hasRoomFor(*drive); drive = nextConnection(enumeration)) {
        resources.add(*drive);
        ++enumeration.next;
    }
    count = resources.count();
    if (count > 0 || wanted == 0) {
        return NO_ERROR;
    }
    if (!drive) {
        return ERROR_NO_MORE_ITEMS;
    }
    size = static_cast<DWORD>(ResourceBuffer::sizeOf(*drive));
    return ERROR_MORE_DATA;
}

} // namespace

DWORD WNetOpenEnumA(DWORD scope, DWORD type, DWORD /*usage*/, NETRESOURCEA* container, HANDLE* handle) {
    if (!handle || container) {
        return ERROR_INVALID_PARAMETER;
    }
    if (scope != RESOURCE_CONNECTED || type > RESOURCETYPE_DISK) {
        return ERROR_NOT_SUPPORTED;
    }
    *handle = reinterpret_cast<HANDLE>(enumerations().add({tvx::win::currentDrives(), 0}));
    return NO_ERROR;
}

DWORD WNetEnumResourceA(HANDLE handle, DWORD* count, void* buffer, DWORD* size) {
    if (!count || !size || (!buffer && *size > 0)) {
        return ERROR_INVALID_PARAMETER;
    }
    DWORD answer = ERROR_INVALID_HANDLE;
    enumerations().with(reinterpret_cast<std::uintptr_t>(handle),
                        [&](Enumeration& enumeration) { answer = fill(enumeration, *count, buffer, *size); });
    return answer;
}

DWORD WNetCloseEnum(HANDLE handle) {
    const Enumeration closed = enumerations().take(reinterpret_cast<std::uintptr_t>(handle));
    return closed.table ? ERROR_SUCCESS : ERROR_INVALID_HANDLE;
}
