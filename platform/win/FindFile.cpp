#include "platform/win/FindFile.h"

#include "platform/base/SystemPath.h"
#include "platform/base/Text.h"
#include "platform/win/Error.h"
#include "platform/win/detail/FolderWalk.h"
#include "platform/win/detail/NumberTable.h"

#include <cerrno>
#include <memory>

namespace {

using tvx::win::FolderWalk;

/// Whether a name matches a pattern. Each star is tried with the least text first; only the last one met is ever
/// lengthened, so the time is at most the product of the lengths.
bool matches(std::string_view name, std::string_view pattern) {
    constexpr auto none = std::string_view::npos;
    std::size_t at = 0;
    std::size_t inPattern = 0;
    std::size_t star = none;
    std::size_t tried = 0;
    while (at < name.size()) {
        const std::size_t length = tvx::text::characterLength(name, at);
        const std::size_t wanted = tvx::text::characterLength(pattern, inPattern);
        if (wanted > 0 && pattern[inPattern] == '*') {
            star = inPattern++;
            tried = at;
        } else if (wanted > 0 && (pattern[inPattern] == '?' ||
                                  tvx::text::equalNoCase(name.substr(at, length), pattern.substr(inPattern, wanted)))) {
            at += length;
            inPattern += wanted;
        } else if (star != none) {
            tried += tvx::text::characterLength(name, tried);
            at = tried;
            inPattern = star + 1;
        } else {
            return false;
        }
    }
    return pattern.find_first_not_of('*', inPattern) == none;
}

class Search {
public:
    Search(const std::string& folder, std::string_view pattern)
        : m_walk(folder), m_pattern(pattern == "*.*" ? "*" : pattern) {}

    /// False at the end and on failure; see error().
    bool next(WIN32_FIND_DATAA& data) {
        while (const auto entry = m_walk.next()) {
            if (matches(entry->name, m_pattern)) {
                fill(data, *entry);
                return true;
            }
        }
        return false;
    }
    DWORD error() const {
        return m_walk.error() == 0 ? ERROR_NO_MORE_FILES : tvx::errorFromErrno(m_walk.error());
    }

private:
    static void fill(WIN32_FIND_DATAA& data, const FolderWalk::Entry& entry) {
        data = {};
        const bool isHidden = entry.name.starts_with('.') && entry.name != "." && entry.name != "..";
        data.dwFileAttributes =
            (entry.isFolder ? FILE_ATTRIBUTE_DIRECTORY : 0U) | (isHidden ? FILE_ATTRIBUTE_HIDDEN : 0U);
        if (data.dwFileAttributes == 0) {
            data.dwFileAttributes = FILE_ATTRIBUTE_NORMAL;
        }
        tvx::text::copyCut(entry.name, data.cFileName, sizeof(data.cFileName));
    }

    FolderWalk m_walk;
    std::string m_pattern;
};

using Searches = tvx::win::NumberTable<std::shared_ptr<Search>>;

Searches& searches() {
    static auto* open = new Searches;
    return *open;
}

HANDLE refused(DWORD error) {
    SetLastError(error);
    return INVALID_HANDLE_VALUE;
}

} // namespace

HANDLE FindFirstFileA(LPCSTR pattern, WIN32_FIND_DATAA* entry) {
    const std::string_view name = pattern ? pattern : "";
    const std::size_t last = std::max(name.find_last_of("\\/") + 1, tvx::rootLength(name));
    const auto folder = tvx::systemPath(last == 0 ? "." : name.substr(0, last));
    if (!folder || last == name.size()) {
        return refused(folder ? ERROR_FILE_NOT_FOUND : ERROR_PATH_NOT_FOUND);
    }
    const auto search = std::make_shared<Search>(*folder, name.substr(last));
    if (search->next(*entry)) {
        return reinterpret_cast<HANDLE>(searches().add(search));
    }
    const DWORD error = search->error();
    const bool isMissing = error == ERROR_FILE_NOT_FOUND || error == ERROR_DIRECTORY;
    return refused(error == ERROR_NO_MORE_FILES ? ERROR_FILE_NOT_FOUND : isMissing ? ERROR_PATH_NOT_FOUND : error);
}

BOOL FindNextFileA(HANDLE find, WIN32_FIND_DATAA* entry) {
    std::shared_ptr<Search> search;
    // Reading may take long: the others are not kept off meanwhile.
    searches().with(reinterpret_cast<std::uintptr_t>(find), [&](const auto& found) { search = found; });
    if (search && search->next(*entry)) {
        return TRUE;
    }
    SetLastError(search ? search->error() : ERROR_INVALID_HANDLE);
    return FALSE;
}

BOOL FindClose(HANDLE find) {
    if (searches().take(reinterpret_cast<std::uintptr_t>(find))) {
        return TRUE;
    }
    SetLastError(ERROR_INVALID_HANDLE);
    return FALSE;
}
