#include "platform/win/RegistryNotice.h"

#include "platform/win/detail/RegistryNotices.h"

#include <atomic>
#include <cstdio>

namespace tvx {

namespace {

void tellOnStandardError(const std::string& text) {
    std::fprintf(stderr, "%s\n", text.c_str());
}

std::atomic<RegistryNotice> theNotice{&tellOnStandardError};

} // namespace

void setRegistryNotice(RegistryNotice notice) noexcept {
    theNotice = notice ? notice : &tellOnStandardError;
}

namespace registry {

void deliver(const std::vector<std::string>& notices) {
    for (const std::string& text : notices) {
        theNotice.load()(text);
    }
}

} // namespace registry

} // namespace tvx
