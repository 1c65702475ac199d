#include "tools/includes/Forwarder.h"

#include <exception>
#include <iostream>

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
bool readOptions(int count, char** words, includes::Options& options) {
    for (int i = 1; i < count; ++i) {
        const std::string word = words[i];
        if (!word.starts_with("-")) {
            options.sources.emplace_back(word);
            continue;
        }
        if (++i == count) {
            return false;
        }
        if (word == "-I") {
            options.folders.emplace_back(words[i]);
        } else if (word == "--system") {
            options.systems.emplace_back(words[i]);
        } else if (word == "--output") {
            options.output = words[i];
        } else if (word == "--stamp") {
            options.stamp = words[i];
        } else if (word == "--depfile") {
            options.dependencies = words[i];
        } else {
            return false;
        }
    }
    return !options.sources.empty() && !options.output.empty() && !options.stamp.empty();
}

} // namespace

int main(int argc, char** argv) {
    includes::Options options;
    if (!readOptions(argc, argv, options)) {
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
    }
    return 1;
}
