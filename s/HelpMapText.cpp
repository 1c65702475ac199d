#include "s/HelpMapText.h"

#include <algorithm>
#include <cstring>
#include <functional>
#include <utility>

namespace {

constexpr std::string_view blanks = " \t";
constexpr std::string_view headerMarks = " \t[]";
constexpr std::string_view byteOrderMark = "\xEF\xBB\xBF";
constexpr std::size_t firstSlots = 64;

std::string_view trimmed(std::string_view text) {
    text.remove_prefix(std::min(text.find_first_not_of(blanks), text.size()));
    return text.substr(0, text.find_last_not_of(blanks) + 1);
}

/// Takes the next word off the front; empty when there is none.
std::string_view takeWord(std::string_view& text, std::string_view delimiters) {
    text.remove_prefix(std::min(text.find_first_not_of(delimiters), text.size()));
    const std::string_view word = text.substr(0, text.find_first_of(delimiters));
    text.remove_prefix(word.size());
    return word;
}

std::string_view secondWord(std::string_view line) {
    constexpr std::string_view delimiters = " \t=";
    takeWord(line, delimiters);
    return takeWord(line, delimiters);
}

std::string_view between(const char* begin, const char* end) {
    return {begin, static_cast<std::size_t>(end - begin)};
}

const char* lineEnd(const char* at, const char* end) {
    const auto* const found = static_cast<const char*>(std::memchr(at, '\n', static_cast<std::size_t>(end - at)));
    return found ? found : end;
}

/// Gives a text one kind of line ends without moving anything: a blank before a line feed is trimmed with its line, and
/// the numbers of lines stay.
void unifyLineEnds(std::string& text) {
    for (std::size_t at = text.find('\r'); at != std::string::npos; at = text.find('\r', at + 1)) {
        text[at] = at + 1 < text.size() && text[at + 1] == '\n' ? ' ' : '\n';
    }
}

/// Whether words are joined with single blanks and nothing else.
bool isJoined(std::string_view words) {
    char before = 0;
    for (const char c : words) {
        if (c == '\t' || c == '[' || c == ']' || (c == ' ' && before == ' ')) {
            return false;
        }
        before = c;
    }
    return true;
}

std::uint32_t hashOf(std::string_view key) {
    const std::size_t hash = std::hash<std::string_view>()(key);
    return static_cast<std::uint32_t>(hash ^ (hash >> 32));
}

const char* endOf(const HelpMapFile& file) {
    return file.text.data() + file.text.size();
}

} // namespace

bool HelpMapLines::next(std::string_view& line) {
    if (m_rest.empty()) {
        return false;
    }
    const std::size_t length = std::min(m_rest.find('\n'), m_rest.size());
    line = trimmed(m_rest.substr(0, length));
    m_rest.remove_prefix(std::min(length + 1, m_rest.size()));
    return true;
}

std::string HelpMapKey(std::string_view first, std::string_view words) {
    std::string key(first.substr(std::min(first.find_first_not_of(blanks), first.size())));
    for (std::string_view word = takeWord(words, blanks); !word.empty(); word = takeWord(words, blanks)) {
        // Blanks that end the first part stand before the words, if there are any.
        key.append(key.empty() ? "" : " ").append(word);
    }
    key.erase(key.find_last_not_of(blanks) + 1);
    return key;
}

HelpMapEntry ReadHelpMapEntry(std::string_view line) {
    const std::size_t equals = line.find('=');
    if (equals == std::string_view::npos || equals == 0 || equals == line.size() - 1) {
        return {};
    }
    if (line.starts_with("type")) {
        return {HelpMapKeyword::Type, secondWord(line)};
    }
    const std::string_view value = trimmed(line.substr(equals + 1));
    if (line.starts_with("file")) {
        return {HelpMapKeyword::File, value};
    }
    return {line.starts_with("title") ? HelpMapKeyword::Title : HelpMapKeyword::None, value};
}

