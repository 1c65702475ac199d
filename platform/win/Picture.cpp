#include "platform/win/Picture.h"

#include "platform/win/Resource.h"
#include "platform/win/detail/ByteReader.h"
#include "platform/win/detail/Dib.h"

#include <algorithm>
#include <tuple>

namespace tvx {

namespace {

using detail::ByteReader;
using detail::DibUse;

enum class GroupKind : std::uint16_t { Icon = 1, Cursor = 2 };

// One size of an icon or a cursor.
struct GroupEntry {
    int size = 0;
    int bitsPerPixel = 0;
    WORD id = 0;
};

GroupEntry readGroupEntry(ByteReader& reader, GroupKind kind) {
    GroupEntry entry;
    if (kind == GroupKind::Icon) {
        const int width = reader.u8();
        entry.size = width == 0 ? 256 : width;
        reader.skip(3); // height, number of colours
    } else {
        entry.size = reader.u16();
        reader.skip(2);
    }
    reader.skip(2); // planes
    entry.bitsPerPixel = reader.u16();
    reader.skip(4); // size of the data
    entry.id = reader.u16();
    return entry;
}

ResourceResult<std::vector<GroupEntry>> parseGroup(ResourceBytes data, GroupKind kind) {
    ByteReader reader(data);
    const unsigned reserved = reader.u16();
    const unsigned type = reader.u16();
    const unsigned count = reader.u16();
    if (!reader.ok() || reserved != 0 || type != static_cast<unsigned>(kind)) {
        return ResourceError{"no list of icons or cursors"};
    }
    std::vector<GroupEntry> entries;
    for (unsigned i = 0; i < count && reader.ok(); ++i) {
        entries.push_back(readGroupEntry(reader, kind));
    }
    if (!reader.ok() || entries.empty()) {
        return ResourceError{"list of icons ends before the last of its " + std::to_string(count) + " entries"};
    }
    return entries;
}

// Best first: the wanted size, larger ones from the smallest up, smaller ones from the largest down.
void sortByFitness(std::vector<GroupEntry>& entries, int size) {
    std::ranges::sort(entries, {}, [size](const GroupEntry& entry) {
        const bool isSmaller = entry.size < size;
        return std::tuple(isSmaller, isSmaller ? size - entry.size : entry.size - size, -entry.bitsPerPixel, entry.id);
    });
}

// The first entry that can be read; the first reason when none can. Large sizes may be in a format of files.
template <class T>
ResourceResult<T> firstReadable(HMODULE module, const std::vector<GroupEntry>& entries, LPCSTR type,
                                ResourceResult<T> (*parse)(ResourceBytes)) {
    ResourceResult<T> first = parse(resourceBytes(module, MAKEINTRESOURCE(entries.front().id), type));
    if (first) {
        return first;
    }
    for (auto entry = entries.begin() + 1; entry != entries.end(); ++entry) {
        if (auto other = parse(resourceBytes(module, MAKEINTRESOURCE(entry->id), type))) {
            return other;
        }
    }
    return first;
}

ResourceResult<CursorPicture> parseCursorImage(ResourceBytes data) {
    ByteReader reader(data);
    CursorPicture cursor;
    cursor.hotX = reader.u16();
    cursor.hotY = reader.u16();
    auto picture = detail::decodeDib(reader.bytes(reader.remaining()), DibUse::IconImage);
    if (!picture) {
        return picture.error();
    }
    cursor.picture = std::move(*picture);
    return cursor;
}

ResourceError notFound(const char* what) {
    return {std::string(what) + " not found"};
}

} // namespace

ResourceResult<Picture> parseBitmap(ResourceBytes data) {
    return detail::decodeDib(data, DibUse::Bitmap);
}

ResourceResult<Picture> parseIconImage(ResourceBytes data) {
    return detail::decodeDib(data, DibUse::IconImage);
}

ResourceResult<Picture> loadIconPicture(HMODULE module, LPCSTR name, int size) {
    const ResourceBytes data = resourceBytes(module, name, RT_GROUP_ICON);
    if (data.empty()) {
        return notFound("icon");
    }
    auto entries = parseGroup(data, GroupKind::Icon);
    if (!entries) {
        return entries.error();
    }
    sortByFitness(*entries, size);
    return firstReadable(module, *entries, RT_ICON, parseIconImage);
}

ResourceResult<CursorPicture> loadCursorPicture(HMODULE module, LPCSTR name) {
    const ResourceBytes data = resourceBytes(module, name, RT_GROUP_CURSOR);
    if (data.empty()) {
        return notFound("cursor");
    }
    auto entries = parseGroup(data, GroupKind::Cursor);
    if (!entries) {
        return entries.error();
    }
    return firstReadable(module, *entries, RT_CURSOR, parseCursorImage);
}

ResourceResult<Picture> loadBitmapPicture(HMODULE module, LPCSTR name) {
    const ResourceBytes data = resourceBytes(module, name, RT_BITMAP);
    return data.empty() ? ResourceResult<Picture>(notFound("bitmap")) : parseBitmap(data);
}

} // namespace tvx
