#pragma once

#include "platform/port/StringBase.h"

/// @file
/// Not for hosts: where the family's servers are. An entry of the installation's file names them
/// (docs/installation.md); where there is none, the address holds that the library was built with. Nothing is said
/// about an installation without that file.

/// The location of the family's documents, to which the name of a document is appended: "docLocation", else
/// `TVX_DOC_LOCATION` of the build. It ends in "/".
Port::StringBase<char> DocumentationLocation();

/// The server that knows the family's other pages, such as "https://www.tarvex.example", to which a path is appended:
/// "redirectHost", else `TVX_REDIRECT_HOST` of the build.
Port::StringBase<char> RedirectHost();
