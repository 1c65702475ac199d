#pragma once

#include <memory>
#include <unordered_map>

namespace tvx::afx {

/// Which object of a framework class stands for a handle: the host's own, or one made in passing that lives until the
/// program is idle.
template <class Object>
class HandleMap {
public:
    [[nodiscard]] Object* find(const void* handle) const {
        if (const auto own = m_permanent.find(handle); own != m_permanent.end()) {
            return own->second;
        }
        const auto made = m_temporary.find(handle);
        return made != m_temporary.end() ? made->second.get() : nullptr;
    }
    /// Only the host's own object.
    [[nodiscard]] Object* findPermanent(const void* handle) const {
        const auto own = m_permanent.find(handle);
        return own != m_permanent.end() ? own->second : nullptr;
    }
    void addPermanent(const void* handle, Object& object) {
        m_permanent[handle] = &object;
    }
    /// Takes the handle out if it stands for `object`.
    void removePermanent(const void* handle, const Object& object) {
        const auto own = m_permanent.find(handle);
        if (own != m_permanent.end() && own->second == &object) {
            m_permanent.erase(own);
        }
    }
    Object* addTemporary(const void* handle, std::unique_ptr<Object> object) {
        return (m_temporary[handle] = std::move(object)).get();
    }
    /// @param release called for each object first, so that it does not take what it never owned with it
    template <class Release>
    void deleteTemporaries(Release release) {
        auto dying = std::move(m_temporary);
        m_temporary.clear();
        for (auto& [handle, object] : dying) {
            release(*object);
        }
    }
    template <class Release>
    void deleteTemporary(const void* handle, Release release) {
        if (auto node = m_temporary.extract(handle)) {
            release(*node.mapped());
        }
    }

private:
    std::unordered_map<const void*, Object*> m_permanent;
    std::unordered_map<const void*, std::unique_ptr<Object>> m_temporary;
};

} // namespace tvx::afx
