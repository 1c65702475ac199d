// Reads any bytes as compiled resources, and what they hold by its type.
#include "platform/win/AcceleratorTemplate.h"
#include "platform/win/DialogTemplate.h"
#include "platform/win/MenuTemplate.h"
#include "platform/win/Picture.h"
#include "platform/win/Resource.h"
#include "platform/win/ToolBarTemplate.h"
#include "platform/win/detail/ResourceIndex.h"

#include <cstdlib>
#include <map>
#include <string>

namespace {

using namespace tvx;

// A refusal has a reason, a success has none.
template <auto Parse>
void check(ResourceBytes bytes) {
    const auto outcome = Parse(bytes);
    if (outcome.reason().empty() != static_cast<bool>(outcome)) {
        std::abort();
    }
}

const std::map<std::string, void (*)(ResourceBytes)> parsers = {
    {"#2", check<parseBitmap>},
    {"#3", check<parseIconImage>},
    {"#4", check<parseMenuTemplate>},
    {"#5", check<parseDialogTemplate>},
    {"#9", check<parseAcceleratorTemplate>},
    {"#240", check<parseDialogData>},
    {"#241", check<parseToolBarTemplate>},
};

// What goes through a module: strings, and pictures that a list of icons points to.
void readFromModule(ResourceBytes data) {
    registerResources(data.data(), data.data(), data.size());
    const detail::ResourceIndex index(data);
    for (const detail::ResourceEntry& entry : index.entries()) {
        if (entry.type == "#14") {
            static_cast<void>(loadIconPicture(nullptr, entry.name.c_str(), 16));
        }
        if (entry.type == "#12") {
            static_cast<void>(loadCursorPicture(nullptr, entry.name.c_str()));
        }
    }
    for (UINT id = 0; id < 512; ++id) {
        static_cast<void>(resourceString(nullptr, id));
    }
    unregisterResources(data.data());
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* bytes, std::size_t size) {
    const ResourceBytes data(bytes, size);
    const detail::ResourceIndex index(data);
    for (const detail::ResourceEntry& entry : index.entries()) {
        if (const auto parser = parsers.find(entry.type); parser != parsers.end()) {
            parser->second(entry.data);
        }
    }
    if (index.damage().empty()) {
        readFromModule(data);
    }
    return 0;
}
