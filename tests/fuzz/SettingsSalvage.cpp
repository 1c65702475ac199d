// Reads any bytes as a damaged file of settings and its log, and checks what holds for all that is saved of them.
#include "platform/win/detail/RegistrySalvage.h"

#include <cstdint>
#include <cstdlib>

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const std::string_view bytes(reinterpret_cast<const char*>(data), size);
    // The last byte tells where the log begins.
    const std::size_t end = bytes.empty() ? 0 : size - size * static_cast<std::uint8_t>(bytes.back()) / 255;
    const tvx::registry::Salvage found = tvx::registry::salvage(bytes.substr(0, end), bytes.substr(end));
    for (const auto& [id, key] : found.keys) {
        if (key.spelled.empty() != (id == 1) || key.spelled.size() > size) {
            std::abort();
        }
    }
    for (const auto& [id, value] : found.values) {
        if (value.name.size() + value.data.size() > size) {
            std::abort();
        }
    }
    return 0;
}
