#pragma once

#include "tools/open/Document.h"

#include <string>
#include <string_view>
#include <vector>

namespace opening {

/// What a viewer's call is to hold for a PDF document and a place in it.
struct PaperCall {
    std::string document;            ///< in the document's place
    std::vector<std::string> before; ///< options right behind the program
    std::vector<std::string> behind; ///< arguments right behind the document
};

/// Whether a document is a PDF document.
[[nodiscard]] bool isPaper(const Document& document);

/// How a viewer is told the place. One that is not known gets the file without a place.
/// @param program  the viewer's name without folder, e.g. "evince"
[[nodiscard]] PaperCall paperCall(const Document& document, std::string_view program);

/// Whether the place within a PDF document can be told to a program of this name.
[[nodiscard]] bool isKnownViewer(std::string_view program);

} // namespace opening
