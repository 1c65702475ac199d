#include "tools/helpmapcheck/MapCheck.h"

#include "platform/base/Text.h"
#include "platform/port/FileName.h"
#include "platform/win/FrameworkIds.h"
#include "s/HelpMapText.h"
#include "tools/helpmapcheck/Documents.h"

#include <algorithm>
#include <cstdlib>
#include <unordered_map>
#include <utility>

namespace helpmap {

namespace {

constexpr std::size_t longestShown = 80;

/// A text of the map as a finding shows it.
std::string shown(std::string_view text) {
    const std::string_view start = text.substr(0, tvx::text::characterStart(text, std::min(longestShown, text.size())));
    return "\"" + std::string(start) + (start.size() < text.size() ? "..." : "") + "\"";
}

/// What the reader says about a line.
struct Remark {
    HelpMapRemark kind;
    std::string about;
};

/// The installation's maps; keeps what is remarkable until the lines have numbers.
class Source : public HelpMapSource {
public:
    explicit Source(const Installation& installation) : m_installation(installation) {}

    std::string findInclude(const std::string& name) override {
        return m_installation.findMap(name);
    }
    std::string normalized(const std::string& name) override {
        return Port::FileName(name).Normalize(true).str();
    }
    std::optional<std::string> read(const std::string& name) override {
        return readFile(name);
    }
    void remark(HelpMapRemark kind, const HelpMapFile&, std::string_view line, std::string_view about) override {
        m_remarks.emplace(line.data(), Remark{kind, std::string(about)});
    }

    /// What was said about the line that stands where this one does, if anything was.
    [[nodiscard]] const Remark* remarkAt(std::string_view line) const {
        const auto found = m_remarks.find(line.begin());
        return found == m_remarks.end() ? nullptr : &found->second;
    }

private:
    const Installation& m_installation;
    std::unordered_map<const char*, Remark> m_remarks;
};

bool isNumber(std::string_view text) {
    return !text.empty() && text.find_first_not_of("0123456789") == std::string_view::npos;
}

bool isHexNumber(std::string_view text) {
    return (text.starts_with("0x") || text.starts_with("0X")) && text.size() > 2 &&
           text.find_first_not_of("0123456789abcdefABCDEF", 2) == std::string_view::npos;
}

/// The number that the framework asks for in the place of a command's, 0 where it asks for the command's.
unsigned long askedInstead(std::string_view number) {
    constexpr unsigned long commands = 0x10000;
    constexpr unsigned long systemFirst = 0xF000;
    const unsigned long command =
        isNumber(number) ? std::strtoul(std::string(number).c_str(), nullptr, 10) - commands : 0;
    if (command >= systemFirst && command < 0xF1F0) {
        return commands + AFX_IDS_SCFIRST + (command - systemFirst) / 16;
    }
    return command >= AFX_IDM_FIRST_MDICHILD && command <= 0xFFFF ? commands + AFX_IDS_MDICHILD : 0;
}

/// Why no help request asks for a key; empty when one may. An application can ask for any key by its text, so only keys
/// count that are written as another kind of request, and those that no text can be.
std::string whyUnreachable(std::string_view key) {
    constexpr std::string_view topic = "topic ";
    constexpr std::string_view highest = "4294967295";
    if (key.empty()) {
        return "a header without words";
    }
    if (key.find('\0') != std::string_view::npos) {
        return "a zero byte in the key";
    }
    const std::string_view number = key.starts_with(topic) ? key.substr(topic.size()) : std::string_view();
    if (isHexNumber(number)) {
        return shown(key) + ": context numbers are written in decimal digits";
    }
    if (number == "0") {
        return shown(key) + ": the context 0 is \"topic contents\"";
    }
    if (isNumber(number) && number.starts_with('0')) {
        return shown(key) + ": context numbers are written without zeros before them";
    }
    if (isNumber(number) && (number.size() > highest.size() || (number.size() == highest.size() && number > highest))) {
        return shown(key) + ": the highest context number is " + std::string(highest);
    }
    if (const unsigned long instead = askedInstead(number); instead != 0) {
        return shown(key) + ": menus of windows and their lists ask for " + std::to_string(instead);
    }
    return {};
}

/// Goes through the lines of all files that were read, in the order of files and lines.
class MapCheck {
public:
    MapCheck(const HelpMapText& map, const Source& source, Documents& documents)
        : m_map(map), m_source(source), m_documents(documents) {
        for (std::size_t i = 0; i < map.sections().size(); ++i) {
            m_sectionAt.emplace(map.sections()[i].body.data(), i);
        }
    }

    std::vector<Finding> run() {
        m_places.resize(m_map.sections().size());
        eachLine([this](const Line& line) {
            if (const std::optional<std::size_t> section = sectionBegunBy(line)) {
                m_places[*section] = line.file->name + ":" + std::to_string(line.number);
            }
        });
        eachLine([this](const Line& line) { check(line); });
        endSection();
        return std::move(m_findings);
    }

private:
    struct Line {
        const HelpMapFile* file = nullptr;
        std::size_t number = 0;
        std::string_view text;
        const char* next = nullptr; ///< where the line behind it begins
    };
    /// The section that the lines belong to.
    struct Record {
        Line header;
        std::string_view key;
        std::string_view type;
        std::vector<std::pair<Line, std::string_view>> files;
        std::vector<Line> titles;
        std::size_t firstFinding = 0;
    };

    template <typename Action>
    void eachLine(Action&& action) const {
        for (const HelpMapFile& file : m_map.files()) {
            Line line{&file, 0, {}, file.text.data()};
            HelpMapLines lines(file.text);
            while (lines.next(line.text)) {
                ++line.number;
                line.next = lines.rest();
                action(line);
            }
        }
    }

