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
    /// A resource library, which has no code and so no entry of the loader.
    /// @param path  the file's full path with links resolved
    /// @param bytes its contents
    Module(std::string path, std::vector<std::uint8_t> bytes) : m_path(std::move(path)), m_file(std::move(bytes)) {
        add(m_file);
    }
    Module(const Module&) = delete;
    Module& operator=(const Module&) = delete;

    [[nodiscard]] const void* base() const {
        return m_base;
    }
    [[nodiscard]] HMODULE handle() {
        return reinterpret_cast<HMODULE>(this);
    }
    [[nodiscard]] bool isEmpty() const {
        return m_parts.empty();
    }
    [[nodiscard]] bool isResourceLibrary() const {
        return m_base == nullptr;
    }
    /// How often it was asked for by name and not given back.
    int uses = 0;
    /// What the loader gave for it when it was asked for first; null for what it loaded by itself.
    void* code = nullptr;
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

    const void* m_base = nullptr;
    std::string m_path;
    std::vector<std::uint8_t> m_file;
    std::vector<Part> m_parts;
};

/// All modules of the process. Its operations may be called by any thread.
class ModuleTable {
public:
    static ModuleTable& instance();

    void add(const void* anchor, ResourceBytes data);
    void remove(const void* data);

    /// The resource library of that path, used once more; null when it is not loaded.
    [[nodiscard]] HMODULE useFile(const std::string& path);
    /// Keeps a resource library, used once.
    HMODULE addFile(std::string path, std::vector<std::uint8_t> bytes);
    /// Uses a module with code once more: what the loader gave for it, which counts the uses too.
    HMODULE useCode(void* code);
    /// Ends one use. False when `handle` is no module that is used.
    bool release(HMODULE handle);
    /// A function or variable that the module itself exports; null when it has none of that name.
    [[nodiscard]] void* symbol(HMODULE handle, const char* name);

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
