#include "platform/win/AcceleratorTemplate.h"

#include "platform/win/detail/ByteReader.h"

namespace tvx {

ResourceResult<std::vector<AcceleratorTemplate>> parseAcceleratorTemplate(ResourceBytes data) {
    constexpr unsigned lastEntryFlag = 0x80;
    constexpr unsigned keyFlags = 0x1F;
    detail::ByteReader reader(data);
    std::vector<AcceleratorTemplate> entries;
    for (bool isLast = false; !isLast;) {
        const unsigned flags = reader.u16();
        AcceleratorTemplate entry;
        entry.flags = static_cast<BYTE>(flags & keyFlags);
        entry.key = reader.u16();
        entry.command = reader.u16();
        reader.skip(2);
        if (!reader.ok()) {
            return ResourceError{"accelerator table ends after " + std::to_string(entries.size()) +
                                 " entries without an end mark"};
        }
        entries.push_back(entry);
        isLast = (flags & lastEntryFlag) != 0;
    }
    return entries;
}

} // namespace tvx
