#pragma once

#include "platform/base/Export.h"
#include "platform/win/Module.h"
#include "platform/win/ResourceError.h"

#include <optional>
#include <string>
#include <vector>

namespace tvx::detail {

/// One resource inside `.res` data.
struct ResourceEntry {
    std::string type; ///< canonical name, see `resourceKey`
    std::string name;
    WORD language = 0;
    ResourceBytes data;
};

/// The canonical spelling of a resource name or type: "#123" for a number, else the text with its case folded.
[[nodiscard]] TVX_PLATFORM_API std::string resourceKey(LPCSTR name);

/// The list of what one piece of `.res` data holds. Data that is damaged anywhere is refused as a whole.
class TVX_PLATFORM_API ResourceIndex {
public:
    explicit ResourceIndex(ResourceBytes data);

    /// The resource of that key in `language`; in the neutral language, else the first one, when no language is asked
    /// for. The address stays valid as long as the index.
    [[nodiscard]] const ResourceEntry* find(const std::string& type, const std::string& name,
                                            std::optional<WORD> language) const;
    [[nodiscard]] bool hasType(const std::string& type) const;
    /// All resources, sorted by type, then name, then place in the file.
    [[nodiscard]] const std::vector<ResourceEntry>& entries() const {
        return m_entries;
    }
    /// Why the data was refused, empty when it is sound.
    [[nodiscard]] const std::string& damage() const {
        return m_damage;
    }

private:
    std::vector<ResourceEntry> m_entries;
    std::string m_damage;
};

} // namespace tvx::detail
