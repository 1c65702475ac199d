#include "tools/rc/Compiler.h"

#include <exception>
#include <functional>
#include <iostream>
#include <map>

namespace {

constexpr const char* usage = R"(usage: tvx-rc [options] script.rc output.res
Compiles a resource script into resource data.
  -I FOLDER        looks for included files and pictures in FOLDER too
  -D NAME[=VALUE]  defines a macro
  --depfile FILE   writes a make rule that names every file that was read
  --cxx PROGRAM    C preprocessor to use (c++)
  --rc PROGRAM     resource compiler to use (llvm-rc)
)";

// Reads the command line; answers whether it was complete.
bool readOptions(const std::vector<std::string>& words, rc::Options& options) {
    const std::map<std::string, std::function<void(const std::string&)>> switches = {
        {"-I", [&](const std::string& value) { options.includes.emplace_back(value); }},
        {"-D", [&](const std::string& value) { options.definitions.push_back(value); }},
        {"--depfile", [&](const std::string& value) { options.dependencies = value; }},
        {"--cxx", [&](const std::string& value) { options.preprocessor = value; }},
        {"--rc", [&](const std::string& value) { options.compiler = value; }}};
    std::vector<std::string> files;
    for (std::size_t i = 0; i < words.size(); ++i) {
        const auto found = switches.find(words[i]);
        if (found == switches.end()) {
            files.push_back(words[i]);
        } else if (++i < words.size()) {
            found->second(words[i]);
        } else {
            return false;
        }
    }
    if (files.size() != 2) {
        return false;
    }
    options.script = files[0];
    options.output = files[1];
    return true;
}

void print(const rc::Fault& fault) {
    if (!fault.place.file.empty()) {
        std::cerr << fault.place.file << ":" << fault.place.line << ": error: ";
    }
    std::cerr << fault.message << "\n";
}

} // namespace

int main(int argc, char** argv) {
    rc::Options options;
    if (!readOptions({argv + 1, argv + argc}, options)) {
        std::cerr << usage;
        return 2;
    }
    try {
        rc::compile(options);
        return 0;
    } catch (const rc::Fault& fault) {
        print(fault);
    } catch (const std::exception& error) {
        std::cerr << "tvx-rc: " << error.what() << "\n";
    }
    return 1;
}
