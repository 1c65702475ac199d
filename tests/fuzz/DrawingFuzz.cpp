// Reads arbitrary text as a drawing of the board; one that is accepted is the same after it was written and read again.
#include "samples/board/Drawing.h"

#include <cstdint>
#include <cstdlib>

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const auto first = board::readDrawing({reinterpret_cast<const char*>(data), size});
    if (!first.ok()) {
        return 0;
    }
    const auto second = board::readDrawing(board::writeDrawing(first.drawing));
    if (!second.ok() || second.drawing != first.drawing) {
        std::abort();
    }
    return 0;
}
