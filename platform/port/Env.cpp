#include "platform/port/Env.h"

#include "platform/win/Installation.h"

#include <cstdlib>

const char* Port_Env::GetEnv(const char* name) {
    return name ? std::getenv(name) : nullptr;
}

std::vector<std::string> Port_Env::GetRoots() {
    return tvx::installationRoots();
}
