#include "s/Locale.h"

#include "s/FileName.h"

#include <cstdlib>

namespace {

bool isEnglish() {
    return PRIMARYLANGID(LANGIDFROMLCID(GetUserDefaultLCID())) == LANG_ENGLISH;
}

/// A library on a network drive keeps its drive: only its own name matters here.
class WithoutNetworkNames {
public:
    WithoutNetworkNames() : m_before(Gui_FileName::GetUncFlag()) {
        Gui_FileName::SetUncFlag(0);
    }
    ~WithoutNetworkNames() {
        Gui_FileName::SetUncFlag(m_before);
    }
    WithoutNetworkNames(const WithoutNetworkNames&) = delete;
    WithoutNetworkNames& operator=(const WithoutNetworkNames&) = delete;

private:
    int m_before;
};

void report(HINSTANCE library, const CString& name) {
    const DWORD error = GetLastError();
    CString text;
    text.Format("hDll=%x ErrCode=%x DllBaseName=%s",
                static_cast<unsigned int>(reinterpret_cast<std::uintptr_t>(library)), error, name.GetString());
    MessageBoxA(nullptr, text, "Gui_Locale Info", MB_OK);
}

HINSTANCE loadResourceLibrary(HINSTANCE instance, const char* baseName) {
    if (isEnglish()) {
        return nullptr;
    }
    const WithoutNetworkNames scope;
    Gui_FileName name;
    name = baseName ? baseName : tvx::plainModuleName(tvx::moduleFileName(instance)).c_str();
    if (!name.HasBase()) {
        return nullptr;
    }
    char language[4] = "";
    GetLocaleInfoA(LOCALE_USER_DEFAULT, LOCALE_SABBREVLANGNAME, language, sizeof language);
    name.SetExtension(language);
    const CString libraryName = name.GetBaseAndExtension();
    SetLastError(ERROR_SUCCESS);
    const HINSTANCE library = LoadLibraryA(libraryName);
    if (std::getenv("Gui_Locale")) {
        report(library, libraryName);
    }
    return library;
}

} // namespace

void Gui_Locale::SetAppResourceHandle(const char* baseName) {
    if (const HINSTANCE library = loadResourceLibrary(AfxGetInstanceHandle(), baseName)) {
        AfxSetResourceHandle(library);
    }
}

void Gui_Locale::SetDllResourceHandle(AFX_EXTENSION_MODULE& module, HINSTANCE instance, const char* baseName) {
    if (const HINSTANCE library = loadResourceLibrary(instance, baseName)) {
        module.hResource = library;
    }
}

int Gui_Locale::GetFixedWidthFont(CFont& font) {
    return font.Attach(CreateFontA(15, 0, 0, 0, 0, FALSE, FALSE, FALSE, DEFAULT_CHARSET, OUT_DEFAULT_PRECIS,
                                   CLIP_DEFAULT_PRECIS, PROOF_QUALITY, FIXED_PITCH | FF_MODERN,
                                   isEnglish() ? "Courier" : "FixedSys"));
}
