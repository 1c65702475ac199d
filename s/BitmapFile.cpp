#include "s/BitmapFile.h"

#include <algorithm>
#include <cstdint>
#include <cstring>
#include <new>

namespace {

constexpr UINT fileHeaderSize = 14;
constexpr UINT infoHeaderSize = sizeof(BITMAPINFOHEADER);
constexpr std::uint16_t bitmapType = 0x4D42; // "BM"

template <typename Number>
Number readNumber(const BYTE* bytes) {
    Number number = 0;
    for (std::size_t i = sizeof(Number); i-- > 0;) {
        number = static_cast<Number>(number << 8 | bytes[i]);
    }
    return number;
}

/// Bytes of pixels that the file header announces; 0 or less when it is no bitmap's.
std::int64_t announcedPixels(CFile& file) {
    BYTE header[fileHeaderSize] = {};
    if (file.Read(header, fileHeaderSize) != fileHeaderSize || readNumber<std::uint16_t>(header) != bitmapType) {
        return 0;
    }
    constexpr int sizeField = 2;
    constexpr int offsetField = 10;
    return std::int64_t{readNumber<std::uint32_t>(header + sizeField)} -
           std::int64_t{readNumber<std::uint32_t>(header + offsetField)};
}

Gui_Bitmap::LoadError readHeader(CFile& file, BITMAPINFOHEADER& header) {
    const UINT length = file.Read(&header, infoHeaderSize);
    if (length < sizeof(header.biSize) || header.biSize != infoHeaderSize) {
        return Gui_Bitmap::NotSupported;
    }
    return length == infoHeaderSize ? Gui_Bitmap::Loaded : Gui_Bitmap::TooShort;
}

std::int64_t bytesLeft(const CFile& file) {
    return static_cast<std::int64_t>(file.GetLength()) - static_cast<std::int64_t>(file.GetPosition());
}

/// Appends exactly `count` bytes; false when the file has fewer, which is known before any memory is taken.
bool append(CFile& file, std::int64_t count, std::vector<BYTE>& bytes) {
    if (count > bytesLeft(file)) {
        return false;
    }
    const std::size_t start = bytes.size();
    bytes.resize(start + static_cast<std::size_t>(count));
    for (std::size_t at = start; at < bytes.size();) {
        constexpr std::size_t most = 1 << 30;
        const UINT length = file.Read(&bytes[at], static_cast<UINT>(std::min(bytes.size() - at, most)));
        if (length == 0) {
            return false; // somebody cuts the file meanwhile
        }
        at += length;
    }
    return true;
}

/// The colour table has an entry for each value of a pixel, whatever the header says of used colours. Deep formats have
/// none, but are taken to have one: no file holds it.
std::int64_t paletteBytes(const BITMAPINFOHEADER& header) {
    constexpr int deepest = 32;
    return std::int64_t{sizeof(RGBQUAD)} << std::min<int>(header.biBitCount, deepest);
}

Gui_Bitmap::LoadError readParts(CFile& file, BitmapFile& read) {
    const std::int64_t pixels = announcedPixels(file);
    if (pixels <= 0) {
        return Gui_Bitmap::NotSupported;
    }
    BITMAPINFOHEADER header{};
    if (const Gui_Bitmap::LoadError error = readHeader(file, header); error != Gui_Bitmap::Loaded) {
        return error;
    }
    header.biClrUsed = 0; // all of the table
    const auto* bytes = reinterpret_cast<const BYTE*>(&header);
    read.info.assign(bytes, bytes + infoHeaderSize);
    const bool whole = append(file, paletteBytes(header), read.info) && append(file, pixels, read.bits);
    return whole ? Gui_Bitmap::Loaded : Gui_Bitmap::TooShort;
}

} // namespace

bool BitmapFile::isComplete() const {
    const BITMAPINFOHEADER& info = header().bmiHeader;
    const std::int64_t row = (std::int64_t{info.biWidth} * info.biBitCount + 31) / 32 * 4;
    const std::int64_t rows = info.biHeight < 0 ? -std::int64_t{info.biHeight} : std::int64_t{info.biHeight};
    return row <= 0 || rows == 0 || rows <= static_cast<std::int64_t>(bits.size()) / row;
}

Gui_Bitmap::LoadError ReadBitmapFile(CFile& file, BitmapFile& read) {
    try {
        return readParts(file, read);
    } catch (const std::bad_alloc&) {
        return Gui_Bitmap::OutOfMemory;
    } catch (CFileException* error) {
        error->Delete();
        return Gui_Bitmap::TooShort;
    }
}
