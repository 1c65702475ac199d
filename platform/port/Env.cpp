#include "platform/port/Env.h"

#include <cstdlib>

const char* Port_Env::GetEnv(const char* name) {
    return name ? std::getenv(name) : nullptr;
}

std::vector<std::string> Port_Env::GetRoots() {
    std::vector<std::string> roots;
    for (const char* variable : {"MYTARVEX", "TARVEX"}) {
        const char* root = GetEnv(variable);
        if (root && *root)
            roots.emplace_back(root);
    }
    return roots;
}
