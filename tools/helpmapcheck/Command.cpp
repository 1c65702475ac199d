#include "tools/helpmapcheck/Command.h"

#include "tools/helpmapcheck/MapCheck.h"

#include <optional>
#include <ostream>
#include <utility>

namespace helpmap {

namespace {

constexpr const char* usage = R"(Usage: helpmapcheck [--root DIR]... PACKAGE-or-MAPFILE...
Checks help maps, what they include, and the documents that they name.

  PACKAGE     the map share/helpmap/PACKAGE.map of the first root that has one
  MAPFILE     a file: a name that ends in ".map" or has folders
  --root DIR  a root of an installation; several are searched in this order.
              Without any: those of $MYTARVEX and $TARVEX
  --help, --version

Writes a line for each finding: FILE:LINE: KIND: TEXT. Kinds are anchor, cycle,
duplicate, empty, include, line, missing, prefix, title, unreachable and
untranslated; the manual page tells what they mean.
Exit code: 0 nothing found, 1 findings, 2 wrong usage or a map cannot be read.
)";

/// A command line that makes no sense.
struct Misuse {
    std::string message;
};

struct Request {
    std::vector<std::string> roots;
    std::vector<std::string> maps;
};

Request requestOf(const std::vector<std::string>& words) {
    Request request;
    bool areNames = false;
    for (auto word = words.begin(); word != words.end(); ++word) {
        if (areNames || !word->starts_with('-')) {
            request.maps.push_back(*word);
        } else if (*word == "--") {
            areNames = true;
        } else if (*word != "--root") {
            throw Misuse{"unknown option " + *word};
        } else if (++word == words.end()) {
            throw Misuse{"--root needs a folder behind it"};
        } else {
            request.roots.push_back(*word);
        }
    }
    if (request.maps.empty()) {
        throw Misuse{"name a package or a map file"};
    }
    return request;
}

/// The file that a word of the command line means; empty when a package has none.
std::string mapFileOf(const std::string& word, const Installation& installation) {
    const bool isFile = word.ends_with(".map") || word.find_first_of("/\\") != std::string::npos;
    return isFile ? word : installation.findMap(word + ".map");
}

Outcome check(const Request& request, std::ostream& out, std::ostream& errors) {
    const Installation installation = request.roots.empty() ? Installation::fromEnvironment() //
                                                            : Installation(request.roots);
    Outcome outcome = Outcome::Clean;
    for (const std::string& word : request.maps) {
        const std::string file = mapFileOf(word, installation);
        const auto findings = file.empty() ? std::nullopt : checkMap(file, installation);
        if (!findings) {
            errors << "helpmapcheck: " << word
                   << (file.empty() ? ": there is no map of this package\n" : ": it cannot be read\n");
            outcome = Outcome::Failed;
            continue;
        }
        for (const Finding& finding : *findings) {
            out << finding.file << ":" << finding.line << ": " << finding.kind << ": " << finding.text << "\n";
        }
        if (!findings->empty() && outcome == Outcome::Clean) {
            outcome = Outcome::Findings;
        }
    }
    return outcome;
}

} // namespace

Outcome run(const std::vector<std::string>& words, std::ostream& out, std::ostream& errors) {
    if (words == std::vector<std::string>{"--help"}) {
        out << usage;
        return Outcome::Clean;
    }
    if (words == std::vector<std::string>{"--version"}) {
        out << "helpmapcheck " TVX_VERSION "\n";
        return Outcome::Clean;
    }
    try {
        return check(requestOf(words), out, errors);
    } catch (const Misuse& misuse) {
        errors << "helpmapcheck: " << misuse.message << ". See helpmapcheck --help.\n";
        return Outcome::Failed;
    }
}

} // namespace helpmap
