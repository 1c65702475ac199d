#include "platform/win/Installation.h"

#include <cstdlib>

namespace tvx {

std::vector<std::string> installationRoots() {
    std::vector<std::string> roots;
    for (const char* variable : {"MYTARVEX", "TARVEX"}) {
        if (const char* root = std::getenv(variable); root && *root != '\0') {
            roots.emplace_back(root);
        }
    }
    return roots;
}

} // namespace tvx
