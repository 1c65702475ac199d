#pragma once

/// @file
/// The framework's search for resources: the current resource module, the application, then the chain of extension
/// modules (newest first) and last the layer itself with the framework's own strings and dialogs. Where a module has a
/// translation (ResourceLibrary.h) that stands before it.
///
/// A shared library that brings resources joins the chain once, when it is loaded:
///
///     static AFX_EXTENSION_MODULE module;
///     AfxInitExtensionModule(module, instance);
///     new CDynLinkLibrary(module); // the chain owns it
///
/// The chain belongs to the user-interface thread; modules may be loaded by any thread.

#include "platform/base/Export.h"
#include "platform/base/Types.h"

/// What a resource-bearing shared library tells about itself. One static object a library.
struct AFX_EXTENSION_MODULE {
    BOOL bInitialized = FALSE;   ///< set by `AfxInitExtensionModule`
    HMODULE hModule = nullptr;   ///< the library itself
    HMODULE hResource = nullptr; ///< where its resources are taken from first: itself, or a translation of it
};

/// Fills `state` for the library `module`, which becomes its own resource module. Always TRUE; a second call changes
/// nothing.
TVX_PLATFORM_API BOOL AfxInitExtensionModule(AFX_EXTENSION_MODULE& state, HMODULE module);

/// Takes the library's links out of the chain and deletes them. For libraries that are unloaded before the process
/// ends.
TVX_PLATFORM_API void AfxTermExtensionModule(AFX_EXTENSION_MODULE& state, BOOL all = FALSE);

/// One link of the chain of extension modules. Made with `new` by the library when it is loaded; the chain owns it from
/// then on and deletes it in `AfxTermExtensionModule`. A link that is destroyed leaves the chain.
class TVX_PLATFORM_API CDynLinkLibrary {
public:
    /// Joins the chain at its head with the resource module that `state` names at this moment.
    /// @param system TRUE joins at the tail: for libraries whose resources others are meant to replace
    explicit CDynLinkLibrary(AFX_EXTENSION_MODULE& state, BOOL system = FALSE);
    /// The same for a library without a state of its own; a null `resource` means `module`.
    explicit CDynLinkLibrary(HINSTANCE module, HINSTANCE resource = nullptr);
    virtual ~CDynLinkLibrary();

    CDynLinkLibrary(const CDynLinkLibrary&) = delete;
    CDynLinkLibrary& operator=(const CDynLinkLibrary&) = delete;

    HMODULE m_hModule;     ///< the library
    HINSTANCE m_hResource; ///< searched first; what it lacks is looked for in the library itself
    BOOL m_bSystem;        ///< whether it stands behind the others
};

/// The application's own module, whatever resources are current.
TVX_PLATFORM_API HINSTANCE AfxGetInstanceHandle();

/// The module that is searched first: the application's, or its translation once one was set.
TVX_PLATFORM_API HINSTANCE AfxGetResourceHandle();

/// Makes `resource` the module that is searched first. The application's own resources are still found behind it.
/// Null makes it the application's again.
TVX_PLATFORM_API void AfxSetResourceHandle(HINSTANCE resource);

/// The first module of the search that has the resource. When none has, the answer is `AfxGetResourceHandle()`, so that
/// the `FindResourceA` that follows reports the error.
TVX_PLATFORM_API HINSTANCE AfxFindResourceHandle(LPCSTR name, LPCSTR type);

/// The first module of the search whose string table has a non-empty string `id`, null when none has.
TVX_PLATFORM_API HINSTANCE AfxFindStringResourceHandle(UINT id);

/// Copies the string `id`, wherever the search finds it, into `buffer` of `size` bytes. The result is the length
/// copied; without such a string it is 0 and `buffer` is the empty text.
TVX_PLATFORM_API int AfxLoadString(UINT id, LPSTR buffer, UINT size = 256);

namespace tvx {

/// The layer's own module, the last one of the search.
[[nodiscard]] TVX_PLATFORM_API HMODULE platformModule();

} // namespace tvx
