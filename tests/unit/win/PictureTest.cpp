#include "platform/win/Picture.h"

#include "platform/win/Resource.h"
#include "tests/data/resources/resource.h"
#include "tests/unit/win/Damage.h"

#include <cstring>

using namespace tvx;

namespace {

constexpr std::uint32_t white = 0xFFFFFFFF;
constexpr std::uint32_t black = 0xFF000000;

// Data of a bitmap resource, put together in a test.
struct BitmapData {
    std::vector<std::uint8_t> bytes;

    explicit BitmapData(std::int32_t width, std::int32_t height, std::uint16_t bits, std::uint32_t compression = 0) {
        number(40, 4);
        number(static_cast<std::uint32_t>(width), 4);
        number(static_cast<std::uint32_t>(height), 4);
        number(1, 2);
        number(bits, 2);
        number(compression, 4);
        bytes.resize(40);
    }
    BitmapData& number(std::uint32_t value, int size) {
        for (int i = 0; i < size; ++i) {
            bytes.push_back(static_cast<std::uint8_t>(value >> 8 * i));
        }
        return *this;
    }
};

} // namespace

TEST(Picture, IndexedBitmapStandsBottomUp) {
    const auto picture = loadBitmapPicture(nullptr, MAKEINTRESOURCE(IDB_STRIPES));
    ASSERT_TRUE(picture) << picture.reason();
    ASSERT_EQ(picture->width, 3);
    ASSERT_EQ(picture->height, 2);
    EXPECT_EQ(picture->bitsPerPixel, 4);
    EXPECT_EQ(picture->pixels,
              (std::vector<std::uint32_t>{0xFFFF0000, 0xFF00FF00, 0xFF0000FF, white, black, 0xFFFF0000}));
    EXPECT_FALSE(picture->hasAlpha);
}

TEST(Picture, TrueColourRowsArePadded) {
    const auto picture = loadBitmapPicture(nullptr, "grid");
    ASSERT_TRUE(picture) << picture.reason();
    EXPECT_EQ(picture->pixels, (std::vector<std::uint32_t>{0xFF090807, 0xFF0C0B0A, 0xFF030201, 0xFF060504}));
}

TEST(Picture, EveryDepthIsDecoded) {
    BitmapData mono(10, -1, 1);
    mono.number(0x00000000, 4).number(0x00FFFFFF, 4).number(0x40A0, 4);
    const auto one = parseBitmap(mono.bytes);
    ASSERT_TRUE(one) << one.reason();
    EXPECT_EQ(one->pixels,
              (std::vector<std::uint32_t>{white, black, white, black, black, black, black, black, black, white}));

    BitmapData fiveBits(2, 1, 16);
    const auto sixteen = parseBitmap(fiveBits.number(0x7FFF, 2).number(0x7C00, 2).bytes);
    ASSERT_TRUE(sixteen) << sixteen.reason();
    EXPECT_EQ(sixteen->pixels, (std::vector<std::uint32_t>{white, 0xFFFF0000}));

    BitmapData masked(1, 1, 32, 3);
    const auto swapped =
        parseBitmap(masked.number(0x0000FF, 4).number(0x00FF00, 4).number(0xFF0000, 4).number(0x030201, 4).bytes);
    ASSERT_TRUE(swapped) << swapped.reason();
    EXPECT_EQ(swapped->pixels[0], 0xFF010203);

    const auto alpha = parseBitmap(BitmapData(2, 1, 32).number(0x80112233, 4).number(0, 4).bytes);
    ASSERT_TRUE(alpha) << alpha.reason();
    EXPECT_TRUE(alpha->hasAlpha);
    const auto unused = parseBitmap(BitmapData(2, 1, 32).number(0x00112233, 4).number(0, 4).bytes);
    ASSERT_TRUE(unused) << unused.reason();
    EXPECT_EQ(unused->pixels, (std::vector<std::uint32_t>{0xFF112233, black}));
}

TEST(Picture, ImpossibleBitmapsAreRefused) {
    EXPECT_EQ(parseBitmap(BitmapData(0, 5, 24).bytes).reason(), "bitmap of impossible size 0 x 5");
    EXPECT_EQ(parseBitmap(BitmapData(5, INT32_MIN, 24).bytes).reason(), "bitmap of impossible size 5 x 2147483648");
    EXPECT_EQ(parseBitmap(BitmapData(0x7FFF, 0x7FFF, 32).bytes).reason(), "bitmap ends before its last row");
    EXPECT_EQ(parseBitmap(BitmapData(5, 5, 7).bytes).reason(), "bitmap with 7 bits a pixel");
    EXPECT_EQ(parseBitmap(BitmapData(5, 5, 8, 1).bytes).reason(), "compressed bitmap (method 1)");
}

TEST(Picture, DamagedBitmapsAreRefused) {
    for (const LPCSTR name : {MAKEINTRESOURCE(IDB_STRIPES), LPCSTR("GRID")}) {
        const ResourceBytes data = resourceBytes(nullptr, name, RT_BITMAP);
        expectTruncationsRefused(data, data.size(), parseBitmap);
        parseWithFlippedBits(data.first(60), parseBitmap);
    }
}

TEST(Picture, IconsComeInTheSizeThatFits) {
    const LPCSTR spot = MAKEINTRESOURCE(IDI_SPOT);
    for (const auto& [wanted, got] : {std::pair(1, 2), {2, 2}, {3, 4}, {4, 4}, {32, 4}}) {
        const auto icon = loadIconPicture(nullptr, spot, wanted);
        ASSERT_TRUE(icon) << icon.reason();
        EXPECT_EQ(icon->width, got) << "for " << wanted;
    }
    EXPECT_EQ(loadIconPicture(nullptr, "none", 16).reason(), "icon not found");
}

TEST(Picture, IconsAreTransparentByMaskOrAlpha) {
    const auto masked = loadIconPicture(nullptr, MAKEINTRESOURCE(IDI_SPOT), 2);
    ASSERT_TRUE(masked) << masked.reason();
    EXPECT_EQ(masked->pixels, (std::vector<std::uint32_t>{white, black, 0, white}));
    EXPECT_TRUE(masked->hasAlpha);
    const auto alpha = loadIconPicture(nullptr, MAKEINTRESOURCE(IDI_SPOT), 4);
    ASSERT_TRUE(alpha) << alpha.reason();
    EXPECT_EQ(alpha->at(0, 0), 0x3F302010u);
    EXPECT_EQ(alpha->at(3, 3), 0xFF302010u);
}

TEST(Picture, CursorsHaveAHotSpot) {
    const auto cursor = loadCursorPicture(nullptr, MAKEINTRESOURCE(IDC_POINTER));
    ASSERT_TRUE(cursor) << cursor.reason();
    EXPECT_EQ(cursor->hotX, 1);
    EXPECT_EQ(cursor->hotY, 0);
    EXPECT_EQ(cursor->picture.width, 2);
}

TEST(Picture, DamagedIconsAreRefused) {
    for (const int id : {1, 2}) {
        const ResourceBytes data = resourceBytes(nullptr, MAKEINTRESOURCE(id), RT_ICON);
        ASSERT_FALSE(data.empty());
        const bool hasAlphaChannel = data[14] == 32; // then the mask may be missing
        expectTruncationsRefused(data, hasAlphaChannel ? data.size() - 16 : data.size(), parseIconImage);
        parseWithFlippedBits(data.first(60), parseIconImage);
    }
}
