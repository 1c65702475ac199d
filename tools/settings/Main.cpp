#include "tools/settings/Commands.h"

#include <iostream>
#include <string>
#include <vector>

int main(int argc, char** argv) {
    const settings::Outcome outcome = settings::run({argv + 1, argv + argc}, std::cin, std::cout, std::cerr);
    std::cout.flush();
    if (!std::cout && outcome == settings::Outcome::Done) {
        std::cerr << "tvxsettings: the output could not be written\n";
        return static_cast<int>(settings::Outcome::BadFile);
    }
    return static_cast<int>(outcome);
}
