#include "platform/win/ExtensionModule.h"

#include "platform/base/StringSource.h"
#include "platform/win/Resource.h"
#include "platform/win/ResourceLibrary.h"

#include <algorithm>
#include <concepts>
#include <vector>

namespace {

// Links in the order of the search. Plain pointers: each link enters and leaves by itself.
std::vector<CDynLinkLibrary*>& chain() {
    // Never destroyed: libraries may take out their links while the process ends.
    static auto* const links = new std::vector<CDynLinkLibrary*>;
    return *links;
}

HINSTANCE currentResourceModule = nullptr;

// Ordinary links stand before the system ones, each kind with its newest first.
void join(CDynLinkLibrary* link) {
    auto& links = chain();
    const auto place =
        std::ranges::find_if(links, [&](const CDynLinkLibrary* other) { return other->m_bSystem || !link->m_bSystem; });
    links.insert(place, link);
}

// The layer's own texts in the user's language. Looked for when a search comes so far for the first time.
HINSTANCE layerTranslation() {
    static const HINSTANCE module = tvx::loadTranslation(tvx::platformModule());
    return module;
}

// The first module of the search that `has` what is looked for; null when none has.
HINSTANCE search(std::predicate<HINSTANCE> auto has) {
    for (const HINSTANCE module : {AfxGetResourceHandle(), AfxGetInstanceHandle()}) {
        if (has(module)) {
            return module;
        }
    }
    for (const CDynLinkLibrary* link : chain()) {
        for (const HINSTANCE module : {link->m_hResource, link->m_hModule}) {
            if (module && has(module)) {
                return module;
            }
        }
    }
    for (const HINSTANCE module : {layerTranslation(), tvx::platformModule()}) {
        if (module && has(module)) {
            return module;
        }
    }
    return nullptr;
}

bool loadStringForBase(HINSTANCE module, UINT id, std::string& text) {
    if (!module) {
        module = AfxFindStringResourceHandle(id);
    }
    if (!module) {
        return false;
    }
    auto string = tvx::resourceString(module, id);
    if (string) {
        text = std::move(*string);
    }
    return string.has_value();
}

__attribute__((constructor)) void installStringLoader() {
    tvx::setStringLoader(loadStringForBase);
}

} // namespace

BOOL AfxInitExtensionModule(AFX_EXTENSION_MODULE& state, HMODULE module) {
    if (state.bInitialized) {
        return TRUE;
    }
    state.bInitialized = TRUE;
    state.hModule = module;
    state.hResource = module;
    return TRUE;
}

void AfxTermExtensionModule(AFX_EXTENSION_MODULE& state, BOOL) {
    if (!state.bInitialized) {
        return;
    }
    const auto links = chain();
    for (CDynLinkLibrary* link : links) {
        if (link->m_hModule == state.hModule) {
            delete link; // NOLINT: the chain owns its links
        }
    }
    state = {};
}

CDynLinkLibrary::CDynLinkLibrary(AFX_EXTENSION_MODULE& state, BOOL system)
    : m_hModule(state.hModule), m_hResource(state.hResource), m_bSystem(system) {
    join(this);
}

CDynLinkLibrary::CDynLinkLibrary(HINSTANCE module, HINSTANCE resource)
    : m_hModule(module), m_hResource(resource ? resource : module), m_bSystem(FALSE) {
    join(this);
}

CDynLinkLibrary::~CDynLinkLibrary() {
    std::erase(chain(), this);
}

HINSTANCE AfxGetInstanceHandle() {
    return tvx::applicationModule();
}

HINSTANCE AfxGetResourceHandle() {
    return currentResourceModule ? currentResourceModule : tvx::applicationModule();
}

void AfxSetResourceHandle(HINSTANCE resource) {
    currentResourceModule = resource;
}

HINSTANCE AfxFindResourceHandle(LPCSTR name, LPCSTR type) {
    const HINSTANCE found = search([&](HINSTANCE module) { return FindResourceA(module, name, type) != nullptr; });
    return found ? found : AfxGetResourceHandle();
}

HINSTANCE AfxFindStringResourceHandle(UINT id) {
    return search([&](HINSTANCE module) { return tvx::resourceString(module, id).has_value(); });
}

int AfxLoadString(UINT id, LPSTR buffer, UINT size) {
    if (size > 0) {
        buffer[0] = '\0';
    }
    const HINSTANCE module = AfxFindStringResourceHandle(id);
    return module && size > 0 ? LoadStringA(module, id, buffer, static_cast<int>(size)) : 0;
}

namespace tvx {

HMODULE platformModule() {
    // Any address in this library will do.
    static const HMODULE module = moduleFromAddress(reinterpret_cast<const void*>(&installStringLoader));
    return module;
}

} // namespace tvx
