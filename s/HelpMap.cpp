#include "s/HelpMap.h"

#include "platform/base/SystemPath.h"
#include "platform/base/Text.h"
#include "platform/port/Env.h"
#include "platform/port/File.h"
#include "platform/port/FileName.h"
#include "platform/port/TarvexPath.h"
#include "s/HelpMapText.h"
#include "s/HelpPreference.h"
#include "s/MessageOrigin.h"
#include "s/Record.h"
#include "s/WebHosts.h"

#include <initializer_list>
#include <optional>
#include <string>
#include <string_view>
#include <utility>

/// What a help map keeps for itself.
struct Gui_HelpMapData {
    HelpMapText text;
    std::string fileName;  ///< of the last map read, as it was given
    std::string directory; ///< of that file, with its last "/"
};

namespace {

using String = Port::StringBase<char>;

constexpr const char* blanks = " \t";
constexpr const char* notFound = "topic_not_found";
/// What is shown of a wrong line.
constexpr std::size_t longestShown = 2047;

Port_MsgManData origin(int line) {
    return LibraryOrigin("../s/HelpMap", line, "$Revision");
}

String dataFile(const String& relativeName) {
    return Port_Env::GetDataFileName(relativeName.c_str(), 1);
}

String mapFile(const char* format, const String& name) {
    String relativeName;
    relativeName.Format(format, name.c_str());
    return dataFile(relativeName);
}

/// The maps of the installation.
class InstalledMaps : public HelpMapSource {
public:
    std::string findInclude(const std::string& name) override {
        return mapFile("helpmap/%s", name).str();
    }
    std::string normalized(const std::string& name) override {
        return Port::FileName(name).Normalize(true).str();
    }
    std::optional<std::string> read(const std::string& name) override {
        if (!Port::File::canread(name.c_str())) {
            origin(__LINE__).issueError("Cannot read file %s . Please check the installation\n", name.c_str());
            return std::nullopt;
        }
        Port::Stream* const stream = Port::File::open(name.c_str(), Port::File::AccessRead, Port::File::FlagText);
        std::optional<std::string> text = stream ? std::optional(stream->readall()) : std::nullopt;
        Port::File::close(stream);
        return text;
    }
    void remark(HelpMapRemark remark, const HelpMapFile&, std::string_view line, std::string_view) override {
        if (remark == HelpMapRemark::IncludeWithoutSpace) {
            const std::string shown(line.substr(0, tvx::text::characterStart(line, longestShown)));
            origin(__LINE__).issueInternal("include statement %s does not have space\n", shown.c_str());
        }
    }
};

String firstWord(const String& text) {
    String::Range word;
    return text.NextTokenRange(word, blanks) ? text.Extract(word) : String();
}

/// The first of these keys that has a record.
Gui_HelpMap::Position firstOf(const Gui_HelpMap& map, std::initializer_list<std::pair<String, String>> keys) {
    for (const auto& [first, words] : keys) {
        if (const Gui_HelpMap::Position position = map.Find(first, words); position != Gui_HelpMap::End()) {
            return position;
        }
    }
    return Gui_HelpMap::End();
}

void clear(Gui_HelpMap::Strings& files, Gui_HelpMap::Strings& titles, String& type) {
    files.clear();
    titles.clear();
    type = String();
}

bool isType(const String& type, const char* name) {
    return type.Compare(name, String::Case::Ignored) == 0;
}

/// The name of a file that exists, as a program of this system finds it: the look-up passes over letter case.
String spelled(const String& path) {
    return path.str().starts_with('/') ? String(tvx::shownName(path.str())) : path;
}

/// The first file of a name below a root of the installation; empty when there is none.
String installed(const String& relativeName) {
    for (const String& root : Port::TarvexPath::GetInstance()) {
        String path;
        path.Format("%s/%s", root.c_str(), relativeName.c_str());
        if (Port::File::exist(path.c_str())) {
            return spelled(path);
        }
    }
    return {};
}

String installedDocument(const char* language, const String& name) {
    String relativeName;
    relativeName.Format("doc/%s/%s", language, name.c_str());
    return installed(relativeName);
}

} // namespace

Gui_HelpMap::Gui_HelpMap() : m_data(MakeRecord<Gui_HelpMapData>()) {}

