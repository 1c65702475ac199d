// Reads arbitrary bytes as a bitmap file, and makes a bitmap of what was read.
#include "s/BitmapFile.h"

#include <cstdint>
#include <cstdlib>

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    CMemFile file;
    file.Write(data, static_cast<UINT>(size));
    file.SeekToBegin();
    BitmapFile read;
    const Gui_Bitmap::LoadError error = ReadBitmapFile(file, read);
    if (read.info.size() + read.bits.size() > size) {
        std::abort(); // more than the file holds
    }
    if (error != Gui_Bitmap::Loaded) {
        return 0;
    }
    const BITMAPINFO& info = read.header();
    const std::int64_t pixels = std::int64_t{info.bmiHeader.biWidth} * std::abs(std::int64_t{info.bmiHeader.biHeight});
    constexpr std::int64_t most = 1 << 20;
    if (!read.isComplete() || pixels > most) {
        return 0;
    }
    DeleteObject(CreateDIBitmap(nullptr, &info.bmiHeader, CBM_INIT, read.bits.data(), &info, DIB_RGB_COLORS));
    return 0;
}
