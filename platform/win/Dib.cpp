#include "platform/win/detail/Dib.h"

#include "platform/win/detail/ByteReader.h"

#include <algorithm>
#include <bit>
#include <optional>

namespace tvx::detail {

namespace {

constexpr std::uint32_t opaque = 0xFF000000;
constexpr std::uint32_t coreHeaderSize = 12;
constexpr std::uint32_t infoHeaderSize = 40;
// Bitmaps larger than that are no resources of an application; it also keeps all products within 64 bits.
constexpr std::int64_t largestSide = 0x7FFF;

enum Compression : std::uint32_t { Uncompressed = 0, BitFields = 3 };

struct Header {
    std::uint32_t size = 0;
    std::int64_t width = 0;
    std::int64_t height = 0;
    bool isTopDown = false;
    unsigned bitsPerPixel = 0;
    std::uint32_t compression = Uncompressed;
    std::uint32_t colorsUsed = 0;
};

Header readHeader(ByteReader& reader) {
    Header header;
    header.size = reader.u32();
    const bool isCore = header.size == coreHeaderSize;
    header.width = isCore ? reader.u16() : reader.s32();
    header.height = isCore ? reader.u16() : reader.s32();
    reader.skip(2); // planes
    header.bitsPerPixel = reader.u16();
    if (!isCore) {
        header.compression = reader.u32();
        reader.skip(12); // image size, resolution
        header.colorsUsed = reader.u32();
        reader.skip(4); // important colours
    }
    header.isTopDown = header.height < 0;
    header.height = header.isTopDown ? -header.height : header.height;
    return header;
}

std::string headerFault(const Header& header) {
    if (header.size != coreHeaderSize && header.size < infoHeaderSize) {
        return "bitmap header of the unknown size " + std::to_string(header.size);
    }
    if (header.width < 1 || header.width > largestSide || header.height < 1 || header.height > largestSide) {
        return "bitmap of impossible size " + std::to_string(header.width) + " x " + std::to_string(header.height);
    }
    const unsigned bits = header.bitsPerPixel;
    if (bits != 1 && bits != 4 && bits != 8 && bits != 16 && bits != 24 && bits != 32) {
        return "bitmap with " + std::to_string(bits) + " bits a pixel";
    }
    const bool mayHaveMasks = bits == 16 || bits == 32;
    const bool hasMasks = header.compression == BitFields && mayHaveMasks;
    if (header.compression != Uncompressed && !hasMasks) {
        return "compressed bitmap (method " + std::to_string(header.compression) + ")";
    }
    if (header.colorsUsed > 256 && bits <= 8) {
        return "bitmap with a palette of " + std::to_string(header.colorsUsed) + " colours";
    }
    return {};
}

// One colour of pixels whose colours lie in bit fields.
class Channel {
public:
    explicit Channel(std::uint32_t mask) : m_mask(mask), m_shift(std::countr_zero(mask)) {}
    // Its value in 8 bits.
    [[nodiscard]] std::uint32_t of(std::uint32_t pixel) const {
        if (m_mask == 0) {
            return 0;
        }
        const std::uint64_t largest = m_mask >> m_shift;
        return static_cast<std::uint32_t>(((pixel & m_mask) >> m_shift) * std::uint64_t{255} / largest);
    }
    [[nodiscard]] bool exists() const {
        return m_mask != 0;
    }

private:
    std::uint32_t m_mask;
    int m_shift;
};

struct Channels {
    Channel red{0x00FF0000};
    Channel green{0x0000FF00};
    Channel blue{0x000000FF};
    Channel alpha{0xFF000000};
};

class DibDecoder {
public:
    DibDecoder(ResourceBytes data, DibUse use) : m_reader(data), m_use(use) {}

    ResourceResult<Picture> decode() {
        m_header = readHeader(m_reader);
        if (!m_reader.ok()) {
            return ResourceError{"bitmap ends within its header"};
        }
        if (m_use == DibUse::IconImage) {
            m_header.height /= 2;
        }
        if (std::string fault = headerFault(m_header); !fault.empty()) {
            return ResourceError{std::move(fault)};
        }
        readMasks();
        readPalette();
        if (!m_reader.ok()) {
            return ResourceError{"bitmap ends within its palette"};
        }
        const ResourceBytes rows = m_reader.bytes(rowSize(m_header.bitsPerPixel) * height());
        if (!m_reader.ok()) {
            return ResourceError{"bitmap ends before its last row"};
        }
        return finish(rows);
    }

private:
    [[nodiscard]] std::size_t width() const {
        return static_cast<std::size_t>(m_header.width);
    }
    [[nodiscard]] std::size_t height() const {
        return static_cast<std::size_t>(m_header.height);
    }
    // Rows are padded to whole numbers of 32 bits.
    [[nodiscard]] std::size_t rowSize(unsigned bitsPerPixel) const {
        return (width() * bitsPerPixel + 31) / 32 * 4;
    }

