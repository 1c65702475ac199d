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
        if (const auto own = permanent_.find(handle); own != permanent_.end()) {
            return own->second;
        }
        const auto made = temporary_.find(handle);
        return made != temporary_.end() ? made->second.get() : nullptr;
    }
    /// Only the host's own object.
    [[nodiscard]] Object* findPermanent(const void* handle) const {
        const auto own = permanent_.find(handle);
        return own != permanent_.end() ? own->second : nullptr;
    }
    void addPermanent(const void* handle, Object& object) {
        permanent_[handle] = &object;
    }
    /// Takes the handle out if it stands for `object`.
    void removePermanent(const void* handle, const Object& object) {
        const auto own = permanent_.find(handle);
        if (own != permanent_.end() && own->second == &object) {
            permanent_.erase(own);
        }
    }
    Object* addTemporary(const void* handle, std::unique_ptr<Object> object) {
        return (temporary_[handle] = std::move(object)).get();
    }
    /// @param release called for each object first, so that it does not take what it never owned with it
    template <class Release>
    void deleteTemporaries(Release release) {
        auto dying = std::move(temporary_);
        temporary_.clear();
        for (auto& [handle, object] : dying) {
            release(*object);
        }
    }
    template <class Release>
    void deleteTemporary(const void* handle, Release release) {
        if (auto node = temporary_.extract(handle)) {
            release(*node.mapped());
        }
    }

private:
    std::unordered_map<const void*, Object*> permanent_;
    std::unordered_map<const void*, std::unique_ptr<Object>> temporary_;
};

} // namespace tvx::afx
