#include "s/Version.h"

#include "afx.h"
#include "platform/port/Env.h"
#include "platform/port/File.h"
#include "platform/port/MsgManData.h"
#include "platform/port/Str.h"
#include "platform/port/Time.h"
#include "platform/port/Version.h"
#include "s/InstalledValue.h"
#include "s/MessageOrigin.h"

#include <algorithm>
#include <array>
#include <cstdint>
#include <ctime>
#include <iterator>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <unordered_map>
#include <utility>

namespace {

constexpr const char* fileName = "fileset.txt";
constexpr std::size_t pathSize = 516;
constexpr int lineLimit = 255;
constexpr std::int64_t unknownTime = -1;

Port_MsgManData origin(int line) {
    return LibraryOrigin("../s/Version", line, "$Revision: 1.7 $");
}

// --- one line ---

struct Entry {
    std::string value;
    std::int64_t time = unknownTime;
};

int monthOf(std::string_view name) {
    static constexpr const char* months[] = {"Jan", "Feb", "Mar", "Apr", "May", "Jun",
                                             "Jul", "Aug", "Sep", "Oct", "Nov", "Dec"};
    const auto* const month = std::find_if(std::begin(months), std::end(months),
                                           [&](const char* each) { return UT_STR::Compare(each, name) == 0; });
    return month == std::end(months) ? 0 : static_cast<int>(month - std::begin(months));
}

/// Seconds of a time as the date command writes it: "Mon Jan  5 10:20:30 GMT 2026".
std::int64_t timeOf(std::string text) {
    std::array<std::string, 5> fields;
    for (std::string& field : fields) {
        // A day of one digit is padded with a second blank.
        text.erase(0, text.find_first_not_of(' '));
        if (UT_STR::GetToken(text, field, " ") != ' ') {
            return unknownTime;
        }
    }
    const auto& [weekday, month, day, clock, zone] = fields;
    std::tm local{};
    if (UT_STR::SScanf(clock.c_str(), "%d %*c %d %*c %d", &local.tm_hour, &local.tm_min, &local.tm_sec) != 3) {
        return unknownTime;
    }
    local.tm_mday = UT_STR::AToI(day.c_str());
    local.tm_mon = monthOf(month);
    local.tm_year = std::max(UT_STR::AToI(text.c_str()), 0) - 1900;
    return UT_TIME::MkTime(local);
}

/// The key and the entry that a line gives, if it gives one.
std::optional<std::pair<std::string, Entry>> parse(std::string_view line) {
    static constexpr std::string_view mark = "::";
    const int end = UT_STR::FindString(line, mark);
    if (end < 0) {
        return std::nullopt;
    }
    const auto length = static_cast<std::size_t>(end);
    std::string rest(line.substr(length + mark.size()));
    std::string key;
    if (UT_STR::GetToken(rest, key, "=") != '=' || key.empty()) {
        return std::nullopt;
    }
    if (key == "summary") {
        rest += '\n';
    } else {
        UT_STR::Trim(rest);
    }
    return std::pair(std::move(key), Entry{std::move(rest), timeOf(std::string(line.substr(0, length)))});
}

// --- the file ---

/// The file, opened, and when it was last changed.
struct OpenedFile {
    std::unique_ptr<Port::Stream, Port::File::Closer> stream;
    std::optional<std::int64_t> changed;
};

/// The variable's value; an empty one is no value.
const char* rootIn(const char* variable) {
    const char* root = Port_Env::GetEnv(variable);
    return root && *root ? root : nullptr;
}

/// The file's path below a root. It holds until the next call; null, and an error, when the root is too long.
const char* pathBelow(const char* root, const char* variable) {
    static char path[pathSize];
    if (UT_STR::Copy(path, pathSize, root) && UT_STR::Cat(path, pathSize, "/") &&
        UT_STR::Cat(path, pathSize, fileName)) {
        return path;
    }
    origin(__LINE__).issueError("The value of environment variable %s is too long.\n", variable);
    return nullptr;
}

OpenedFile openFile(const char* path) {
    OpenedFile file;
    // Asked before the file is opened: one that is replaced in between is then read once more, and not missed.
    std::int64_t changed = unknownTime;
    if (Port::File::getdatetime(path, changed)) {
        file.changed = changed;
    }
    file.stream.reset(Port::File::open(path, Port::File::AccessRead, Port::File::FlagText));
    return file;
}

/// Opens the user's own file, else the installation's. No stream when that fails, which the user has been told then.
OpenedFile findFile() {
    const char* const ownRoot = rootIn("MYTARVEX");
    const char* path = ownRoot ? pathBelow(ownRoot, "MYTARVEX") : nullptr;
    OpenedFile file = path ? openFile(path) : OpenedFile();
    if (file.stream) {
        return file;
    }
    const char* const root = rootIn("TARVEX");
    if (!root) {
        origin(__LINE__).issueError("Unable to obtain the value of environment variable TARVEX.\n");
        return file;
    }
    path = pathBelow(root, "TARVEX");
    if (!path) {
        return file;
    }
    file = openFile(path);
    if (!file.stream) {
        origin(__LINE__).issueError("Unable to open $TARVEX/%s.\n", fileName);
    }
    return file;
}

// --- all values ---

class Values {
public:
    /// Reads the file if it was never read or is newer than when it was.
    void update(const OpenedFile& file) {
        const bool isNewer = file.changed && UT_TIME::DiffTime(*file.changed, m_changed) > 0;
        if (m_isLoaded && !isNewer) {
            return;
        }
        load(*file.stream);
        m_isLoaded = true;
        m_changed = file.changed.value_or(unknownTime);
    }

    [[nodiscard]] const char* find(const char* key) const {
        const auto found = m_entries.find(key);
        return found == m_entries.end() ? nullptr : found->second.value.c_str();
    }

private:
    void load(Port::Stream& stream) {
        Port_MsgManData::debugStub("Loading information from %s ...\n\n", fileName);
        m_entries.clear();
        char line[lineLimit + 1];
        for (;;) {
            const int length = stream.readline(line, lineLimit);
            // What stands behind the last line end is a line that has not been written whole.
            if (stream.geteof()) {
                return;
            }
            if (auto parsed = parse({line, static_cast<std::size_t>(length)})) {
                store(std::move(parsed->first), std::move(parsed->second));
            }
        }
    }

    /// The newest entry of a key wins, the later line among equals.
    void store(std::string key, Entry entry) {
        const auto [place, isNew] = m_entries.try_emplace(std::move(key), entry);
        if (!isNew && UT_TIME::DiffTime(entry.time, place->second.time) >= 0) {
            place->second = std::move(entry);
        }
    }

    std::unordered_map<std::string, Entry> m_entries;
    std::int64_t m_changed = unknownTime;
    bool m_isLoaded = false;
};

Values s_values;

bool hasFileBelow(const char* variable) {
    const char* const root = rootIn(variable);
    return root && Port::File::canread((std::string(root) + "/" + fileName).c_str());
}

} // namespace

Port::StringBase<char> InstalledValue(const char* key) {
    return hasFileBelow("MYTARVEX") || hasFileBelow("TARVEX") ? Port::Version::getValue(key) : Port::StringBase<char>();
}

const char* Gui_InstallInfo::GetValue(const char* key) {
    const char* value = nullptr;
    tvx::allocating([&] {
        const OpenedFile file = findFile();
        if (!file.stream) {
            return;
        }
        s_values.update(file);
        value = key ? s_values.find(key) : nullptr;
    });
    return value;
}
