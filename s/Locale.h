#pragma once

#include "afxwin.h"
#include "s/Export.h"

/// The texts of applications and of the library in the user's language, and the font of their text windows.
///
/// Programs carry their texts in English. Other languages come in resource libraries, files that are named after the
/// program and the language: "board.DEU" for the German texts of "board". A host asks for its own early in its start:
///
/// @code
/// BOOL BoardApp::InitInstance() {
///     Gui_Locale::SetAppResourceHandle();
///     ...
/// @endcode
///
/// The user's language comes from the environment (`LC_ALL`, `LC_MESSAGES`, `LANG`); English users need no resource
/// library, and none is looked for. What a resource library lacks comes from the program. docs/languages.md tells how
/// resource libraries are made and where they are found.
///
/// When the environment variable `Gui_Locale` is set, a message box reports each attempt to load one: the handle (0
/// when it failed), the error number, and the name that was looked for.
class GUI_API Gui_Locale {
public:
    Gui_Locale() = delete;

    /// Loads the application's resource library, which is searched first from then on. Nothing changes when there is
    /// none.
    /// @param baseName the name to derive the resource library's from, with or without extension and folder; null takes
    ///     the name of the program's file
    static void SetAppResourceHandle(const char* baseName = nullptr);

    /// Loads the resource library of a shared library, and makes it that library's resource module. Nothing changes
    /// when there is none. Call it before the library joins the search with a `CDynLinkLibrary`.
    /// @param module   the library's record, filled by `AfxInitExtensionModule`
    /// @param instance the library
    /// @param baseName as above; null takes the name of the library's file, "GuiUtilities" for libGuiUtilities.so.1
    static void SetDllResourceHandle(AFX_EXTENSION_MODULE& module, HINSTANCE instance, const char* baseName = nullptr);

    /// Makes the family's font for text windows, whose characters are all of one width, 15 pixels high.
    /// @param font an object without a font; it owns the new one
    /// @return non-zero when @p font has it
    static int GetFixedWidthFont(CFont& font);
};
