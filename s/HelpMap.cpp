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

#include <algorithm>
#include <initializer_list>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <utility>

using String = Port::StringBase<char>;
using Strings = Gui_HelpMap::Strings;
using Position = Gui_HelpMap::Position;

/// What a help map keeps for itself, and what it does; the map turns an exhausted heap into the framework's exception.
struct Gui_HelpMapData {
    /// A key as it is asked for: the first part and the words behind it.
    using Key = std::pair<const char*, String>;

    bool read(const std::string& name);
    [[nodiscard]] Position find(std::string_view first, std::string_view words) const;
    [[nodiscard]] Gui_HelpMapRecord recordAt(Position position) const;
    void resolve(Position position, Strings& files, Strings& titles, String& type) const;
    /// Resolves the first of these keys that has a record; without any the outputs are empty.
    void lookUp(std::initializer_list<Key> keys, Strings& files, Strings& titles, String& type) const;
    [[nodiscard]] String locate(const String& name) const;
    [[nodiscard]] String webUrl(const String& name) const;

    HelpMapText text;
    std::string fileName;  ///< of the last map read, as it was given
    std::string directory; ///< of that file, with its last "/"
};

namespace {

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
        const std::unique_ptr<Port::Stream, Port::File::Closer> stream(
            Port::File::open(name.c_str(), Port::File::AccessRead, Port::File::FlagText));
        return stream ? std::optional(stream->readall()) : std::nullopt;
    }
    void remark(HelpMapRemark remark, const HelpMapFile& file, std::string_view line, std::string_view) override {
        if (remark == HelpMapRemark::IncludeWithoutSpace && isNews(file, line)) {
            const std::string shown(line.substr(0, tvx::text::characterStart(line, longestShown)));
            origin(__LINE__).issueInternal("include statement %s does not have space\n", shown.c_str());
        }
    }

private:
    /// In a file that is no text any line may begin with "#". The user, who gets a box for each message, needs to know
    /// of one.
    bool isNews(const HelpMapFile& file, std::string_view line) {
        const auto isControl = [](unsigned char character) { return character < ' ' && character != '\t'; };
        return std::ranges::none_of(line, isControl) || std::exchange(m_damaged, &file) != &file;
    }

    const HelpMapFile* m_damaged = nullptr; ///< that such a line was last told of
};

String firstWord(const String& text) {
    String::Range word;
    return text.NextTokenRange(word, blanks) ? text.Extract(word) : String();
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

bool Gui_HelpMapData::read(const std::string& name) {
    InstalledMaps maps;
    if (!text.add(name, maps)) {
        return false;
    }
    directory = name.substr(0, name.rfind('/') + 1);
    fileName = name;
    return true;
}

Position Gui_HelpMapData::find(std::string_view first, std::string_view words) const {
    const std::optional<std::size_t> found = text.find(HelpMapKey(first, words));
    return found ? Position{*found} : Gui_HelpMap::End();
}

Gui_HelpMapRecord Gui_HelpMapData::recordAt(Position position) const {
    return ReadHelpMapRecord(text.sections()[static_cast<std::size_t>(position)]);
}

void Gui_HelpMapData::resolve(Position position, Strings& files, Strings& titles, String& type) const {
    const Gui_HelpMapRecord record = recordAt(position);
    type = record.type;
    const bool isUrl = isType(type, "url");
    files.clear();
    for (const std::string_view name : record.files) {
        files.push_back(isUrl ? String(name) : locate(name));
        if (files.back().IsEmpty()) {
            files.back() = webUrl(name);
            type = "url";
        }
    }
    titles.assign(record.titles.begin(), record.titles.end());
}

void Gui_HelpMapData::lookUp(std::initializer_list<Key> keys, Strings& files, Strings& titles, String& type) const {
    for (const auto& [first, words] : keys) {
        if (const Position position = find(first, words.str()); position != Gui_HelpMap::End()) {
            resolve(position, files, titles, type);
            return;
        }
    }
    files.clear();
    titles.clear();
    type = String();
}

String Gui_HelpMapData::locate(const String& name) const {
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
    if (path.IsEmpty() && Port::File::canread((directory + document.str()).c_str())) {
        path = spelled(directory + document.str());
    }
    return path.IsEmpty() ? path : path + anchor;
}

String Gui_HelpMapData::webUrl(const String& name) const {
    String prefix = Gui_HelpPreference().GetUrlPrefix();
    const Position position = find("prefix helpurl", "");
    if (prefix.IsEmpty() && position != Gui_HelpMap::End()) {
        // As it stands: to locate it, as other documents are, would ask for the web location again.
        const Gui_HelpMapRecord record = recordAt(position);
        prefix = record.files.empty() ? String() : String(record.files.front());
    }
    return (prefix.IsEmpty() ? DocumentationLocation() : prefix) + name;
}

Gui_HelpMap::Gui_HelpMap() : m_data(MakeRecord<Gui_HelpMapData>()) {}

Gui_HelpMap::~Gui_HelpMap() = default;

// Hosts know these operations with texts by value.
// NOLINTBEGIN(performance-unnecessary-value-param)

bool Gui_HelpMap::Read(String fileName) {
    return tvx::allocating([&] { return m_data->read(fileName.str()); });
}

bool Gui_HelpMap::IsLoaded(String name) const {
    return m_data->fileName == name.str();
}

Position Gui_HelpMap::Find(String first, String words) const {
    return tvx::allocating([&] { return m_data->find(first.str(), words.str()); });
}

void Gui_HelpMap::Resolve(Position position, Strings& files, Strings& titles, String& type) const {
    if (position != End()) {
        tvx::allocating([&] { m_data->resolve(position, files, titles, type); });
    }
}

void Gui_HelpMap::LookupKey(String key, Strings& files, Strings& titles, String& type) const {
    tvx::allocating([&] {
        m_data->lookUp({{"", key}, {"", firstWord(key) + " " + notFound}, {"", notFound}}, files, titles, type);
    });
}

void Gui_HelpMap::LookupIndex(String keyword, Strings& files, Strings& titles, String& type) const {
    tvx::allocating([&] {
        m_data->lookUp({{"index", keyword}, {"", keyword}, {"index", notFound}, {"", notFound}}, files, titles, type);
    });
}

String Gui_HelpMap::LookupContext(unsigned int contextId, String& type) const {
    return tvx::allocating([&] {
        String number = "contents";
        if (contextId != 0) {
            number.Format("%u", contextId);
        }
        Strings files;
        Strings titles;
        m_data->lookUp({{"topic", number}, {"topic", notFound}, {"", notFound}}, files, titles, type);
        return files.empty() ? String() : files.front();
    });
}

String Gui_HelpMap::GetContents(String& type) const {
    return LookupContext(0, type);
}

String Gui_HelpMap::LocateDocument(String name) const {
    return tvx::allocating([&] { return m_data->locate(name); });
}

String Gui_HelpMap::GetWebUrl(String name) const {
    return tvx::allocating([&] { return m_data->webUrl(name); });
}

String GetMapFileForPackage(String package) {
    return tvx::allocating([&] { return mapFile("helpmap/%s.map", package); });
}

// NOLINTEND(performance-unnecessary-value-param)
