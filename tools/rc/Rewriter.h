#pragma once

#include "tools/rc/Script.h"

#include <filesystem>
#include <string>
#include <vector>

namespace rc {

/// Turns statements that the resource compiler refuses into ones it takes, with the same meaning:
/// tool bars, dialog data, extended menus and accelerators with modifiers of characters become numbered raw data, the
/// statements of resource editors are dropped, and files are named by the path that exists here.
class Rewriter {
public:
    /// @param folders where files named in the script are looked for, in this order
    explicit Rewriter(std::vector<std::filesystem::path> folders) : m_folders(std::move(folders)) {}

    /// The statement's text for the resource compiler, empty when it is dropped. Throws `Fault`.
    [[nodiscard]] std::string rewrite(const Script& script, const Statement& statement);

    /// Files that the statements so far named (pictures, data), for the build's dependencies.
    [[nodiscard]] const std::vector<std::filesystem::path>& files() const {
        return m_files;
    }

private:
    std::string rewriteFile(const Script& script, const Statement& statement);

    std::vector<std::filesystem::path> m_folders;
    std::vector<std::filesystem::path> m_files;
};

/// The file that `name` means under `folder`: backslashes separate folders, and where the exact spelling does not
/// exist, one that differs in case only is taken. Empty when there is none.
[[nodiscard]] std::filesystem::path findFile(const std::filesystem::path& folder, std::string name);

} // namespace rc
