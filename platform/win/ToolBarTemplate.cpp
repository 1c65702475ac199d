#include "platform/win/ToolBarTemplate.h"

#include "platform/win/detail/ByteReader.h"

namespace tvx {

ResourceResult<ToolBarTemplate> parseToolBarTemplate(ResourceBytes data) {
    detail::ByteReader reader(data);
    const unsigned version = reader.u16();
    ToolBarTemplate bar;
    bar.buttonWidth = reader.u16();
    bar.buttonHeight = reader.u16();
    const unsigned count = reader.u16();
    if (!reader.ok()) {
        return ResourceError{"tool bar ends within its head"};
    }
    if (version != 1) {
        return ResourceError{"tool bar of the unknown version " + std::to_string(version)};
    }
    if (bar.buttonWidth == 0 || bar.buttonHeight == 0) {
        return ResourceError{"tool bar whose buttons have no size"};
    }
    if (reader.remaining() < std::size_t{count} * 2) {
        return ResourceError{"tool bar ends before the last of its " + std::to_string(count) + " buttons"};
    }
    for (unsigned i = 0; i < count; ++i) {
        bar.commands.push_back(reader.u16());
    }
    return bar;
}

} // namespace tvx