    void readMasks() {
        if (m_header.bitsPerPixel == 16) {
            m_channels = {Channel(0x7C00), Channel(0x03E0), Channel(0x001F), Channel(0)};
        }
        // Long headers hold the masks themselves, right where they would follow a short one.
        const bool hasMasks = m_header.compression == BitFields;
        std::size_t rest = m_header.size > infoHeaderSize ? m_header.size - infoHeaderSize : 0;
        if (hasMasks) {
            const Channel red(m_reader.u32());
            const Channel green(m_reader.u32());
            const Channel blue(m_reader.u32());
            const bool hasAlphaMask = rest >= 16;
            const Channel alpha(hasAlphaMask ? m_reader.u32() : 0);
            m_channels = {red, green, blue, alpha};
            const std::size_t masksSize = hasAlphaMask ? 16 : 12;
            rest = rest > masksSize ? rest - masksSize : 0;
        }
        m_reader.skip(rest);
    }

    void readPalette() {
        const bool isIndexed = m_header.bitsPerPixel <= 8;
        const std::size_t all = isIndexed ? std::size_t{1} << m_header.bitsPerPixel : 0;
        const std::size_t count = m_header.colorsUsed != 0 ? m_header.colorsUsed : all;
        const bool isCore = m_header.size == coreHeaderSize;
        if (!isIndexed) {
            m_reader.skip(count * 4);
            return;
        }
        m_palette.assign(256, opaque);
        for (std::size_t i = 0; i < count; ++i) {
            const std::uint32_t blue = m_reader.u8();
            const std::uint32_t green = m_reader.u8();
            const std::uint32_t red = m_reader.u8();
            m_palette[i] = opaque | red << 16 | green << 8 | blue;
            m_reader.skip(isCore ? 0 : 1);
        }
    }

    ResourceResult<Picture> finish(ResourceBytes rows) {
        Picture picture;
        picture.width = static_cast<int>(width());
        picture.height = static_cast<int>(height());
        picture.bitsPerPixel = static_cast<int>(m_header.bitsPerPixel);
        picture.pixels.resize(width() * height());
        for (std::size_t y = 0; y < height(); ++y) {
            decodeRow(rows.subspan(rowFromTop(y) * rowSize(m_header.bitsPerPixel)), &picture.pixels[y * width()]);
        }
        // An alpha channel that says nothing is visible is none.
        if (std::ranges::all_of(picture.pixels, [](std::uint32_t pixel) { return (pixel & opaque) == 0; })) {
            setOpaque(picture);
        }
        const bool hasOwnAlpha = m_header.bitsPerPixel == 32 && hasAlpha(picture);
        if (m_use == DibUse::IconImage && !hasOwnAlpha && !applyMask(picture)) {
            return ResourceError{"icon ends before the last row of its mask"};
        }
        picture.hasAlpha = hasAlpha(picture);
        return picture;
    }

    [[nodiscard]] std::size_t rowFromTop(std::size_t y) const {
        return m_header.isTopDown ? y : height() - 1 - y;
    }

    void decodeRow(ResourceBytes row, std::uint32_t* pixels) const {
        for (std::size_t x = 0; x < width(); ++x) {
            pixels[x] = pixelAt(row, x);
        }
    }

    [[nodiscard]] std::uint32_t pixelAt(ResourceBytes row, std::size_t x) const {
        const unsigned bits = m_header.bitsPerPixel;
        if (bits <= 8) {
            const std::size_t bit = x * bits;
            return m_palette[row[bit / 8] >> (8 - bits - bit % 8) & ((1u << bits) - 1)];
        }
        const std::size_t bytes = bits / 8;
        std::uint32_t value = 0;
        for (std::size_t i = bytes; i-- > 0;) {
            value = value << 8 | row[x * bytes + i];
        }
        if (bits == 24) {
            return opaque | value;
        }
        const std::uint32_t alpha = m_channels.alpha.exists() ? m_channels.alpha.of(value) : 255;
        return alpha << 24 | m_channels.red.of(value) << 16 | m_channels.green.of(value) << 8 |
               m_channels.blue.of(value);
    }

    static bool hasAlpha(const Picture& picture) {
        return std::ranges::any_of(picture.pixels, [](std::uint32_t pixel) { return (pixel & opaque) != opaque; });
    }

    static void setOpaque(Picture& picture) {
        for (std::uint32_t& pixel : picture.pixels) {
            pixel |= opaque;
        }
    }

    // A set bit of the mask lets the background through.
    bool applyMask(Picture& picture) {
        const ResourceBytes mask = m_reader.bytes(rowSize(1) * height());
        if (!m_reader.ok()) {
            return false;
        }
        for (std::size_t y = 0; y < height(); ++y) {
            for (std::size_t x = 0; x < width(); ++x) {
                if ((mask[rowFromTop(y) * rowSize(1) + x / 8] >> (7 - x % 8) & 1) != 0) {
                    picture.pixels[y * width() + x] = 0;
                }
            }
        }
        return true;
    }

    ByteReader m_reader;
    DibUse m_use;
    Header m_header;
    Channels m_channels;
    std::vector<std::uint32_t> m_palette;
};

} // namespace

ResourceResult<Picture> decodeDib(ResourceBytes data, DibUse use) {
    return DibDecoder(data, use).decode();
}

} // namespace tvx::detail
