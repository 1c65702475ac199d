#pragma once

#include <cstddef>
#include <cstdint>
#include <deque>
#include <optional>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

/// @file
/// Not for hosts: the text of help maps (docs/help-maps.md), for the map that the library looks into and for the tool
/// that checks maps. Nothing here knows where files are; a HelpMapSource does.

/// What a record says. The texts are those of the map's file and live as long as it.
struct Gui_HelpMapRecord {
    std::vector<std::string_view> files;
    std::vector<std::string_view> titles;
    std::string_view type; ///< empty when the record has none
};

/// What a line of a section is, by its keyword.
enum class HelpMapKeyword { None, Type, File, Title };

/// A line of a section.
struct HelpMapEntry {
    HelpMapKeyword keyword = HelpMapKeyword::None;
    std::string_view value;
};

/// A section whose lines count.
struct HelpMapSection {
    std::string_view key;
    /// Its lines, from behind its header up to the next one. Includes among them are to be skipped.
    std::string_view body;
};

/// A file that has been read.
struct HelpMapFile {
    std::string name;
    std::string text;
};

/// What is remarkable about a line.
enum class HelpMapRemark {
    DuplicateSection,    ///< the section is ignored, its key was there before
    IncludeWithoutSpace, ///< "#" begins a line of one word
    MissingInclude,      ///< no such file is installed
    IncludedWhileRead,   ///< the file is the one that includes, or on the way to it
    UnreadableFile,      ///< it is there, but may not be read
};

/// Where help maps come from, and who is told what is remarkable in them.
class HelpMapSource {
public:
    virtual ~HelpMapSource() = default;

    /// The full name of an installed map by the name that an include gives it, empty when there is none.
    virtual std::string findInclude(const std::string& name) = 0;
    /// A form of a file's name that all its names share.
    virtual std::string normalized(const std::string& name) = 0;
    /// All that is in a file; nothing when it cannot be read.
    virtual std::optional<std::string> read(const std::string& name) = 0;
    /// Tells of a line.
    /// @param line  trimmed; its place in the file's text is where it was found
    /// @param about the key of a duplicate section, else the name of the other file
    virtual void remark(HelpMapRemark remark, const HelpMapFile& file, std::string_view line,
                        std::string_view about) = 0;
};

/// The lines of a text, one after the other, without blanks and tabs at their ends.
class HelpMapLines {
public:
    explicit HelpMapLines(std::string_view text) : m_rest(text) {}

    /// Takes the next line.
    /// @return false when there is none
    bool next(std::string_view& line);
    /// Where the line behind it begins.
    [[nodiscard]] const char* rest() const {
        return m_rest.data();
    }

private:
    std::string_view m_rest;
};

/// The key that is looked up for a first part and words: they are joined with single blanks, the first part is taken as
/// it is. No blanks or tabs are at its ends.
[[nodiscard]] std::string HelpMapKey(std::string_view first, std::string_view words);

/// Takes a trimmed line of a section apart. One that means nothing has no keyword.
[[nodiscard]] HelpMapEntry ReadHelpMapEntry(std::string_view line);

/// Takes the lines of a section together.
[[nodiscard]] Gui_HelpMapRecord ReadHelpMapRecord(const HelpMapSection& section);

/// All sections of some help maps and of what they include, in the order in which they were read. The first of a key is
/// the one that counts.
///
/// The files are kept as they were read, and an index tells where their sections begin: what a section says is read
/// when it is asked for. So much text as a large package has is read in the time that it takes to look at each line
/// once.
class HelpMapText {
public:
    HelpMapText() = default;
    HelpMapText(const HelpMapText&) = delete;
    HelpMapText& operator=(const HelpMapText&) = delete;

    /// Adds the sections of a file and of those that it includes, at any depth; each file is included once.
    /// @return whether the file could be read
    bool add(const std::string& name, HelpMapSource& source);

    /// The position of a key's section, or none.
    [[nodiscard]] std::optional<std::size_t> find(std::string_view key) const;

    [[nodiscard]] const std::vector<HelpMapSection>& sections() const {
        return m_sections;
    }
    [[nodiscard]] const std::deque<HelpMapFile>& files() const {
        return m_files;
    }

private:
    class Reader;
    struct Slot {
        std::uint32_t hash = 0;
        std::uint32_t number = 0; ///< of a section, from 1; 0 marks a slot that is free
    };

    bool begin(std::string_view key);
    std::string_view keyOf(std::string_view header);
    [[nodiscard]] std::size_t slotOf(std::string_view key, std::uint32_t hash) const;
    void grow();

    std::deque<HelpMapFile> m_files;
    std::deque<std::string> m_keys; ///< those that their headers do not spell as they are
    std::vector<HelpMapSection> m_sections;
    std::vector<Slot> m_slots;                    ///< a hash table of the sections by their keys
    std::unordered_map<std::string, bool> m_read; ///< by the normalised names of the files: whether one is being read
};