Gui_HelpMapRecord ReadHelpMapRecord(const HelpMapSection& section) {
    Gui_HelpMapRecord record;
    HelpMapLines lines(section.body);
    for (std::string_view line; lines.next(line);) {
        const HelpMapEntry entry = line.starts_with('#') ? HelpMapEntry() : ReadHelpMapEntry(line);
        switch (entry.keyword) {
        case HelpMapKeyword::Type:
            record.type = entry.value;
            break;
        case HelpMapKeyword::File:
            record.files.push_back(entry.value);
            break;
        case HelpMapKeyword::Title:
            record.titles.push_back(entry.value);
            break;
        case HelpMapKeyword::None:
            break;
        }
    }
    return record;
}

// --- files ---

/// Reads one file with all that it includes. Files that include each other in a long chain must not need a deep stack:
/// the chain is kept in a vector.
class HelpMapText::Reader {
public:
    Reader(HelpMapText& map, HelpMapSource& source) : m_map(map), m_source(source) {}

    bool read(const std::string& name) {
        if (!open(name)) {
            return false;
        }
        while (!m_chain.empty()) {
            if (readOn(m_chain.back()) == Stop::AtEnd) {
                *m_chain.back().isBeingRead = false;
                m_chain.pop_back();
            }
        }
        return true;
    }

private:
    /// A file that is being read: up to where, and the section that its lines belong to.
    struct Reading {
        const HelpMapFile* file;
        bool* isBeingRead; ///< in the map's list of files
        const char* at;
        std::optional<std::size_t> section;
        const char* bodyStart = nullptr;
    };
    enum class Stop { AtEnd, AtInclude };

    bool open(const std::string& name);
    Stop readOn(Reading& reading);
    void beginSection(Reading& reading, std::string_view header);
    void endSection(Reading& reading, const char* bodyEnd);
    bool include(const HelpMapFile& file, std::string_view line);
    bool includeFound(const HelpMapFile& file, std::string_view line, const std::string& found);

    HelpMapText& m_map;
    HelpMapSource& m_source;
    std::vector<Reading> m_chain; ///< each included by the one before
};

bool HelpMapText::Reader::open(const std::string& name) {
    std::optional<std::string> text = m_source.read(name);
    if (!text) {
        return false;
    }
    unifyLineEnds(*text);
    if (text->starts_with(byteOrderMark)) {
        text->erase(0, byteOrderMark.size());
    }
    const HelpMapFile& file = m_map.m_files.emplace_back(HelpMapFile{name, *std::move(text)});
    bool& isBeingRead = m_map.m_read[m_source.normalized(name)];
    m_chain.push_back({&file, &isBeingRead, file.text.data(), std::nullopt});
    isBeingRead = true;
    return true;
}

/// Reads a file up to its end or to a file that it includes, which is the last of the chain then.
HelpMapText::Reader::Stop HelpMapText::Reader::readOn(Reading& reading) {
    const char* const end = endOf(*reading.file);
    while (reading.at < end) {
        const char* start = reading.at;
        const char* const stop = lineEnd(start, end);
        reading.at = std::min(stop + 1, end);
        while (start < stop && (*start == ' ' || *start == '\t')) {
            ++start;
        }
        if (start < stop && *start == '[') {
            endSection(reading, start);
            beginSection(reading, between(start, stop));
        } else if (start < stop && *start == '#' && include(*reading.file, trimmed(between(start, stop)))) {
            return Stop::AtInclude;
        }
    }
    endSection(reading, end);
    return Stop::AtEnd;
}

/// Begins a section, unless there is one of its key. The lines of one whose key is empty count for nothing.
void HelpMapText::Reader::beginSection(Reading& reading, std::string_view header) {
    const std::string_view key = m_map.keyOf(header);
    if (!m_map.begin(key)) {
        m_source.remark(HelpMapRemark::DuplicateSection, *reading.file, trimmed(header), key);
        return;
    }
    m_map.m_sections.back().body = between(reading.at, reading.at);
    if (!key.empty()) {
        reading.section = m_map.m_sections.size() - 1;
        reading.bodyStart = reading.at;
    }
}

