#include "platform/port/Version.h"

namespace Port {

namespace {

Version::Reader s_reader = nullptr;

} // namespace

StringBase<char> Version::getValue(const char* key) {
    return {s_reader ? s_reader(key) : nullptr};
}

void Version::setReader(Reader reader) noexcept {
    s_reader = reader;
}

} // namespace Port
