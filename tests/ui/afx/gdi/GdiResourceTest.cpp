#include "tests/data/resources/resource.h"
#include "tests/ui/afx/gdi/MemoryDc.h"

#include "platform/afx/core/WindowCalls.h"
#include "platform/afx/core/detail/Cursors.h"
#include "platform/afx/gdi/detail/GdiObjects.h"
#include "platform/win/ExtensionModule.h"

#include <gtest/gtest.h>

#include <QImage>

#include <cstring>
#include <vector>

namespace {

/// Draws a bitmap at the top left corner.
std::string pictureOf(CBitmap& bitmap) {
    BITMAP size{};
    bitmap.GetBitmap(&size);
    MemoryDc dc(size.bmWidth, size.bmHeight);
    CDC source;
    source.CreateCompatibleDC(&dc);
    CBitmap* old = source.SelectObject(&bitmap);
    dc.BitBlt(0, 0, size.bmWidth, size.bmHeight, &source, 0, 0, SRCCOPY);
    source.SelectObject(old);
    return dc.picture();
}

TEST(Resources, AreLoadedByNumberAndByName) {
    CBitmap stripes, grid, none;
    ASSERT_TRUE(stripes.LoadBitmap(IDB_STRIPES));
    EXPECT_EQ(pictureOf(stripes), "rgb\n"
                                  ".#r\n");
    ASSERT_TRUE(grid.LoadBitmap("grid"));
    BITMAP record;
    grid.GetBitmap(&record);
    EXPECT_EQ(CSize(record.bmWidth, record.bmHeight), CSize(2, 2));
    EXPECT_EQ(record.bmBitsPixel, 32);
    EXPECT_FALSE(none.LoadBitmap("no such picture"));
    EXPECT_EQ(none.GetSafeHandle(), nullptr);
    const HBITMAP bare = LoadBitmapA(nullptr, MAKEINTRESOURCE(IDB_STRIPES));
    EXPECT_NE(bare, nullptr);
    EXPECT_TRUE(DeleteObject(bare));
}

TEST(Cursors, AreLoadedFromTheirModuleOrAreTheSystems) {
    const HINSTANCE module = AfxGetInstanceHandle();
    const HCURSOR pointer = LoadCursorA(module, MAKEINTRESOURCE(IDC_POINTER));
    const QCursor shown = tvx::afx::cursorOf(pointer);
    EXPECT_EQ(shown.shape(), Qt::BitmapCursor);
    EXPECT_EQ(shown.hotSpot(), QPoint(1, 0));
    EXPECT_EQ(shown.pixmap().size(), QSize(2, 2));
    EXPECT_EQ(shown, tvx::afx::cursorOf(LoadCursorA(module, MAKEINTRESOURCE(IDC_POINTER)))) << "loaded once";
    EXPECT_EQ(tvx::afx::cursorOf(LoadCursorA(nullptr, IDC_CROSS)).shape(), Qt::CrossCursor);
    EXPECT_EQ(LoadCursorA(nullptr, MAKEINTRESOURCE(IDC_POINTER)), nullptr) << "that is none of the system's";
    EXPECT_EQ(LoadCursorA(module, "no such cursor"), nullptr);
}

TEST(Icons, AreDrawnOverWhatIsThere) {
    const HICON icon = LoadIconA(nullptr, MAKEINTRESOURCE(IDI_SPOT));
    EXPECT_EQ(icon, nullptr) << "without a module only the predefined ones are meant";
    QImage image(2, 1, QImage::Format_ARGB32);
    image.setPixel(0, 0, 0xFFFF0000);
    image.setPixel(1, 0, 0x00000000);
    const HICON own = tvx::afx::addIcon(image);
    MemoryDc dc(4, 2);
    EXPECT_TRUE(dc.DrawIcon(1, 1, own));
    EXPECT_EQ(dc.picture(), "....\n"
                            ".r..\n");
    CBrush blue(RGB(0, 0, 255));
    EXPECT_TRUE(DrawIconEx(dc, 0, 0, own, 0, 0, 0, blue, DI_NORMAL));
    EXPECT_EQ(dc.picture({0, 0, 4, 1}), "rb..\n");
    const HICON copy = CopyIcon(own);
    EXPECT_TRUE(DestroyIcon(own));
    EXPECT_FALSE(dc.DrawIcon(0, 0, own));
    EXPECT_TRUE(dc.DrawIcon(0, 0, copy));
    EXPECT_TRUE(DestroyIcon(copy));
}

TEST(Icons, OfMessageBoxesArePredefined) {
    const HICON warning = LoadIconA(nullptr, MAKEINTRESOURCE(32515));
    ASSERT_NE(warning, nullptr);
    EXPECT_EQ(LoadIconA(nullptr, MAKEINTRESOURCE(32515)), warning) << "loaded once";
    MemoryDc dc(40, 40);
    dc.DrawIcon(4, 4, warning);
    EXPECT_GT(dc.inked(), 100);
    EXPECT_EQ(LoadIconA(nullptr, MAKEINTRESOURCE(1)), nullptr);
}

/// Device-independent bits with a full colour table: 0 black, 1 red, 2 green, 3 blue, others white.
struct DeviceIndependentBits {
    DeviceIndependentBits(int width, int height, WORD bitsPerPixel) {
        header().biSize = sizeof(BITMAPINFOHEADER);
        header().biWidth = width;
        header().biHeight = height;
        header().biPlanes = 1;
        header().biBitCount = bitsPerPixel;
        const RGBQUAD colors[] = {{0, 0, 0, 0}, {0, 0, 255, 0}, {0, 255, 0, 0}, {255, 0, 0, 0}};
        std::memset(table(), 0xFF, 256 * sizeof(RGBQUAD));
        std::memcpy(table(), colors, sizeof colors);
    }
    BITMAPINFOHEADER& header() {
        return info()->bmiHeader;
    }
    BITMAPINFO* info() {
        return reinterpret_cast<BITMAPINFO*>(storage.data());
    }
    RGBQUAD* table() {
        return reinterpret_cast<RGBQUAD*>(storage.data() + sizeof(BITMAPINFOHEADER));
    }
    HBITMAP create(const std::vector<BYTE>& bits) {
        return CreateDIBitmap(nullptr, &header(), CBM_INIT, bits.data(), info(), DIB_RGB_COLORS);
    }
    std::vector<BYTE> storage = std::vector<BYTE>(sizeof(BITMAPINFOHEADER) + 256 * sizeof(RGBQUAD));
};

TEST(DeviceIndependentBits, BecomeColourBitmaps) {
    CBitmap four;
    ASSERT_TRUE(four.Attach(DeviceIndependentBits(3, 2, 4).create({0x45, 0x10, 0, 0, 0x01, 0x20, 0, 0})));
    EXPECT_EQ(pictureOf(four), "#rg\n"
                               "..r\n")
        << "rows come from the bottom";
    CBitmap one;
    ASSERT_TRUE(one.Attach(DeviceIndependentBits(9, -1, 1).create({0x81, 0x80, 0, 0})));
    EXPECT_EQ(pictureOf(one), "r######rr\n") << "a negative height begins at the top";
    BITMAP record;
    one.GetBitmap(&record);
    EXPECT_EQ(record.bmBitsPixel, 32) << "in the format of the screen, two colours or not";
    CBitmap eight;
    ASSERT_TRUE(eight.Attach(DeviceIndependentBits(2, 1, 8).create({3, 255, 0, 0})));
    EXPECT_EQ(pictureOf(eight), "b.\n");
}

TEST(DeviceIndependentBits, ThatAreNotUnderstoodAreRefused) {
    const std::vector<BYTE> bits(64);
    DeviceIndependentBits size(3, 2, 4), depth(3, 2, 5), packed(3, 2, 4), empty(0, 2, 4), huge(1 << 20, 1 << 20, 4),
        colors(3, 2, 4), good(3, 2, 4);
    size.header().biSize = 12;
    packed.header().biCompression = 1;
    colors.header().biClrUsed = 0xFFFFFFFF;
    for (DeviceIndependentBits* bad : {&size, &depth, &packed, &empty, &huge, &colors}) {
        EXPECT_EQ(bad->create(bits), nullptr);
    }
    EXPECT_EQ(CreateDIBitmap(nullptr, nullptr, CBM_INIT, bits.data(), good.info(), DIB_RGB_COLORS), nullptr);
    EXPECT_EQ(CreateDIBitmap(nullptr, &good.header(), CBM_INIT, nullptr, good.info(), DIB_RGB_COLORS), nullptr);
    EXPECT_EQ(CreateDIBitmap(nullptr, &good.header(), CBM_INIT, bits.data(), good.info(), 7), nullptr);
    const HBITMAP black = CreateDIBitmap(nullptr, &good.header(), 0, nullptr, nullptr, DIB_RGB_COLORS);
    EXPECT_TRUE(DeleteObject(black));
}

} // namespace
