#include "tests/unit/win/HangingFolder.h"

#include <dirent.h>
#include <dlfcn.h>

#include <condition_variable>
#include <mutex>
#include <string_view>

namespace {

struct Hanging {
    std::mutex mutex;
    std::condition_variable changed;
    std::string folder;
};

Hanging& hanging() {
    // Never destroyed: a thread may still wait when the program ends.
    static auto* state = new Hanging;
    return *state;
}

bool isHanging(std::string_view name) {
    while (name.size() > 1 && name.ends_with('/')) {
        name.remove_suffix(1);
    }
    return !hanging().folder.empty() && name == hanging().folder;
}

} // namespace

HangingFolder::HangingFolder(std::string folder) {
    const std::lock_guard lock(hanging().mutex);
    hanging().folder = std::move(folder);
}

HangingFolder::~HangingFolder() {
    answer();
}

void HangingFolder::answer() {
    const std::lock_guard lock(hanging().mutex);
    hanging().folder.clear();
    hanging().changed.notify_all();
}

/// The layer's calls end here, as this program comes before the system's library.
extern "C" __attribute__((visibility("default"))) DIR* opendir(const char* name) {
    {
        std::unique_lock lock(hanging().mutex);
        hanging().changed.wait(lock, [name] { return !isHanging(name); });
    }
    static const auto real = reinterpret_cast<DIR* (*)(const char*)>(dlsym(RTLD_NEXT, "opendir"));
    return real(name);
}
