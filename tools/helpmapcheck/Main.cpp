#include "tools/helpmapcheck/Command.h"

#include <iostream>
#include <string>
#include <vector>

int main(int argc, char** argv) {
    const helpmap::Outcome outcome = helpmap::run({argv + 1, argv + argc}, std::cout, std::cerr);
    std::cout.flush();
    if (!std::cout) {
        std::cerr << "helpmapcheck: the output could not be written\n";
        return static_cast<int>(helpmap::Outcome::Failed);
    }
    return static_cast<int>(outcome);
}