/// Ends the section that is being read, if there is one.
void HelpMapText::Reader::endSection(Reading& reading, const char* bodyEnd) {
    if (reading.section) {
        m_map.m_sections[*reading.section].body = between(reading.bodyStart, bodyEnd);
        reading.section.reset();
    }
}

/// @return whether a file has been opened
bool HelpMapText::Reader::include(const HelpMapFile& file, std::string_view line) {
    const std::size_t space = line.find_first_of(blanks);
    if (space == std::string_view::npos) {
        m_source.remark(HelpMapRemark::IncludeWithoutSpace, file, line, {});
        return false;
    }
    std::string name(trimmed(line.substr(space)));
    if (name.find('.') == std::string::npos) {
        name += ".map";
    }
    const std::string found = m_source.findInclude(name);
    if (found.empty()) {
        m_source.remark(HelpMapRemark::MissingInclude, file, line, name);
        return false;
    }
    return includeFound(file, line, found);
}

bool HelpMapText::Reader::includeFound(const HelpMapFile& file, std::string_view line, const std::string& found) {
    const auto before = m_map.m_read.find(m_source.normalized(found));
    if (before == m_map.m_read.end()) {
        const bool isOpen = open(found);
        if (!isOpen) {
            m_source.remark(HelpMapRemark::UnreadableFile, file, line, found);
        }
        return isOpen;
    }
    if (before->second) {
        m_source.remark(HelpMapRemark::IncludedWhileRead, file, line, found);
    }
    return false;
}

bool HelpMapText::add(const std::string& name, HelpMapSource& source) {
    return Reader(*this, source).read(name);
}

// --- sections ---

std::optional<std::size_t> HelpMapText::find(std::string_view key) const {
    if (m_slots.empty()) {
        return std::nullopt;
    }
    const std::uint32_t number = m_slots[slotOf(key, hashOf(key))].number;
    return number == 0 ? std::nullopt : std::optional<std::size_t>(number - 1);
}

/// Enters a section.
/// @return false when there is one of that key
bool HelpMapText::begin(std::string_view key) {
    if ((m_sections.size() + 1) * 2 > m_slots.size()) {
        grow();
    }
    const std::uint32_t hash = hashOf(key);
    Slot& slot = m_slots[slotOf(key, hash)];
    if (slot.number != 0) {
        return false;
    }
    m_sections.push_back({key, {}});
    slot = {hash, static_cast<std::uint32_t>(m_sections.size())};
    return true;
}

/// The words of a header, joined with single blanks. Most headers spell their key so, and it is not copied.
std::string_view HelpMapText::keyOf(std::string_view header) {
    header.remove_prefix(std::min(header.find_first_not_of(headerMarks), header.size()));
    header = header.substr(0, header.find_last_not_of(headerMarks) + 1);
    if (isJoined(header)) {
        return header;
    }
    std::string key;
    for (std::string_view word = takeWord(header, headerMarks); !word.empty(); word = takeWord(header, headerMarks)) {
        key.append(key.empty() ? "" : " ").append(word);
    }
    return m_keys.emplace_back(std::move(key));
}

/// The slot of a key's section, or the free one where it belongs.
std::size_t HelpMapText::slotOf(std::string_view key, std::uint32_t hash) const {
    const std::size_t mask = m_slots.size() - 1;
    std::size_t at = hash & mask;
    while (m_slots[at].number != 0 && (m_slots[at].hash != hash || m_sections[m_slots[at].number - 1].key != key)) {
        at = (at + 1) & mask;
    }
    return at;
}

void HelpMapText::grow() {
    std::vector<Slot> slots(std::max(firstSlots, m_slots.size() * 2));
    const std::size_t mask = slots.size() - 1;
    for (const Slot& slot : m_slots) {
        std::size_t at = slot.hash & mask;
        while (slots[at].number != 0) {
            at = (at + 1) & mask;
        }
        if (slot.number != 0) {
            slots[at] = slot;
        }
    }
    m_slots = std::move(slots);
}
