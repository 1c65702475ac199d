// Reads arbitrary text as help maps that include each other, and compares what they say with the same read in the
// plainest way: line by line, into maps of texts. Looks into the text as a page of HTML too.
#include "s/HelpMapText.h"

#include "tools/helpmapcheck/Page.h"

#include <cstdint>
#include <cstdlib>
#include <map>
#include <set>
#include <string>
#include <vector>

namespace {

void require(bool holds) {
    if (!holds) {
        std::abort();
    }
}

/// The files of an input: it is cut at form feeds, and the pieces are named "0.map", "1.map" and so on.
std::map<std::string, std::string> filesOf(const std::string& input) {
    std::map<std::string, std::string> files;
    std::size_t at = 0;
    for (int i = 0; at <= input.size(); ++i) {
        const std::size_t end = std::min(input.find('\f', at), input.size());
        files[std::to_string(i) + ".map"] = input.substr(at, end - at);
        at = end + 1;
    }
    return files;
}

class Source : public HelpMapSource {
public:
    explicit Source(const std::map<std::string, std::string>& files) : m_files(files) {}

    std::string findInclude(const std::string& name) override {
        return m_files.contains(name) ? name : std::string();
    }
    std::string normalized(const std::string& name) override {
        return name;
    }
    std::optional<std::string> read(const std::string& name) override {
        require(m_read.insert(name).second);
        return m_files.at(name);
    }
    void remark(HelpMapRemark, const HelpMapFile& file, std::string_view line, std::string_view) override {
        require(line.data() >= file.text.data() && line.end() <= file.text.data() + file.text.size());
    }

private:
    const std::map<std::string, std::string>& m_files;
    std::set<std::string> m_read;
};

struct Record {
    std::vector<std::string> files;
    std::vector<std::string> titles;
    std::string type;
};

std::string trim(std::string text) {
    text.erase(0, std::min(text.find_first_not_of(" \t"), text.size()));
    text.erase(text.find_last_not_of(" \t") + 1);
    return text;
}

std::vector<std::string> split(const std::string& text, const char* delimiters) {
    std::vector<std::string> words(1);
    for (const char c : text) {
        if (c != '\0' && std::string(delimiters).find(c) != std::string::npos) {
            words.emplace_back();
        } else {
            words.back() += c;
        }
    }
    return words;
}

std::vector<std::string> wordsOf(const std::string& text, const char* delimiters) {
    std::vector<std::string> words = split(text, delimiters);
    std::erase(words, "");
    return words;
}

/// The plain reading.
class Plain {
public:
    explicit Plain(const std::map<std::string, std::string>& files) : m_files(files) {
        read("0.map");
    }
    std::map<std::string, Record> records;

private:
    void read(const std::string& name) {
        m_read.insert(name);
        std::string text = m_files.at(name);
        if (text.starts_with("\xEF\xBB\xBF")) {
            text.erase(0, 3);
        }
        Record* record = nullptr;
        for (const std::string& each : split(text, "\r\n")) {
            takeLine(trim(each), record);
        }
    }
    void takeLine(const std::string& line, Record*& record) {
        if (line.starts_with('[')) {
            std::string key;
            for (const std::string& word : wordsOf(line, " \t[]")) {
                key += (key.empty() ? "" : " ") + word;
            }
            const auto [place, isNew] = records.try_emplace(key);
            record = isNew && !key.empty() ? &place->second : nullptr;
        } else if (line.starts_with('#')) {
            include(line);
        } else if (record) {
            takeEntry(line, *record);
        }
    }
    void include(const std::string& line) {
        const std::size_t space = line.find_first_of(" \t");
        std::string name = space == std::string::npos ? std::string() : trim(line.substr(space));
        name += name.find('.') == std::string::npos ? ".map" : "";
        if (m_files.contains(name) && !m_read.contains(name)) {
            read(name);
        }
    }
    static void takeEntry(const std::string& line, Record& record) {
        const std::size_t equals = line.find('=');
        if (equals == std::string::npos || equals == 0 || equals + 1 == line.size()) {
            return;
        }
        const std::string value = trim(line.substr(equals + 1));
        if (line.substr(0, equals).starts_with("type")) {
            const std::vector<std::string> words = wordsOf(line, " \t=");
            record.type = words.size() > 1 ? words[1] : std::string();
        } else if (line.substr(0, equals).starts_with("file")) {
            record.files.push_back(value);
        } else if (line.substr(0, equals).starts_with("title")) {
            record.titles.push_back(value);
        }
    }

    const std::map<std::string, std::string>& m_files;
    std::set<std::string> m_read;
};

std::vector<std::string> copied(const std::vector<std::string_view>& texts) {
    return {texts.begin(), texts.end()};
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const std::string input(reinterpret_cast<const char*>(data), size);
    const std::map<std::string, std::string> files = filesOf(input);
    Source source(files);
    HelpMapText map;
    require(map.add("0.map", source));
    const Plain plain(files);
    require(map.sections().size() == plain.records.size());
    for (const auto& [key, expected] : plain.records) {
        const auto found = map.find(key);
        require(found && map.sections()[*found].key == key);
        const Gui_HelpMapRecord record = ReadHelpMapRecord(map.sections()[*found]);
        require(copied(record.files) == expected.files && copied(record.titles) == expected.titles &&
                record.type == expected.type);
    }
    for (const std::string& anchor : helpmap::anchorsOf(input)) {
        require(anchor.empty() || input.find(anchor) != std::string::npos);
    }
    return 0;
}
