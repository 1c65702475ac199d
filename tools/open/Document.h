#pragma once

#include <string>
#include <string_view>

namespace opening {

/// A document as the caller named it, taken apart.
struct Document {
    std::string text;  ///< as it was named
    std::string file;  ///< absolute; empty for a web address
    std::string query; ///< what stands behind "?" in a file's address
    std::string place; ///< what stands behind "#"; decoded

    [[nodiscard]] bool isFile() const {
        return !file.empty();
    }
    /// The file's address, with the place in it and without.
    [[nodiscard]] std::string address() const;
    [[nodiscard]] std::string bareAddress() const;
};

/// Takes the name or the address of a document apart. A file that has such a name, "#" and all, is meant itself; what
/// is coded in an address may also be written as it is.
[[nodiscard]] Document readDocument(std::string_view text);

} // namespace opening
