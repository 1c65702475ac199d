#include "s/KeptKeys.h"

#include "s/KeyIndex.h"

#include <algorithm>
#include <charconv>
#include <optional>

namespace {

/// One line of the setting.
struct Change {
    bool given; ///< else taken away
    Gui_Accel accel;
};

/// Reads a number that fills the text up to `end`, and takes it off the text.
std::optional<unsigned long> takeNumber(std::string_view& text, int base, std::size_t end) {
    unsigned long number = 0;
    const char* const start = std::to_address(text.begin());
    const char* const stop = start + std::min(end, text.size());
    const auto [read, error] = std::from_chars(start, stop, number, base);
    if (error != std::errc() || read != stop) {
        return std::nullopt;
    }
    text.remove_prefix(static_cast<std::size_t>(read - start));
    return number;
}

constexpr unsigned long knownFlags = FVIRTKEY | FNOINVERT | FSHIFT | FCONTROL | FALT;
constexpr unsigned long knownBits = 0xFFFF0000UL | knownFlags;

std::optional<Change> parse(std::string_view line) {
    if (line.ends_with('\r')) {
        line.remove_suffix(1);
    }
    if (line.empty() || (line[0] != '+' && line[0] != '-')) {
        return std::nullopt;
    }
    Change change{line[0] == '+', Gui_Accel()};
    line.remove_prefix(1);
    const auto packed = takeNumber(line, 16, line.find(' '));
    if (!packed || (*packed & ~knownBits) != 0 || *packed <= knownFlags || line.empty()) {
        return std::nullopt;
    }
    line.remove_prefix(1);
    const auto command = takeNumber(line, 10, line.size());
    if (!command || *command == 0 || *command > 0xFFFF) {
        return std::nullopt;
    }
    change.accel.DecodeFlagsAndKey(*packed);
    change.accel.cmd = static_cast<WORD>(*command);
    return change;
}

void apply(const Change& change, Gui_AccelMap& map) {
    unsigned short owner = 0;
    map.GetCmdAt(change.accel, owner);
    if (change.given) {
        map.Add(change.accel);
    } else if (owner == change.accel.cmd) {
        map.Remove(change.accel); // a later version may have given the key to another command: that one keeps it
    }
}

/// Calls a function with each accelerator of one map whose key has another command in the other, or none.
template <typename Function>
void forEachMissing(const Gui_AccelMap& map, const Gui_AccelMap& other, Function function) {
    for (const Gui_Accel& accel : AccelsOf(map)) {
        unsigned short command = 0;
        other.GetCmdAt(accel, command);
        if (command != accel.cmd) {
            function(accel, command);
        }
    }
}

} // namespace

void ApplyKeptKeys(std::string_view text, Gui_AccelMap& map) {
    while (!text.empty()) {
        const std::string_view line = text.substr(0, text.find('\n'));
        text.remove_prefix(std::min(line.size() + 1, text.size()));
        if (const auto change = parse(line)) {
            apply(*change, map);
        }
    }
}

CString KeptKeysText(const Gui_AccelMap& map, const Gui_AccelMap& own) {
    CString text;
    forEachMissing(own, map, [&text](const Gui_Accel& accel, unsigned short now) {
        if (now == 0) {
            text.AppendFormat("-%08lX %u\n", accel.EncodeFlagsAndKey(), accel.cmd);
        }
    });
    forEachMissing(map, own, [&text](const Gui_Accel& accel, unsigned short) {
        text.AppendFormat("+%08lX %u\n", accel.EncodeFlagsAndKey(), accel.cmd);
    });
    return text;
}
