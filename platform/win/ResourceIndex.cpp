#include "platform/win/detail/ResourceIndex.h"

#include "platform/base/Text.h"
#include "platform/win/detail/ByteReader.h"

#include <algorithm>
#include <charconv>
#include <tuple>

namespace tvx::detail {

namespace {

constexpr std::uint16_t ordinalMark = 0xFFFF;
// Two lengths, two names of at least two bytes each, and 16 bytes of versions, flags and language.
constexpr std::uint32_t smallestHeader = 28;
constexpr std::uint32_t headSize = 32;

std::string keyOf(WORD number) {
    return "#" + std::to_string(number);
}

std::string keyOf(std::string_view name) {
    unsigned number = 0;
    if (name.size() > 1 && name.front() == '#') {
        const auto [end, error] = std::from_chars(name.data() + 1, name.data() + name.size(), number);
        if (error == std::errc() && end == name.data() + name.size() && number <= 0xFFFF) {
            return keyOf(static_cast<WORD>(number));
        }
    }
    return text::foldCase(name);
}

std::string readKey(ByteReader& reader) {
    if (reader.peekU16() != ordinalMark) {
        return keyOf(text::narrow(reader.zeroEndedText()));
    }
    reader.skip(2);
    return keyOf(reader.u16());
}

// The list begins with an empty entry, which tells this format from older ones.
bool isListHead(ResourceBytes data) {
    ByteReader reader(data);
    return data.size() >= headSize && reader.u32() == 0 && reader.u32() == headSize && reader.u16() == ordinalMark &&
           reader.u16() == 0 && reader.u16() == ordinalMark && reader.u16() == 0;
}

std::string damageAt(const char* what, std::size_t offset) {
    return std::string(what) + " at offset " + std::to_string(offset);
}

// Reads one entry; `damage` tells why it was refused.
ResourceEntry readEntry(ByteReader& reader, std::string& damage) {
    const std::size_t start = reader.position();
    ResourceEntry entry;
    const std::uint32_t dataSize = reader.u32();
    const std::uint32_t headerSize = reader.u32();
    if (!reader.ok() || headerSize < smallestHeader || headerSize - 8 > reader.remaining()) {
        damage = damageAt("resource header of a wrong size", start);
        return entry;
    }
    ByteReader header(reader.bytes(headerSize - 8));
    entry.type = readKey(header);
    entry.name = readKey(header);
    header.align(4);
    header.skip(6); // data version, memory flags
    entry.language = header.u16();
    header.skip(8); // version, characteristics
    if (!header.ok()) {
        damage = damageAt("resource header without an end", start);
    }
    entry.data = reader.bytes(dataSize);
    if (!reader.ok()) {
        damage = damageAt("resource longer than the file", start);
    }
    reader.align(4);
    return entry;
}

auto keyRange(const std::vector<ResourceEntry>& entries, const std::string& type, const std::string& name) {
    return std::ranges::equal_range(entries, std::tie(type, name), {},
                                    [](const ResourceEntry& entry) { return std::tie(entry.type, entry.name); });
}

} // namespace

std::string resourceKey(LPCSTR name) {
    if (IS_INTRESOURCE(name)) {
        return keyOf(static_cast<WORD>(reinterpret_cast<std::uintptr_t>(name)));
    }
    return keyOf(std::string_view(name));
}

ResourceIndex::ResourceIndex(ResourceBytes data) {
    if (!isListHead(data)) {
        m_damage = "no list of resources";
        return;
    }
    ByteReader reader(data);
    reader.skip(headSize);
    while (reader.remaining() > 0 && m_damage.empty()) {
        m_entries.push_back(readEntry(reader, m_damage));
    }
    if (!m_damage.empty()) {
        m_entries.clear();
        return;
    }
    // Equal names, which differ in language, stay in the order of the file.
    std::ranges::sort(m_entries, {}, [](const ResourceEntry& entry) {
        return std::tuple<const std::string&, const std::string&, const void*>(entry.type, entry.name,
                                                                               entry.data.data());
    });
}

const ResourceEntry* ResourceIndex::find(const std::string& type, const std::string& name,
                                         std::optional<WORD> language) const {
    const auto range = keyRange(m_entries, type, name);
    if (range.empty()) {
        return nullptr;
    }
    const auto found = std::ranges::find(range, language.value_or(0), &ResourceEntry::language);
    if (found != range.end()) {
        return &*found;
    }
    return language ? nullptr : &range.front();
}

bool ResourceIndex::hasType(const std::string& type) const {
    return std::ranges::binary_search(m_entries, type, {}, &ResourceEntry::type);
}

} // namespace tvx::detail
