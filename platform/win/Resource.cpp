#include "platform/win/Resource.h"

#include "platform/base/Text.h"
#include "platform/win/Error.h"
#include "platform/win/detail/ByteReader.h"
#include "platform/win/detail/ModuleTable.h"

#include <tuple>

namespace {

using tvx::detail::ModuleTable;
using tvx::detail::ResourceEntry;
using tvx::detail::ResourceIndex;
using Indexes = std::vector<const ResourceIndex*>;

// Strings come in blocks of 16; block 1 holds the strings 0 to 15.
constexpr UINT stringsPerBlock = 16;

const ResourceEntry* findIn(const Indexes& indexes, LPCSTR type, LPCSTR name, std::optional<WORD> language) {
    const std::string typeKey = tvx::detail::resourceKey(type);
    const std::string nameKey = tvx::detail::resourceKey(name);
    for (const ResourceIndex* index : indexes) {
        if (const ResourceEntry* entry = index->find(typeKey, nameKey, language)) {
            return entry;
        }
    }
    return nullptr;
}

// Says why nothing was found: the first of the steps (any data, type, name, language) that failed.
DWORD whyMissing(const Indexes& indexes, LPCSTR type, LPCSTR name) {
    const std::string typeKey = tvx::detail::resourceKey(type);
    bool hasData = false;
    bool hasType = false;
    for (const ResourceIndex* index : indexes) {
        hasData = hasData || !index->entries().empty();
        hasType = hasType || index->hasType(typeKey);
    }
    if (!hasData) {
        return ERROR_RESOURCE_DATA_NOT_FOUND;
    }
    if (!hasType) {
        return ERROR_RESOURCE_TYPE_NOT_FOUND;
    }
    return findIn(indexes, type, name, std::nullopt) ? ERROR_RESOURCE_LANG_NOT_FOUND : ERROR_RESOURCE_NAME_NOT_FOUND;
}

const ResourceEntry* findEntry(HMODULE module, LPCSTR type, LPCSTR name, std::optional<WORD> language) {
    const Indexes indexes = ModuleTable::instance().indexes(module);
    const ResourceEntry* entry = findIn(indexes, type, name, language);
    if (!entry) {
        SetLastError(whyMissing(indexes, type, name));
    }
    return entry;
}

const ResourceEntry* entryOf(HRSRC resource) {
    return reinterpret_cast<const ResourceEntry*>(resource);
}

HRSRC handleOf(const ResourceEntry* entry) {
    return reinterpret_cast<HRSRC>(const_cast<ResourceEntry*>(entry));
}

} // namespace

HRSRC FindResourceA(HMODULE module, LPCSTR name, LPCSTR type) {
    return handleOf(findEntry(module, type, name, std::nullopt));
}

HRSRC FindResourceExA(HMODULE module, LPCSTR type, LPCSTR name, WORD language) {
    return handleOf(findEntry(module, type, name, language != 0 ? std::optional(language) : std::nullopt));
}

HGLOBAL LoadResource(HMODULE, HRSRC resource) {
    if (!resource) {
        SetLastError(ERROR_INVALID_HANDLE);
        return nullptr;
    }
    return const_cast<std::uint8_t*>(entryOf(resource)->data.data());
}

LPVOID LockResource(HGLOBAL data) {
    return data;
}

DWORD SizeofResource(HMODULE, HRSRC resource) {
    if (!resource) {
        SetLastError(ERROR_INVALID_HANDLE);
        return 0;
    }
    return static_cast<DWORD>(entryOf(resource)->data.size());
}

BOOL FreeResource(HGLOBAL) {
    return FALSE;
}

int LoadStringA(HINSTANCE module, UINT id, LPSTR buffer, int size) {
    const auto string = tvx::resourceString(module, id);
    if (size <= 0 || !buffer) {
        return string ? static_cast<int>(string->size()) : 0;
    }
    buffer[0] = '\0';
    if (!string) {
        return 0;
    }
    return static_cast<int>(tvx::text::copyCut(*string, buffer, static_cast<std::size_t>(size)));
}

namespace tvx {

ResourceBytes resourceBytes(HMODULE module, LPCSTR name, LPCSTR type) {
    const ResourceEntry* entry = findEntry(module, type, name, std::nullopt);
    return entry ? entry->data : ResourceBytes();
}

std::string firstResource(HMODULE module, LPCSTR type) {
    const std::string wanted = detail::resourceKey(type);
    // Numbers are written as "#128": they come behind names, and a shorter one is a lower one.
    const auto place = [](const std::string& name) {
        return std::tuple(name.starts_with('#'), name.starts_with('#') ? name.size() : 0, name);
    };
    std::string first;
    for (const ResourceIndex* index : ModuleTable::instance().indexes(module)) {
        for (const ResourceEntry& entry : index->entries()) {
            if (entry.type == wanted && (first.empty() || place(entry.name) < place(first))) {
                first = entry.name;
            }
        }
    }
    return first;
}

std::optional<std::string> resourceString(HMODULE module, UINT id) {
    if (id > 0xFFFF) {
        SetLastError(ERROR_RESOURCE_NAME_NOT_FOUND);
        return std::nullopt;
    }
    detail::ByteReader reader(resourceBytes(module, MAKEINTRESOURCE(id / stringsPerBlock + 1), RT_STRING));
    for (UINT i = 0; i < id % stringsPerBlock; ++i) {
        reader.skip(std::size_t{reader.u16()} * 2);
    }
    const std::u16string string = reader.text(reader.u16());
    if (reader.ok() && !string.empty()) {
        return text::narrow(string);
    }
    if (reader.ok()) {
        SetLastError(ERROR_RESOURCE_NAME_NOT_FOUND);
    }
    return std::nullopt;
}

std::string resourceDamage(HMODULE module) {
    for (const ResourceIndex* index : ModuleTable::instance().indexes(module)) {
        if (!index->damage().empty()) {
            return index->damage();
        }
    }
    return {};
}

} // namespace tvx
