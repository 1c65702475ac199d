#include "platform/win/ExtensionModule.h"
#include "platform/win/Module.h"

// What every library with resources does when it is loaded.
__attribute__((constructor)) static void joinChain() {
    static AFX_EXTENSION_MODULE module;
    AfxInitExtensionModule(module, tvx::moduleFromAddress(&module));
    new CDynLinkLibrary(module);
}
