#include "platform/win/ProcessMark.h"

#include <fstream>
#include <iterator>
#include <sstream>

namespace tvx {

namespace {

// In the order of /proc/<id>/stat, behind the program's name: state is field 3, the start in clock ticks field 22.
constexpr int fieldsBeforeStart = 22 - 3;

std::string startTicks(DWORD processId) {
    std::ifstream file("/proc/" + std::to_string(processId) + "/stat");
    const std::string stat{std::istreambuf_iterator<char>(file), {}};
    // The name is in parentheses and may hold any character, closing parentheses too.
    const auto nameEnd = stat.rfind(')');
    if (nameEnd == std::string::npos) {
        return {};
    }
    std::istringstream fields(stat.substr(nameEnd + 1));
    std::string field;
    for (int skipped = 0; skipped < fieldsBeforeStart; ++skipped) {
        fields >> field;
    }
    field.clear();
    fields >> field;
    return field;
}

std::string bootId() {
    std::ifstream file("/proc/sys/kernel/random/boot_id");
    std::string id;
    file >> id;
    return id;
}

} // namespace

std::string processMark(DWORD processId) {
    const std::string ticks = startTicks(processId);
    const std::string boot = bootId();
    if (ticks.empty() || boot.empty()) {
        return {};
    }
    return std::to_string(processId) + " " + boot + " " + ticks;
}

bool isOtherProcess(DWORD processId, const std::string& mark) {
    if (!mark.starts_with(std::to_string(processId) + " ")) {
        return false;
    }
    const std::string present = processMark(processId);
    return !present.empty() && present != mark;
}

} // namespace tvx
