#pragma once

#include "afx.h"
#include "platform/port/StringBase.h"
#include "s/Export.h"

#include <cstddef>
#include <memory>
#include <vector>

struct Gui_HelpMapData;

/// A help map: which documents answer a help topic, a keyword or any other key (docs/help-maps.md).
///
/// The help dispatcher holds one by value and reads its package's map once. Who wants documents of its own accord makes
/// one too:
///
/// @code
/// Gui_HelpMap map;
/// const Port::StringBase<char> name = GetMapFileForPackage("board");
/// Port::StringBase<char> type;
/// if (!map.IsLoaded(name) && map.Read(name))
///     open(map.LookupContext(1001, type), type);
/// @endcode
///
/// Documents come out as they can be opened: the full name of an installed file, or a web address where it is not
/// installed. Types are those of the map; "url" also where documents of another type had to be replaced by web
/// addresses. Everything runs on the user-interface thread.
class GUI_API Gui_HelpMap {
public:
    using String = Port::StringBase<char>;
    using Strings = std::vector<Port::StringBase<char>>;
    /// A place among the records.
    enum class Position : std::size_t {};

    /// An empty map.
    Gui_HelpMap();
    ~Gui_HelpMap();
    Gui_HelpMap(const Gui_HelpMap&) = delete;
    Gui_HelpMap& operator=(const Gui_HelpMap&) = delete;

    /// Adds the records of a map file and of those that it includes. Of records with one key the first that was read
    /// counts, also over several files. Wrong lines are skipped.
    /// @return false when the file cannot be read, which the user is told; the map is as before then
    bool Read(String fileName);
    /// Whether that was the last file read, by the very name given to Read.
    bool IsLoaded(String name) const;

    /// Looks a record up by exactly one key: @p first and the words of @p words, joined with single blanks.
    /// @return End() when there is none
    Position Find(String first, String words) const;
    /// The place behind all records.
    static constexpr Position End() {
        return Position{static_cast<std::size_t>(-1)};
    }
    /// What a record says, with its documents located. At End() the outputs stay as they are.
    /// @param files   an entry for each document of the record, in its order
    /// @param titles  the titles as they stand in the record; there may be more or fewer than files
    void Resolve(Position position, Strings& files, Strings& titles, String& type) const;

    /// The record of @p key, else that of its first word with "topic_not_found", else "topic_not_found". The outputs
    /// are empty when there is none of them.
    void LookupKey(String key, Strings& files, Strings& titles, String& type) const;
    /// The record of "index" with @p keyword, else of the keyword alone, else "index topic_not_found", else
    /// "topic_not_found".
    void LookupIndex(String keyword, Strings& files, Strings& titles, String& type) const;
    /// The first document of "topic" with a number, else of "topic topic_not_found", else of "topic_not_found".
    /// @param contextId  0: the contents page, which is "topic contents"
    /// @return empty when there is no such record, or it has no document
    String LookupContext(unsigned int contextId, String& type) const;
    /// The contents page.
    String GetContents(String& type) const;

    /// The full name of the installed file of a document: in the user's language, else in American English, else
    /// beside the map file. A place in the document ("a.htm#start") is kept.
    /// @return empty when it is not installed, and always when the user wants help from the web
    String LocateDocument(String name) const;
    /// The web address of a document: the user's location of documents, else the map's, else the family's.
    String GetWebUrl(String name) const;

private:
    std::unique_ptr<Gui_HelpMapData> m_data;
};

/// The full name of the map file of a help package: the installed data file "helpmap/<package>.map".
/// @return empty when there is none
GUI_API Port::StringBase<char> GetMapFileForPackage(Port::StringBase<char> package);
