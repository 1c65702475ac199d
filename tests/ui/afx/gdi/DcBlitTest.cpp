#include "tests/ui/afx/gdi/MemoryDc.h"

#include <gtest/gtest.h>

#include <functional>

namespace {

constexpr COLORREF colorMask = 0xFFFFFF;

struct NamedOperation {
    const char* name;
    DWORD code;
    std::function<COLORREF(COLORREF pattern, COLORREF source, COLORREF destination)> result;
};

void PrintTo(const NamedOperation& operation, std::ostream* stream) {
    *stream << operation.name;
}

using C = COLORREF;
const NamedOperation operations[] = {
    {"SRCCOPY", SRCCOPY, [](C, C s, C) { return s; }},
    {"SRCPAINT", SRCPAINT, [](C, C s, C d) { return s | d; }},
    {"SRCAND", SRCAND, [](C, C s, C d) { return s & d; }},
    {"SRCINVERT", SRCINVERT, [](C, C s, C d) { return s ^ d; }},
    {"SRCERASE", SRCERASE, [](C, C s, C d) { return s & ~d; }},
    {"NOTSRCCOPY", NOTSRCCOPY, [](C, C s, C) { return ~s; }},
    {"NOTSRCERASE", NOTSRCERASE, [](C, C s, C d) { return ~(s | d); }},
    {"MERGECOPY", MERGECOPY, [](C p, C s, C) { return s & p; }},
    {"MERGEPAINT", MERGEPAINT, [](C, C s, C d) { return ~s | d; }},
    {"PATCOPY", PATCOPY, [](C p, C, C) { return p; }},
    {"PATPAINT", PATPAINT, [](C p, C s, C d) { return p | ~s | d; }},
    {"PATINVERT", PATINVERT, [](C p, C, C d) { return p ^ d; }},
    {"DSTINVERT", DSTINVERT, [](C, C, C d) { return ~d; }},
    {"BLACKNESS", BLACKNESS, [](C, C, C) { return C{0}; }},
    {"WHITENESS", WHITENESS, [](C, C, C) { return colorMask; }},
    {"a masked pattern", 0x00B8074A, [](C p, C s, C d) { return ((p ^ d) & s) ^ p; }},
};

class RasterOperation : public testing::TestWithParam<NamedOperation> {};

TEST_P(RasterOperation, CombinesPatternSourceAndDestination) {
    const COLORREF pattern = RGB(0xF0, 0x12, 0x9A), source = RGB(0xCC, 0x77, 0x35), destination = RGB(0xAA, 0xE1, 0x0F);
    MemoryDc target(3, 3), from(3, 3);
    target.FillSolidRect(0, 0, 3, 3, destination);
    from.FillSolidRect(0, 0, 3, 3, source);
    CBrush brush(pattern);
    target.SelectObject(&brush);
    EXPECT_TRUE(target.BitBlt(1, 1, 1, 1, &from, 0, 0, GetParam().code));
    EXPECT_EQ(target.GetPixel(1, 1), GetParam().result(pattern, source, destination) & colorMask);
    EXPECT_EQ(target.GetPixel(0, 1), destination);
    EXPECT_EQ(target.GetPixel(2, 1), destination);
}

INSTANTIATE_TEST_SUITE_P(Named, RasterOperation, testing::ValuesIn(operations));

TEST(PatBlt, RefusesOperationsThatNeedASource) {
    MemoryDc dc(3, 3);
    EXPECT_FALSE(dc.PatBlt(0, 0, 3, 3, SRCCOPY));
    EXPECT_FALSE(dc.PatBlt(0, 0, 3, 3, PATPAINT));
    EXPECT_EQ(dc.inked(), 0);
    EXPECT_TRUE(dc.BitBlt(0, 0, 3, 3, nullptr, 0, 0, BLACKNESS)) << "no source is needed for this";
    EXPECT_EQ(dc.inked(), 9);
    EXPECT_FALSE(dc.BitBlt(0, 0, 3, 3, nullptr, 0, 0, SRCCOPY));
}

/// A row of five pixels: black, red, green, blue, white.
class Blit : public testing::Test {
protected:
    Blit() {
        const COLORREF colors[] = {0, RGB(255, 0, 0), RGB(0, 255, 0), RGB(0, 0, 255), RGB(255, 255, 255)};
        for (int x = 0; x < 5; ++x) {
            source.SetPixelV(x, 0, colors[x]);
        }
    }
    MemoryDc source{5, 1};
    MemoryDc target{10, 2};
};

TEST_F(Blit, LeavesOutWhatTheSourceDoesNotHave) {
    target.BitBlt(1, 0, 8, 2, &source, -2, -1, SRCCOPY);
    EXPECT_EQ(target.picture(), "..........\n"
                                "...#rgb...\n");
    target.BitBlt(0, 0, 9, 1, &source, 3, 0, SRCCOPY);
    EXPECT_EQ(target.picture({0, 0, 10, 1}), "b.........\n");
    EXPECT_TRUE(target.BitBlt(0, 0, 5, 1, &source, 50, 50, SRCCOPY));
    EXPECT_TRUE(target.BitBlt(0, 0, 0, 0, &source, 0, 0, SRCCOPY));
}

TEST_F(Blit, WithinOneBitmapReadsBeforeItWrites) {
    source.BitBlt(1, 0, 4, 1, &source, 0, 0, SRCCOPY);
    EXPECT_EQ(source.picture(), "##rgb\n");
    source.BitBlt(0, 0, 4, 1, &source, 1, 0, SRCCOPY);
    EXPECT_EQ(source.picture(), "#rgbb\n");
}

TEST_F(Blit, StretchesAndMirrors) {
    target.SetStretchBltMode(COLORONCOLOR);
    target.StretchBlt(0, 0, 10, 1, &source, 0, 0, 5, 1, SRCCOPY);
    target.StretchBlt(0, 1, 5, 1, &source, 4, 0, -5, 1, SRCCOPY);
    EXPECT_EQ(target.picture(), "##rrggbb..\n"
                                ".bgr#.....\n");
    target.StretchBlt(9, 1, -10, 1, &source, 0, 0, 5, 1, SRCCOPY);
    EXPECT_EQ(target.picture({0, 1, 10, 2}), "..bbggrr##\n") << "runs from pixel 9 down to pixel 0";
}

TEST_F(Blit, ShrinksByTheStretchingMode) {
    MemoryDc wide(6, 1), narrow(3, 1);
    const COLORREF colors[] = {0, colorMask, colorMask, colorMask, RGB(255, 0, 0), RGB(0, 0, 255)};
    for (int x = 0; x < 6; ++x) {
        wide.SetPixelV(x, 0, colors[x]);
    }
    narrow.StretchBlt(0, 0, 3, 1, &wide, 0, 0, 6, 1, SRCCOPY); // black prevails
    EXPECT_EQ(narrow.picture(), "#.#\n");
    narrow.SetStretchBltMode(WHITEONBLACK);
    narrow.StretchBlt(0, 0, 3, 1, &wide, 0, 0, 6, 1, SRCCOPY);
    EXPECT_EQ(narrow.GetPixel(0, 0), colorMask);
    EXPECT_EQ(narrow.GetPixel(2, 0), RGB(255, 0, 255));
    narrow.SetStretchBltMode(HALFTONE);
    narrow.StretchBlt(0, 0, 3, 1, &wide, 0, 0, 6, 1, SRCCOPY);
    EXPECT_EQ(narrow.GetPixel(0, 0), RGB(128, 128, 128));
    EXPECT_EQ(narrow.GetPixel(2, 0), RGB(128, 0, 128));
}

TEST_F(Blit, StretchesByDifferentMappingModes) {
    target.SetStretchBltMode(COLORONCOLOR);
    target.SetMapMode(MM_ANISOTROPIC);
    target.SetWindowExt(1, 1);
    target.SetViewportExt(2, 2);
    target.BitBlt(0, 0, 5, 1, &source, 0, 0, SRCCOPY);
    EXPECT_EQ(target.picture(), "##rrggbb..\n"
                                "##rrggbb..\n");
}

TEST_F(Blit, DrawsABitmapUnchangedUnderTheTargetsMapping) {
    // The way in which pictures are drawn by hosts: the same mode in both contexts, sizes converted by the target.
    for (const int mode : {MM_TEXT, MM_LOENGLISH, MM_TWIPS}) {
        MemoryDc paper(10, 3);
        paper.SetMapMode(mode);
        source.SetMapMode(mode);
        CSize size(5, 1);
        paper.DPtoLP(&size);
        CPoint at(2, 1), origin(0, 0);
        paper.DPtoLP(&at);
        source.DPtoLP(&origin);
        const int height = mode == MM_TEXT ? size.cy : -size.cy;
        paper.BitBlt(at.x, at.y, size.cx, height, &source, origin.x, origin.y, SRCCOPY);
        EXPECT_EQ(paper.picture(), "..........\n"
                                   "..#rgb....\n"
                                   "..........\n")
            << mode;
    }
}

TEST_F(Blit, PaintsMonochromePicturesInTheTargetsColours) {
    MemoryDc mono(4, 1, 1);
    mono.SetPixelV(1, 0, 0);
    mono.SetPixelV(3, 0, RGB(60, 60, 60));
    EXPECT_EQ(mono.picture(), ".#.#\n") << "a dark colour is black";
    target.SetTextColor(RGB(255, 0, 0));
    target.SetBkColor(RGB(0, 0, 255));
    target.BitBlt(0, 0, 4, 1, &mono, 0, 0, SRCCOPY);
    EXPECT_EQ(target.picture({0, 0, 4, 1}), "brbr\n");
}

TEST_F(Blit, MakesAMaskOfOneColour) {
    MemoryDc mask(5, 1, 1);
    source.SetBkColor(RGB(0, 0, 255));
    mask.BitBlt(0, 0, 5, 1, &source, 0, 0, SRCCOPY);
    EXPECT_EQ(mask.picture(), "###.#\n");
    // The mask lets the background through where the colour was, the picture everywhere else.
    target.FillSolidRect(0, 0, 5, 1, RGB(128, 128, 128));
    target.SetTextColor(0);
    target.SetBkColor(RGB(255, 255, 255));
    target.BitBlt(0, 0, 5, 1, &mask, 0, 0, SRCAND);
    source.SetTextColor(RGB(255, 255, 255));
    source.SetBkColor(0);
    source.BitBlt(0, 0, 5, 1, &mask, 0, 0, SRCAND);
    target.BitBlt(0, 0, 5, 1, &source, 0, 0, SRCPAINT);
    EXPECT_EQ(target.picture({0, 0, 5, 1}), "#rg?.\n");
    EXPECT_EQ(target.GetPixel(3, 0), RGB(128, 128, 128));
}

TEST(Pixels, AreExact) {
    MemoryDc color(3, 1), mono(3, 1, 1);
    for (const COLORREF value : {RGB(1, 2, 3), RGB(254, 255, 253), RGB(0x12, 0x80, 0x7F)}) {
        EXPECT_EQ(color.SetPixel(1, 0, value), value);
        EXPECT_EQ(color.GetPixel(1, 0), value);
    }
    EXPECT_EQ(mono.SetPixel(0, 0, RGB(200, 200, 200)), colorMask);
    EXPECT_EQ(mono.SetPixel(0, 0, RGB(10, 90, 10)), 0U);
    EXPECT_EQ(color.SetPixel(3, 0, 0), CLR_INVALID);
}

} // namespace
