#include "tools/includes/Forwarder.h"

#include "tools/rc/Rewriter.h"

#include <algorithm>
#include <fstream>
#include <iterator>
#include <map>
#include <regex>
#include <set>
#include <stdexcept>

namespace includes {

namespace {

namespace fs = std::filesystem;

std::string textOf(const fs::path& path) {
    std::ifstream file(path, std::ios::binary);
    return {std::istreambuf_iterator<char>(file), {}};
}

void write(const fs::path& path, const std::string& text) {
    fs::create_directories(path.parent_path());
    std::ofstream file(path, std::ios::binary);
    if (!(file << text).flush()) {
        throw std::runtime_error(path.string() + " cannot be written");
    }
}

/// What an `#include` line names.
struct Name {
    std::string text;
    bool quoted = false;
    std::size_t line = 0;
};

std::vector<Name> namesIn(const fs::path& file) {
    static const std::regex pattern(R"re(^[ \t]*#[ \t]*include[ \t]*(["<])([^">]+)[">])re");
    std::vector<Name> names;
    std::ifstream stream(file);
    std::string line;
    for (std::size_t number = 1; std::getline(stream, line); ++number) {
        std::smatch match;
        if (line.find('#') != std::string::npos && std::regex_search(line, match, pattern)) {
            names.push_back({match[2], match[1] == "\"", number});
        }
    }
    return names;
}

class Finder {
public:
    explicit Finder(const Options& options) : m_options(options) {}

    void look(const fs::path& file) {
        if (!m_seen.insert(fs::weakly_canonical(file)).second) {
            return;
        }
        for (const Name& name : namesIn(file)) {
            follow(file, name);
        }
    }
    [[nodiscard]] const std::set<fs::path>& seen() const {
        return m_seen;
    }
    /// The real file of each name that needs help.
    [[nodiscard]] const std::map<std::string, fs::path>& forwards() const {
        return m_forwards;
    }
    std::vector<std::string> warnings;

private:
    void follow(const fs::path& file, const Name& name) {
        std::vector<fs::path> folders = m_options.folders;
        if (name.quoted) {
            folders.insert(folders.begin(), file.parent_path());
        }
        // As it is written, as the compiler will find it: folders of the compiler's own come last and are not entered.
        const auto isThere = [&](const fs::path& folder) { return fs::is_regular_file(folder / name.text); };
        if (const auto found = std::ranges::find_if(folders, isThere); found != folders.end()) {
            look(*found / name.text);
        } else if (std::ranges::none_of(m_options.systems, isThere)) {
            forward(file, name, folders);
        }
    }
    void forward(const fs::path& file, const Name& name, const std::vector<fs::path>& folders) {
        fs::path real;
        for (const auto* searched : {&folders, &m_options.systems}) {
            for (auto folder = searched->begin(); folder != searched->end() && real.empty(); ++folder) {
                real = rc::findFile(*folder, name.text);
            }
            if (!real.empty() && searched == &folders) {
                look(real);
            }
        }
        if (real.empty()) {
            return; // the compiler says so
        }
        real = fs::weakly_canonical(real);
        const auto [known, isNew] = m_forwards.emplace(name.text, real);
        if (!isNew && known->second != real) {
            warnings.push_back(file.string() + ":" + std::to_string(name.line) + ": warning: \"" + name.text +
                               "\" means " + known->second.string() + " elsewhere: write it as the file is spelled");
        }
    }

    const Options& m_options;
    std::set<fs::path> m_seen;
    std::map<std::string, fs::path> m_forwards;
};

void removeOthers(const fs::path& output, const std::set<fs::path>& wanted) {
    std::vector<fs::path> others;
    for (const auto& entry : fs::recursive_directory_iterator(output)) {
        if (entry.is_regular_file() && !wanted.contains(entry.path())) {
            others.push_back(entry.path());
        }
    }
    for (const fs::path& file : others) {
        fs::remove(file);
    }
}

void writeDependencies(const Options& options, const std::set<fs::path>& files) {
    std::string rule = options.stamp.string() + ":";
    for (const fs::path& file : files) {
        rule += " \\\n  " + std::regex_replace(file.string(), std::regex("[ #]"), "\\$&");
    }
    write(options.dependencies, rule + "\n");
}

} // namespace

fs::path searchFolder(const fs::path& output) {
    return output / "1" / "2" / "3" / "4";
}

std::vector<std::string> forward(const Options& options) {
    Finder finder(options);
    for (const fs::path& source : options.sources) {
        finder.look(source);
    }
    const fs::path base = searchFolder(options.output);
    fs::create_directories(base);
    std::set<fs::path> wanted;
    for (const auto& [name, real] : finder.forwards()) {
        const fs::path file = (base / name).lexically_normal();
        const std::string text = "#include \"" + real.string() + "\"\n";
        if (textOf(file) != text) {
            write(file, text);
        }
        wanted.insert(file);
    }
    removeOthers(options.output, wanted);
    if (!options.dependencies.empty()) {
        writeDependencies(options, finder.seen());
    }
    write(options.stamp, "");
    return finder.warnings;
}

} // namespace includes
