#pragma once

#include "platform/win/Module.h"
#include "platform/win/detail/ResourceIndex.h"

#include <memory>
#include <mutex>
#include <string>
#include <string_view>
#include <vector>

namespace tvx::detail {

/// One loaded file with the resource data it handed over. Its address is the module's handle.
class Module {
public:
    /// @param base the loader's entry of the file, which identifies it while it is loaded
    explicit Module(const void* base) : m_base(base) {}

    [[nodiscard]] const void* base() const {
        return m_base;
    }
    [[nodiscard]] HMODULE handle() {
        return reinterpret_cast<HMODULE>(this);
    }
    [[nodiscard]] bool isEmpty() const {
        return m_parts.empty();
    }
    /// The file's full path with links resolved; worked out when first asked for.
    const std::string& path();

    void add(ResourceBytes data);
    void remove(const void* data);
    /// The index of each piece of resource data, made when first asked for: a program that shows nothing reads nothing.
    std::vector<const ResourceIndex*> indexes();

private:
    struct Part {
        ResourceBytes data;
        std::unique_ptr<ResourceIndex> index;
    };

    const void* m_base;
    std::string m_path;
    std::vector<Part> m_parts;
};

/// All modules of the process. Its operations may be called by any thread.
class ModuleTable {
public:
    static ModuleTable& instance();

    void add(const void* anchor, ResourceBytes data);
    void remove(const void* data);

    [[nodiscard]] HMODULE application();
    [[nodiscard]] HMODULE fromAddress(const void* address);
    [[nodiscard]] HMODULE fromName(std::string_view name);
    /// Null and empty when `handle` is no module; a null handle is the application.
    [[nodiscard]] std::string path(HMODULE handle);
    [[nodiscard]] std::vector<const ResourceIndex*> indexes(HMODULE handle);

private:
    Module& applicationModule();
    Module* byBase(const void* base);
    Module* byHandle(HMODULE handle);

    std::mutex m_mutex;
    std::vector<std::unique_ptr<Module>> m_modules;
};

} // namespace tvx::detail