    [[nodiscard]] std::optional<std::size_t> sectionBegunBy(const Line& line) const {
        const auto found = line.text.starts_with('[') ? m_sectionAt.find(line.next) : m_sectionAt.end();
        return found == m_sectionAt.end() ? std::nullopt : std::optional(found->second);
    }

    void report(const Line& line, const char* kind, const std::string& text) {
        m_findings.push_back({line.file->name, line.number, kind, text});
    }

    void check(const Line& line) {
        if (line.number == 1) {
            endSection();
            m_isIgnored = false;
        }
        if (const Remark* remark = m_source.remarkAt(line.text); remark && !line.text.empty()) {
            reportRemark(line, *remark);
        }
        if (line.text.starts_with('[')) {
            endSection();
            beginSection(line);
        } else if (!line.text.empty() && !line.text.starts_with('#') && !line.text.starts_with(';') && !m_isIgnored) {
            checkEntry(line);
        }
    }

    void reportRemark(const Line& line, const Remark& remark) {
        switch (remark.kind) {
        case HelpMapRemark::DuplicateSection:
            report(line, "duplicate",
                   shown(remark.about) + " is ignored, the first is at " +
                       m_places[m_map.find(remark.about).value_or(0)]);
            break;
        case HelpMapRemark::IncludeWithoutSpace:
            report(line, "include", "no file is named");
            break;
        case HelpMapRemark::MissingInclude:
            report(line, "include", shown(remark.about) + " is not installed (a comment begins with \";\")");
            break;
        case HelpMapRemark::IncludedWhileRead:
            report(line, "cycle", remark.about + " is being read already");
            break;
        case HelpMapRemark::UnreadableFile:
            report(line, "include", remark.about + " cannot be read");
            break;
        }
    }

    void beginSection(const Line& header) {
        const std::optional<std::size_t> section = sectionBegunBy(header);
        m_isIgnored = !section;
        if (!section) {
            return;
        }
        const std::string_view key = m_map.sections()[*section].key;
        m_record = Record{header, key, {}, {}, {}, m_findings.size()};
        if (const std::string why = whyUnreachable(key); !why.empty()) {
            report(header, "unreachable", why);
        }
    }

    void checkEntry(const Line& line) {
        const HelpMapEntry entry = ReadHelpMapEntry(line.text);
        if (!m_record || entry.keyword == HelpMapKeyword::None) {
            report(line, "line", (m_record ? "it means nothing: " : "it belongs to no section: ") + shown(line.text));
            return;
        }
        switch (entry.keyword) {
        case HelpMapKeyword::Type:
            if (!m_record->type.empty()) {
                report(line, "line", "the type was " + shown(m_record->type) + " before");
            }
            m_record->type = entry.value;
            break;
        case HelpMapKeyword::File:
            m_record->files.emplace_back(line, entry.value);
            break;
        case HelpMapKeyword::Title:
        case HelpMapKeyword::None:
            m_record->titles.push_back(line);
            break;
        }
    }

    /// Looks at a record when all of its lines are known.
    void endSection() {
        if (!m_record) {
            return;
        }
        const Record record = *std::exchange(m_record, std::nullopt);
        const std::size_t files = record.files.size();
        if (files == 0 && !record.key.empty()) {
            report(record.header, "empty", shown(record.key) + " has no document");
        }
        for (std::size_t i = files; i < record.titles.size(); ++i) {
            report(record.titles[i], "title", "there is no document for this title");
        }
        // The only document of a record is opened without showing its title.
        for (std::size_t i = record.titles.size(); i < files && files > 1; ++i) {
            report(record.files[i].first, "title",
                   shown(record.files[i].second) + " has no title and cannot be chosen");
        }
        checkDocuments(record);
        std::stable_sort(m_findings.begin() + static_cast<std::ptrdiff_t>(record.firstFinding), m_findings.end(),
                         [](const Finding& left, const Finding& right) { return left.line < right.line; });
    }

    void checkDocuments(const Record& record) {
        if (record.key == "prefix helpurl") {
            checkPrefix(record);
        } else if (!tvx::text::equalNoCase(record.type, "url")) {
            for (const auto& [line, name] : record.files) {
                for (const Documents::Fault& fault : m_documents.faultsOf(std::string(name))) {
                    report(line, fault.kind, fault.text);
                }
            }
        }
    }

    void checkPrefix(const Record& record) {
        if (!tvx::text::equalNoCase(record.type, "url")) {
            report(record.header, "prefix", "the type of a web location is \"url\"");
        }
        if (!record.files.empty() && !record.files.front().second.ends_with('/')) {
            report(record.files.front().first, "prefix", "a web location ends in \"/\"");
        }
    }

    const HelpMapText& m_map;
    const Source& m_source;
    Documents& m_documents;
    std::unordered_map<const char*, std::size_t> m_sectionAt; ///< by where the lines of sections begin
    std::vector<std::string> m_places;                        ///< of the sections' headers
    std::vector<Finding> m_findings;
    std::optional<Record> m_record;
    bool m_isIgnored = false; ///< the lines belong to a section that does not count
};

} // namespace

std::optional<std::vector<Finding>> checkMap(const std::string& file, const Installation& installation) {
    HelpMapText map;
    Source source(installation);
    if (!map.add(file, source)) {
        return std::nullopt;
    }
    Documents documents(installation, file.substr(0, file.rfind('/') + 1));
    return MapCheck(map, source, documents).run();
}

} // namespace helpmap
