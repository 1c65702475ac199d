#include "platform/win/Module.h"

#include "platform/base/SystemPath.h"
#include "platform/base/Text.h"
#include "platform/win/Error.h"
#include "platform/win/detail/ModuleTable.h"

#include <dlfcn.h>
#include <link.h>

#include <algorithm>
#include <cstring>
#include <filesystem>

namespace tvx::detail {

namespace {

// The loader's own entry tells files apart; their paths may be relative or lead over links.
const void* loadBase(const void* address) {
    Dl_info info{};
    link_map* map = nullptr;
    if (dladdr1(address, &info, reinterpret_cast<void**>(&map), RTLD_DL_LINKMAP) == 0) {
        return nullptr;
    }
    return map;
}

const void* applicationBase() {
    static const void* const base = [] {
        link_map* map = nullptr;
        dlinfo(dlopen(nullptr, RTLD_LAZY), RTLD_DI_LINKMAP, &map);
        return map;
    }();
    return base;
}

std::string pathOf(const void* base) {
    const bool isApplication = base == applicationBase();
    const std::filesystem::path file = isApplication ? "/proc/self/exe" : static_cast<const link_map*>(base)->l_name;
    std::error_code error;
    const auto resolved = std::filesystem::canonical(file, error);
    return error ? file.string() : resolved.string();
}

// What a module is called, in lower case: "guiutilities" for /usr/lib/libGuiUtilities.so.1.
std::string plainName(std::string_view path) {
    std::string name = plainModuleName(path);
    if (const auto slash = name.find_last_of("/\\"); slash != std::string::npos) {
        name.erase(0, slash + 1);
    }
    name = text::toLower(name);
    for (const std::string_view extension : {".dll", ".exe"}) {
        if (name.ends_with(extension)) {
            name.erase(name.size() - extension.size());
        }
    }
    return name;
}

} // namespace

const std::string& Module::path() {
    if (m_path.empty()) {
        m_path = pathOf(m_base);
    }
    return m_path;
}

void Module::add(ResourceBytes data) {
    m_parts.push_back({data, nullptr});
}

void Module::remove(const void* data) {
    std::erase_if(m_parts, [&](const Part& part) { return part.data.data() == data; });
}

std::vector<const ResourceIndex*> Module::indexes() {
    std::vector<const ResourceIndex*> result;
    for (Part& part : m_parts) {
        if (!part.index) {
            part.index = std::make_unique<ResourceIndex>(part.data);
        }
        result.push_back(part.index.get());
    }
    return result;
}

ModuleTable& ModuleTable::instance() {
    // Never destroyed: shared objects hand their resources back after this library's own objects are gone.
    static ModuleTable* const table = new ModuleTable;
    return *table;
}

void ModuleTable::add(const void* anchor, ResourceBytes data) {
    const void* base = loadBase(anchor);
    const std::scoped_lock lock(m_mutex);
    Module* module = byBase(base);
    if (!module) {
        module = m_modules.emplace_back(std::make_unique<Module>(base)).get();
    }
    module->add(data);
}

void ModuleTable::remove(const void* data) {
    const void* base = loadBase(data);
    const std::scoped_lock lock(m_mutex);
    Module* module = byBase(base);
    if (!module) {
        return;
    }
    module->remove(data);
    if (module->isEmpty() && module->uses == 0 && base != applicationBase()) {
        std::erase_if(m_modules, [&](const auto& owned) { return owned.get() == module; });
    }
}

HMODULE ModuleTable::useFile(const std::string& path) {
    const std::scoped_lock lock(m_mutex);
    const auto found = std::ranges::find_if(
        m_modules, [&](const auto& owned) { return owned->isResourceLibrary() && owned->path() == path; });
    if (found == m_modules.end()) {
        return nullptr;
    }
    ++(*found)->uses;
    return (*found)->handle();
}

HMODULE ModuleTable::addFile(std::string path, std::vector<std::uint8_t> bytes) {
    const std::scoped_lock lock(m_mutex);
    Module& module = *m_modules.emplace_back(std::make_unique<Module>(std::move(path), std::move(bytes)));
    module.uses = 1;
    return module.handle();
}

HMODULE ModuleTable::useCode(void* code) {
    link_map* base = nullptr;
    dlinfo(code, RTLD_DI_LINKMAP, &base);
    const std::scoped_lock lock(m_mutex);
    Module* module = byBase(base);
    if (!module) {
        module = m_modules.emplace_back(std::make_unique<Module>(base)).get();
    }
    module->code = code;
    ++module->uses;
    return module->handle();
}

bool ModuleTable::release(HMODULE handle) {
    void* code = nullptr;
    {
        const std::scoped_lock lock(m_mutex);
        Module* module = handle ? byHandle(handle) : nullptr;
        if (!module || module->uses == 0) {
            return false;
        }
        code = module->code;
        // One with resources goes when it takes them back, which may be never: something else may hold its file.
        if (--module->uses == 0 && (module->isResourceLibrary() || module->isEmpty())) {
            std::erase_if(m_modules, [&](const auto& owned) { return owned.get() == module; });
        }
    }
    if (code) {
        dlclose(code); // outside of the lock: what is unloaded takes its resources back
    }
    return true;
}

void* ModuleTable::symbol(HMODULE handle, const char* name) {
    const std::scoped_lock lock(m_mutex);
    Module* module = byHandle(handle);
    if (!module || module->isResourceLibrary()) {
        return nullptr;
    }
    // By the name that the loader has for it: the file of that name may be another one by now.
    const bool isApplication = module->base() == applicationBase();
    void* code =
        dlopen(isApplication ? nullptr : static_cast<const link_map*>(module->base())->l_name, RTLD_LAZY | RTLD_NOLOAD);
    if (!code) {
        return nullptr;
    }
    void* found = dlsym(code, name);
    dlclose(code);
    // The loader answers for the libraries below a module, too.
    return loadBase(found) == module->base() ? found : nullptr;
}

HMODULE ModuleTable::application() {
    const std::scoped_lock lock(m_mutex);
    return applicationModule().handle();
}

HMODULE ModuleTable::fromAddress(const void* address) {
    const void* base = loadBase(address);
    const std::scoped_lock lock(m_mutex);
    if (base && base == applicationBase()) {
        return applicationModule().handle();
    }
    Module* module = byBase(base);
    return module ? module->handle() : nullptr;
}

HMODULE ModuleTable::fromName(std::string_view name) {
    const std::string wanted = plainName(name);
    const std::scoped_lock lock(m_mutex);
    applicationModule();
    for (const auto& module : m_modules) {
        if (wanted == plainName(module->path())) {
            return module->handle();
        }
    }
    return nullptr;
}

std::string ModuleTable::path(HMODULE handle) {
    const std::scoped_lock lock(m_mutex);
    Module* module = byHandle(handle);
    return module ? module->path() : std::string();
}

std::vector<const ResourceIndex*> ModuleTable::indexes(HMODULE handle) {
    const std::scoped_lock lock(m_mutex);
    Module* module = byHandle(handle);
    return module ? module->indexes() : std::vector<const ResourceIndex*>();
}

Module& ModuleTable::applicationModule() {
    if (Module* module = byBase(applicationBase())) {
        return *module;
    }
    return *m_modules.emplace_back(std::make_unique<Module>(applicationBase()));
}

Module* ModuleTable::byBase(const void* base) {
    if (!base) {
        return nullptr;
    }
    const auto found = std::ranges::find_if(m_modules, [&](const auto& owned) { return owned->base() == base; });
    return found == m_modules.end() ? nullptr : found->get();
}

Module* ModuleTable::byHandle(HMODULE handle) {
    if (!handle) {
        return &applicationModule();
    }
    const auto found = std::ranges::find_if(m_modules, [&](const auto& owned) { return owned->handle() == handle; });
    return found == m_modules.end() ? nullptr : found->get();
}

} // namespace tvx::detail