Gui_HelpMap::~Gui_HelpMap() = default;

// Hosts know these operations with texts by value.
// NOLINTBEGIN(performance-unnecessary-value-param)

bool Gui_HelpMap::Read(String fileName) {
    InstalledMaps maps;
    if (!m_data->text.add(fileName.str(), maps)) {
        return false;
    }
    m_data->fileName = fileName.str();
    m_data->directory = m_data->fileName.substr(0, m_data->fileName.rfind('/') + 1);
    return true;
}

bool Gui_HelpMap::IsLoaded(String name) const {
    return m_data->fileName == name.str();
}

Gui_HelpMap::Position Gui_HelpMap::Find(String first, String words) const {
    const std::optional<std::size_t> found = m_data->text.find(HelpMapKey(first.str(), words.str()));
    return found ? Position{*found} : End();
}

void Gui_HelpMap::Resolve(Position position, Strings& files, Strings& titles, String& type) const {
    if (position == End()) {
        return;
    }
    const Gui_HelpMapRecord record = ReadHelpMapRecord(m_data->text.sections()[static_cast<std::size_t>(position)]);
    clear(files, titles, type);
    type = record.type;
    const bool isUrl = isType(type, "url");
    for (const std::string_view name : record.files) {
        files.push_back(isUrl ? String(name) : LocateDocument(name));
        if (files.back().IsEmpty()) {
            files.back() = GetWebUrl(name);
            type = "url";
        }
    }
    titles.assign(record.titles.begin(), record.titles.end());
}

void Gui_HelpMap::LookupKey(String key, Strings& files, Strings& titles, String& type) const {
    clear(files, titles, type);
    Resolve(firstOf(*this, {{"", key}, {firstWord(key), notFound}, {"", notFound}}), files, titles, type);
}

void Gui_HelpMap::LookupIndex(String keyword, Strings& files, Strings& titles, String& type) const {
    clear(files, titles, type);
    Resolve(firstOf(*this, {{"index", keyword}, {"", keyword}, {"index", notFound}, {"", notFound}}), files, titles,
            type);
}

Gui_HelpMap::String Gui_HelpMap::LookupContext(unsigned int contextId, String& type) const {
    String number = "contents";
    if (contextId != 0) {
        number.Format("%u", contextId);
    }
    Strings files;
    Strings titles;
    type = String();
    Resolve(firstOf(*this, {{"topic", number}, {"topic", notFound}, {"", notFound}}), files, titles, type);
    return files.empty() ? String() : files.front();
}

Gui_HelpMap::String Gui_HelpMap::GetContents(String& type) const {
    return LookupContext(0, type);
}

Gui_HelpMap::String Gui_HelpMap::LocateDocument(String name) const {
    if (Gui_HelpPreference().IsAlwaysGoToWeb()) {
        return {};
    }
    const int anchorStart = name.GetIndexOfLastChar("#");
    const String anchor = anchorStart < 0 ? String() : name.Extract(anchorStart);
    const String document = anchorStart < 0 ? name : name.Extract(0, name.GetIndexOfFirstChar("#"));
    String path = installedDocument(Port_Env::GetLang(), document);
    if (path.IsEmpty()) {
        path = installedDocument("usenglish", document);
    }
    if (path.IsEmpty() && Port::File::canread((m_data->directory + document.str()).c_str())) {
        path = spelled(m_data->directory + document.str());
    }
    return path.IsEmpty() ? path : path + anchor;
}

Gui_HelpMap::String Gui_HelpMap::GetWebUrl(String name) const {
    String prefix = Gui_HelpPreference().GetUrlPrefix();
    const Position position = Find("prefix helpurl", "");
    if (prefix.IsEmpty() && position != End()) {
        // As it stands: to locate it, as other documents are, would ask for the web location again.
        const Gui_HelpMapRecord record = ReadHelpMapRecord(m_data->text.sections()[static_cast<std::size_t>(position)]);
        prefix = record.files.empty() ? String() : String(record.files.front());
    }
    return (prefix.IsEmpty() ? DocumentationLocation() : prefix) + name;
}

String GetMapFileForPackage(String package) {
    return mapFile("helpmap/%s.map", package);
}

// NOLINTEND(performance-unnecessary-value-param)
