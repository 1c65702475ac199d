// What happens when the library is loaded.
#include "platform/win/Module.h"
#include "afx.h"
#include "platform/port/Version.h"
#include "platform/win/ExtensionModule.h"
#include "s/Locale.h"
#include "s/Version.h"

#include <new>

namespace {

AFX_EXTENSION_MODULE s_state;

/// Joins the host's search for resources and provides the installation's values, before the host's own objects are
/// made.
class LibraryModule {
public:
    LibraryModule() {
        const HINSTANCE instance = tvx::moduleFromAddress(&s_state);
        AfxInitExtensionModule(s_state, instance);
        try {
            Gui_Locale::SetDllResourceHandle(s_state, instance);
            new CDynLinkLibrary(s_state); // the chain owns it
        } catch (const std::bad_alloc&) {
            TRACE0("The library works without its resources in the chain.\n");
        }
        Port::Version::setReader(&Gui_InstallInfo::GetValue);
    }
    ~LibraryModule() {
        Port::Version::setReader(nullptr);
        AfxTermExtensionModule(s_state);
    }
    LibraryModule(const LibraryModule&) = delete;
    LibraryModule& operator=(const LibraryModule&) = delete;
};

const LibraryModule s_library;

} // namespace