namespace tvx {

using detail::ModuleTable;

void registerResources(const void* anchor, const void* data, std::size_t size) {
    ModuleTable::instance().add(anchor, {static_cast<const std::uint8_t*>(data), size});
}

void unregisterResources(const void* data) {
    ModuleTable::instance().remove(data);
}

std::string plainModuleName(std::string_view path) {
    const auto slash = path.find_last_of("/\\");
    std::string folder(path.substr(0, slash == std::string_view::npos ? 0 : slash + 1));
    std::string_view file = path.substr(folder.size());
    constexpr std::string_view prefix = "lib";
    const auto extension = text::toLower(file).find(".so");
    if (extension == std::string::npos) {
        return std::string(path);
    }
    file = file.substr(0, extension);
    if (text::startsWithNoCase(file, prefix)) {
        file.remove_prefix(prefix.size());
    }
    return folder.append(file);
}

HMODULE moduleFromAddress(const void* address) {
    return ModuleTable::instance().fromAddress(address);
}

std::string moduleFileName(HMODULE module) {
    return ModuleTable::instance().path(module);
}

HMODULE applicationModule() {
    return ModuleTable::instance().application();
}

} // namespace tvx

HMODULE GetModuleHandleA(LPCSTR name) {
    auto& table = tvx::detail::ModuleTable::instance();
    const HMODULE module = name ? table.fromName(name) : table.application();
    if (!module) {
        SetLastError(ERROR_MOD_NOT_FOUND);
    }
    return module;
}

FARPROC GetProcAddress(HMODULE module, LPCSTR name) {
    // Numbers in the place of names are below all addresses.
    const bool isName = reinterpret_cast<std::uintptr_t>(name) > 0xFFFF;
    void* const found = isName ? tvx::detail::ModuleTable::instance().symbol(module, name) : nullptr;
    if (!found) {
        SetLastError(ERROR_PROC_NOT_FOUND);
    }
    return reinterpret_cast<FARPROC>(found);
}

DWORD GetModuleFileNameA(HMODULE module, LPSTR buffer, DWORD size) {
    const std::string path = tvx::driveName(tvx::moduleFileName(module));
    if (path.empty() || !buffer || size == 0) {
        SetLastError(path.empty() ? ERROR_MOD_NOT_FOUND : ERROR_INSUFFICIENT_BUFFER);
        return 0;
    }
    if (const std::size_t length = tvx::text::copyCut(path, buffer, size); length == path.size()) {
        return static_cast<DWORD>(length);
    }
    SetLastError(ERROR_INSUFFICIENT_BUFFER);
    return size;
}
