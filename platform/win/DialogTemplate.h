#pragma once

#include "platform/base/Export.h"
#include "platform/base/Types.h"
#include "platform/win/Module.h"
#include "platform/win/ResourceError.h"

#include <optional>
#include <string>
#include <variant>
#include <vector>

namespace tvx {

/// A name that is either a number of 16 bits or a text: window classes, captions, menus of a dialog.
using ResourceName = std::variant<WORD, std::string>;

/// The text of a name, empty when it is a number.
[[nodiscard]] TVX_PLATFORM_API std::string textOf(const ResourceName& name);

/// A rectangle in dialog units: a quarter of the average character's width, an eighth of its height.
struct DialogRect {
    int x = 0;      ///< of the left edge
    int y = 0;      ///< of the top edge
    int width = 0;  ///< may be negative in careless templates
    int height = 0; ///< of a combo box: with its list dropped
};

/// The font of a dialog that has DS_SETFONT.
struct DialogFont {
    int pointSize = 8;   ///< in points of 1/72 inch
    int weight = 400;    ///< 400 is normal, 700 bold
    bool italic = false; ///< weight, italic and character set come from DIALOGEX only
    BYTE charSet = 1;
    std::string faceName; ///< "MS Shell Dlg" and its like stand for the user-interface font
};

/// One control of a dialog template.
struct DialogItemTemplate {
    DWORD style = 0;         ///< WS_ styles and those of the control's class
    DWORD extendedStyle = 0; ///< WS_EX_ styles
    DWORD helpId = 0;        ///< help context, DIALOGEX only
    DialogRect rect;         ///< from the dialog's client corner
    DWORD id = 0;            ///< 0xFFFF for IDC_STATIC in both kinds of template
    /// Window class, in the spelling of the script. The six numbered classes are given by name:
    /// "Button", "Edit", "Static", "ListBox", "ScrollBar", "ComboBox".
    std::string className;
    ResourceName title; ///< a number names the picture of an SS_ICON or SS_BITMAP control
};

/// A dialog as its resource describes it.
struct DialogTemplate {
    bool extended = false;                 ///< DIALOGEX
    DWORD style = 0;                       ///< WS_ and DS_ styles
    DWORD extendedStyle = 0;               ///< WS_EX_ styles
    DWORD helpId = 0;                      ///< help context, DIALOGEX only
    DialogRect rect;                       ///< width and height are those of the client area
    ResourceName menu;                     ///< number 0 when there is none
    ResourceName className;                ///< number 0 for an ordinary dialog
    std::string title;                     ///< caption
    std::optional<DialogFont> font;        ///< none: the system's font
    std::vector<DialogItemTemplate> items; ///< in tab order
};

/// Reads the data of an RT_DIALOG resource of either kind. Creation data of controls is skipped.
[[nodiscard]] TVX_PLATFORM_API ResourceResult<DialogTemplate> parseDialogTemplate(ResourceBytes data);

/// One message of a dialog's first contents (type 240).
struct DialogDataEntry {
    /// What is done with the text. Messages of other controls are handed on with their number.
    enum class Kind { AddToListBox, AddToComboBox, Other };
    WORD controlId = 0;      ///< whom the text is for
    Kind kind = Kind::Other; ///< what to do with it
    WORD message = 0;        ///< as the resource has it, for `Kind::Other`
    std::string text;        ///< UTF-8, converted from the western code page if it was written in it
};

/// Reads the data of an RT_DLGINIT resource.
[[nodiscard]] TVX_PLATFORM_API ResourceResult<std::vector<DialogDataEntry>> parseDialogData(ResourceBytes data);

} // namespace tvx
