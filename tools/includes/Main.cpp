#include "tools/includes/Forwarder.h"

#include <exception>
#include <functional>
#include <iostream>
#include <map>

namespace {

constexpr const char* usage = R"(usage: tvx-includes [options] source...
Makes files for included headers that are named in another case than the file's, or with backslashes.
  --output FOLDER  where to; the compiler is to search FOLDER/1/2/3/4
  --stamp FILE     rewritten at each run
  --depfile FILE   a make rule of the stamp that names every file that was read
  -I FOLDER        looks for headers in FOLDER too
  --system FOLDER  the same for the compiler's own headers
)";

/// Reads the command line; answers whether it was complete.
bool readOptions(const std::vector<std::string>& words, includes::Options& options) {
    const std::map<std::string, std::function<void(const std::string&)>> switches = {
        {"-I", [&](const std::string& value) { options.folders.emplace_back(value); }},
        {"--system", [&](const std::string& value) { options.systems.emplace_back(value); }},
        {"--output", [&](const std::string& value) { options.output = value; }},
        {"--stamp", [&](const std::string& value) { options.stamp = value; }},
        {"--depfile", [&](const std::string& value) { options.dependencies = value; }}};
    for (std::size_t i = 0; i < words.size(); ++i) {
        const auto found = switches.find(words[i]);
        if (found == switches.end()) {
            options.sources.emplace_back(words[i]);
        } else if (++i < words.size()) {
            found->second(words[i]);
        }
    }
    return !options.sources.empty() && !options.output.empty() && !options.stamp.empty();
}

} // namespace

int main(int argc, char** argv) {
    includes::Options options;
    if (!readOptions({argv + 1, argv + argc}, options)) {
        std::cerr << usage;
        return 2;
    }
    try {
        for (const std::string& warning : includes::forward(options)) {
            std::cerr << warning << "\n";
        }
        return 0;
    } catch (const std::exception& error) {
        std::cerr << "tvx-includes: " << error.what() << "\n";
        return 1;
    }
}
