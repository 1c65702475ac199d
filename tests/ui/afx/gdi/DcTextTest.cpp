#include "tests/ui/afx/gdi/MemoryDc.h"

#include "platform/afx/gdi/detail/Fonts.h"
#include "platform/afx/gdi/detail/TextLine.h"

#include <gtest/gtest.h>

#include <cstring>
#include <string>
#include <vector>

using namespace tvx::afx;

namespace {

/// The columns and rows that hold any ink.
CRect inkBox(MemoryDc& dc) {
    CRect box(dc.width, dc.height, 0, 0);
    for (int y = 0; y < dc.height; ++y) {
        for (int x = 0; x < dc.width; ++x) {
            if (dc.GetPixel(x, y) == RGB(255, 255, 255)) {
                continue;
            }
            box.left = std::min(box.left, x);
            box.top = std::min(box.top, y);
            box.right = std::max(box.right, x + 1);
            box.bottom = std::max(box.bottom, y + 1);
        }
    }
    return box;
}

TEST(Fonts, OfDialogsHaveTheClassicDialogUnits) {
    for (const char* face : {"MS Sans Serif", "MS Shell Dlg", "ms shell dlg"}) {
        MemoryDc dc;
        CFont font;
        ASSERT_TRUE(font.CreatePointFont(80, face));
        dc.SelectObject(&font);
        LOGFONT description;
        font.GetLogFont(&description);
        EXPECT_EQ(description.lfHeight, -11) << "8 points are rounded to 11 pixels, not cut to 10";
        TEXTMETRIC metrics;
        ASSERT_TRUE(dc.GetTextMetrics(&metrics));
        EXPECT_EQ(metrics.tmAveCharWidth, 6);
        EXPECT_EQ(metrics.tmHeight, 13);
        EXPECT_EQ(metrics.tmHeight, metrics.tmAscent + metrics.tmDescent);
        CString name;
        dc.GetTextFace(name);
        EXPECT_STREQ(name, face) << "a font answers to the name it was asked for";
    }
}

TEST(Fonts, ReplaceFacesThatAreNotInstalledByTheirKind) {
    EXPECT_EQ(familyFor("No Such Face", FIXED_PITCH | FF_MODERN), familyFor("Courier", 0));
    EXPECT_EQ(familyFor("No Such Face", FF_SWISS), familyFor("", 0));
    EXPECT_NE(familyFor("", FF_ROMAN), familyFor("", FF_SWISS));
    EXPECT_EQ(familyFor("DejaVu Sans Mono", FF_ROMAN), "DejaVu Sans Mono") << "an installed face is taken as it is";
    MemoryDc dc;
    CFont font;
    font.CreateFont(15, 0, 0, 0, 0, 0, 0, 0, DEFAULT_CHARSET, 0, 0, PROOF_QUALITY, FIXED_PITCH | FF_MODERN, "FixedSys");
    dc.SelectObject(&font);
    EXPECT_EQ(dc.GetTextExtent("iiii", 4), dc.GetTextExtent("WWWW", 4));
    TEXTMETRIC metrics;
    dc.GetTextMetrics(&metrics);
    EXPECT_EQ(metrics.tmPitchAndFamily & TMPF_FIXED_PITCH, 0) << "the bit is set for variable pitch";
}

TEST(Fonts, TakePositiveHeightsAsCellsAndNegativeOnesAsEms) {
    MemoryDc dc;
    TEXTMETRIC metrics;
    for (const int height : {8, 13, 20, 40}) {
        CFont cell, em;
        cell.CreateFont(height, 0, 0, 0, FW_NORMAL, 0, 0, 0, 1, 0, 0, 0, FF_SWISS, "");
        em.CreateFont(-height, 0, 0, 0, FW_NORMAL, 0, 0, 0, 1, 0, 0, 0, FF_SWISS, "");
        dc.SelectObject(&cell);
        dc.GetTextMetrics(&metrics);
        EXPECT_LE(metrics.tmHeight, height);
        EXPECT_GE(metrics.tmHeight, height - 1);
        dc.SelectObject(&em);
        dc.GetTextMetrics(&metrics);
        EXPECT_EQ(metrics.tmHeight - metrics.tmInternalLeading, height);
    }
}

TEST(Fonts, ScaleWithTheMappingMode) {
    MemoryDc dc(200, 40);
    dc.SetMapMode(MM_ANISOTROPIC);
    dc.SetWindowExt(1440, 1440);
    dc.SetViewportExt(96, 96);
    LOGFONT description{};
    description.lfHeight = 280;
    description.lfPitchAndFamily = FF_SWISS;
    description.lfCharSet = DEFAULT_CHARSET;
    CFont font;
    font.CreateFontIndirect(&description);
    dc.SelectObject(&font);
    const CSize logical = dc.GetTextExtent("Application", 11);
    EXPECT_LE(logical.cy, 285) << "19 pixels of 15 units";
    EXPECT_GE(logical.cy, 255);
    CSize device = logical;
    dc.LPtoDP(&device);
    dc.SetBkMode(TRANSPARENT);
    dc.TextOut(0, 0, "Application", 11);
    dc.SetMapMode(MM_TEXT);
    const CRect ink = inkBox(dc);
    EXPECT_LE(ink.right, device.cx);
    EXPECT_GE(ink.right, device.cx - 3);
}

TEST(Fonts, OfTheStockKeepTheirSizeOnTheDevice) {
    MemoryDc dc(200, 40);
    for (const int stock : {SYSTEM_FONT, DEFAULT_GUI_FONT, ANSI_FIXED_FONT}) {
        dc.SelectStockObject(stock);
        dc.SetMapMode(MM_TEXT);
        const CSize plain = dc.GetTextExtent("Application", 11);
        dc.SetMapMode(MM_LOMETRIC);
        CSize metric = dc.GetTextExtent("Application", 11);
        dc.LPtoDP(&metric);
        EXPECT_NEAR(metric.cx, plain.cx, 1) << stock;
        EXPECT_NEAR(metric.cy, plain.cy, 1) << stock;
    }
}

TEST(Fonts, KeepABrokenDescriptionHarmless) {
    LOGFONT description;
    std::memset(&description, 'x', sizeof description); // no NUL in the name, absurd numbers
    CFont font;
    ASSERT_TRUE(font.CreateFontIndirect(&description));
    MemoryDc dc;
    dc.SelectObject(&font);
    EXPECT_TRUE(dc.TextOut(0, 0, "x", 1));
    char name[4];
    EXPECT_EQ(dc.GetTextFace(4, name), 3);
    EXPECT_STREQ(name, "xxx");
    EXPECT_FALSE(font.CreateFontIndirect(nullptr));
}

TEST(Text, IsAsWideAsMeasuredAndTheSameInPieces) {
    const std::string text = "AVAW Tof, filled: fjord (100%) \xC3\xA4\xC3\xB6";
    for (const char* face : {"MS Sans Serif", "Arial", "Times New Roman", "Courier"}) {
        MemoryDc whole(400, 30), pieces(400, 30);
        CFont font;
        font.CreatePointFont(110, face);
        whole.SelectObject(&font);
        pieces.SelectObject(&font);
        // Characters reach into the cells of their neighbours, so backgrounds would cut them off.
        whole.SetBkMode(TRANSPARENT);
        pieces.SetBkMode(TRANSPARENT);
        whole.TextOut(0, 0, text.c_str());
        int x = 0;
        for (std::size_t at = 0; at < text.size();) {
            const int length = (text[at] & 0x80) ? 2 : 1;
            pieces.TextOut(x, 0, text.data() + at, length);
            x += pieces.GetTextExtent(text.data() + at, length).cx;
            at += static_cast<std::size_t>(length);
        }
        EXPECT_EQ(x, whole.GetTextExtent(text.c_str(), -1).cx) << face;
        EXPECT_EQ(whole.picture(), pieces.picture()) << face;
        SIZE size;
        EXPECT_TRUE(GetTextExtentPoint32(whole, text.c_str(), 4, &size));
        EXPECT_EQ(CSize(size), whole.GetTextExtent("AVAW", 4)) << face;
        int widths[2] = {};
        EXPECT_TRUE(whole.GetCharWidth('A', 'B', widths));
        EXPECT_EQ(widths[0], whole.GetTextExtent("A", 1).cx) << face;
        EXPECT_EQ(widths[1], whole.GetTextExtent("B", 1).cx) << face;
    }
}

TEST(Text, FillsItsCellWhenOpaque) {
    MemoryDc dc(60, 30);
    dc.SetBkColor(RGB(0, 0, 255));
    dc.SetTextColor(RGB(0, 0, 255));
    dc.TextOut(5, 3, "Hood", 4);
    const CSize size = dc.GetTextExtent("Hood", 4);
    EXPECT_EQ(inkBox(dc), CRect(CPoint(5, 3), size));
    EXPECT_EQ(dc.inked(), size.cx * size.cy);
    dc.PatBlt(0, 0, 60, 30, WHITENESS);
    dc.SetBkMode(TRANSPARENT);
    dc.TextOut(5, 3, "Hood", 4);
    EXPECT_LT(dc.inked(), size.cx * size.cy / 2);
}

TEST(Text, IsPlacedByItsAlignment) {
    const CSize size = MemoryDc().GetTextExtent("Align", 5);
    TEXTMETRIC metrics;
    MemoryDc().GetTextMetrics(&metrics);
    struct Case {
        UINT align;
        CPoint corner;
    };
    for (const Case& test : {Case{TA_LEFT | TA_TOP, {50, 40}},
                             {TA_RIGHT, {50 - size.cx, 40}},
                             {TA_CENTER | TA_BOTTOM, {50 - size.cx / 2, 40 - size.cy}},
                             {TA_BASELINE, {50, 40 - metrics.tmAscent}}}) {
        MemoryDc dc(100, 80);
        dc.SetBkColor(RGB(0, 0, 255));
        dc.SetTextAlign(test.align);
        dc.TextOut(50, 40, "Align", 5);
        EXPECT_EQ(inkBox(dc), CRect(test.corner, size)) << test.align;
    }
}

TEST(Text, MovesThePositionOnRequest) {
    MemoryDc dc(100, 20);
    dc.SetTextAlign(TA_UPDATECP);
    dc.MoveTo(7, 2);
    dc.TextOut(50, 50, "ab", 2);
    dc.TextOut(0, 0, "cd", 2);
    EXPECT_EQ(dc.GetCurrentPosition(), CPoint(7 + dc.GetTextExtent("abcd", 4).cx, 2));
    MemoryDc whole(100, 20);
    whole.TextOut(7, 2, "abcd", 4);
    EXPECT_EQ(dc.picture(), whole.picture());
}

TEST(Text, IsClippedAndSpacedByTheExtendedCall) {
    MemoryDc dc(60, 30);
    dc.SetBkColor(RGB(0, 0, 255));
    const RECT rect = {10, 5, 20, 15};
    dc.ExtTextOut(0, 0, ETO_OPAQUE | ETO_CLIPPED, &rect, "MMMMMMMM", 8, nullptr);
    EXPECT_EQ(inkBox(dc), CRect(rect));
    dc.PatBlt(0, 0, 60, 30, WHITENESS);
    const int advances[] = {20, 20, 5};
    dc.SetTextAlign(TA_UPDATECP);
    dc.MoveTo(0, 0);
    dc.ExtTextOut(0, 0, 0, nullptr, "i\xC3\xAFi", 4, advances);
    EXPECT_EQ(dc.GetCurrentPosition(), CPoint(45, 0));
    EXPECT_NE(dc.picture({20, 0, 25, 20}).find('?'), std::string::npos) << "the second character begins at 20";
}

TEST(Text, OnMonochromeBitmapsHasHardEdges) {
    MemoryDc dc(60, 20, 1);
    dc.TextOut(2, 2, "Mono", 4);
    EXPECT_GT(dc.inked(), 20);
    EXPECT_EQ(dc.picture().find('?'), std::string::npos);
    MemoryDc color(60, 20);
    CFont hard;
    hard.CreateFont(-11, 0, 0, 0, 0, 0, 0, 0, 1, 0, 0, NONANTIALIASED_QUALITY, 0, "MS Sans Serif");
    color.SelectObject(&hard);
    color.TextOut(2, 2, "Mono", 4);
    EXPECT_EQ(color.picture().find('?'), std::string::npos);
}

TEST(Text, ShowsBytesThatAreNoUtf8) {
    EXPECT_EQ(shownText("a\xE4z"), QStringLiteral("a\u00E4z"));
    EXPECT_EQ(shownText("\xC3\xA4"), QStringLiteral("\u00E4"));
    EXPECT_EQ(shownText("\xF0\x9F\x98\x80").size(), 2);
    EXPECT_EQ(shownText("\xE2\x82"), QStringLiteral("\u00E2\u0082"));
}

TEST(Text, SlantsWithItsEscapement) {
    MemoryDc dc(100, 100);
    CFont up;
    up.CreateFont(-12, 0, 900, 900, 0, 0, 0, 0, 1, 0, 0, 0, FF_SWISS, "");
    dc.SelectObject(&up);
    dc.SetBkMode(TRANSPARENT);
    dc.TextOut(40, 90, "Upwards", 7);
    const CRect ink = inkBox(dc);
    const CSize size = dc.GetTextExtent("Upwards", 7);
    EXPECT_GE(ink.left, 40);
    EXPECT_LE(ink.right, 40 + size.cy + 1);
    EXPECT_LE(ink.bottom, 91);
    EXPECT_NEAR(ink.Height(), size.cx, 3);
}

TEST(Tabs, StopWhereTheyAreTold) {
    MemoryDc dc(300, 20);
    TEXTMETRIC metrics;
    dc.GetTextMetrics(&metrics);
    const int ab = dc.GetTextExtent("ab", 2).cx;
    EXPECT_EQ(dc.GetTabbedTextExtent("x\tab", 4, 0, nullptr), CSize(8 * metrics.tmAveCharWidth + ab, metrics.tmHeight));
    const int every = 50, stops[] = {40, 200};
    EXPECT_EQ(dc.GetTabbedTextExtent("x\t\tab", 5, 1, &every).cx, 100 + ab);
    EXPECT_EQ(dc.GetTabbedTextExtent("x\t\tab", 5, 2, stops).cx, 200 + ab);
    dc.SetBkMode(TRANSPARENT);
    dc.TabbedTextOut(10, 0, "x\tab", 4, 1, &every, 10);
    MemoryDc plain(300, 20);
    plain.SetBkMode(TRANSPARENT);
    plain.TextOut(10, 0, "x", 1);
    plain.TextOut(60, 0, "ab", 2);
    EXPECT_EQ(dc.picture(), plain.picture());
}

/// What DrawText draws, looked for by drawing the same pieces by hand.
class DrawTextCall : public testing::Test {
protected:
    DrawTextCall() {
        dc.SelectStockObject(DEFAULT_GUI_FONT);
        expected.SelectStockObject(DEFAULT_GUI_FONT);
        dc.SetBkMode(TRANSPARENT);
        expected.SetBkMode(TRANSPARENT);
        TEXTMETRIC metrics;
        dc.GetTextMetrics(&metrics);
        lineHeight = metrics.tmHeight;
        ascent = metrics.tmAscent;
    }
    int width(const char* text) {
        return dc.GetTextExtent(text, -1).cx;
    }
    void expectSame() {
        EXPECT_EQ(dc.picture(), expected.picture());
    }
    MemoryDc dc{200, 80};
    MemoryDc expected{200, 80};
    CRect rect{10, 10, 150, 70};
    int lineHeight = 0;
    int ascent = 0;
};

TEST_F(DrawTextCall, Aligns) {
    EXPECT_EQ(dc.DrawText("Right", -1, &rect, DT_RIGHT | DT_BOTTOM | DT_SINGLELINE), 60);
    expected.TextOut(150 - width("Right"), 70 - lineHeight, "Right", 5);
    dc.DrawText("Middle", &rect, DT_CENTER | DT_VCENTER | DT_SINGLELINE);
    expected.TextOut(10 + (140 - width("Middle")) / 2, 10 + (60 - lineHeight) / 2, "Middle", 6);
    EXPECT_EQ(dc.DrawText("Some\r\nlines", -1, &rect, DT_VCENTER), 2 * lineHeight)
        << "vertical alignment is for single lines";
    expected.TextOut(10, 10, "Some", 4);
    expected.TextOut(10, 10 + lineHeight, "lines", 5);
    expectSame();
}

TEST_F(DrawTextCall, UnderlinesTheMnemonic) {
    dc.DrawText("Save && &Run", -1, &rect, DT_SINGLELINE);
    expected.TextOut(10, 10, "Save & Run", 10);
    expected.MoveTo(10 + width("Save & "), 10 + ascent + 1);
    expected.LineTo(10 + width("Save & R"), 10 + ascent + 1);
    dc.OffsetWindowOrg(0, -30);
    expected.OffsetWindowOrg(0, -30);
    dc.DrawText("A&B", -1, &rect, DT_NOPREFIX);
    expected.TextOut(10, 10, "A&B", 3);
    expectSame();
}

TEST_F(DrawTextCall, BreaksBetweenWords) {
    rect.right = rect.left + width("one two") + 2;
    EXPECT_EQ(dc.DrawText("one two three incomprehensibilities x", -1, &rect, DT_WORDBREAK | DT_NOCLIP),
              4 * lineHeight);
    const char* lines[] = {"one two", "three", "incomprehensibilities", "x"};
    for (int i = 0; i < 4; ++i) {
        expected.TextOut(10, 10 + i * lineHeight, lines[i], -1);
    }
    expectSame();
}

TEST_F(DrawTextCall, CalculatesWithoutDrawing) {
    CRect single(5, 5, 6, 6);
    EXPECT_EQ(dc.DrawText("Measure &me", -1, &single, DT_CALCRECT | DT_SINGLELINE), lineHeight);
    EXPECT_EQ(single, CRect(5, 5, 5 + width("Measure me"), 5 + lineHeight));
    CRect broken(0, 0, width("several"), 0);
    dc.DrawText("several words", -1, &broken, DT_CALCRECT | DT_WORDBREAK);
    EXPECT_EQ(broken, CRect(0, 0, width("several"), 2 * lineHeight));
    EXPECT_EQ(dc.inked(), 0);
}

TEST_F(DrawTextCall, ShortensWhatDoesNotFit) {
    rect.right = rect.left + width("A lon...");
    dc.DrawText("A long text", -1, &rect, DT_SINGLELINE | DT_END_ELLIPSIS);
    expected.TextOut(10, 10, "A lon...", 8);
    rect = {10, 40, 10 + width("C:\\pr...\\main.cpp"), 60};
    dc.DrawText("C:\\proj\\src\\main.cpp", -1, &rect, DT_SINGLELINE | DT_PATH_ELLIPSIS);
    expected.TextOut(10, 40, "C:\\pr...\\main.cpp", -1);
    expectSame();
    CRect tiny(0, 0, 1, 10);
    EXPECT_GT(dc.DrawText("\xC3\xA4\xC3\xB6", -1, &tiny, DT_SINGLELINE | DT_END_ELLIPSIS), 0);
}

TEST_F(DrawTextCall, ClipsAtTheRectangleUnlessToldNotTo) {
    rect = {10, 10, 20, 15};
    dc.DrawText("Clipped", -1, &rect, DT_SINGLELINE);
    const CRect ink = inkBox(dc);
    EXPECT_TRUE(ink.right <= 20 && ink.bottom <= 15);
    dc.DrawText("Clipped", -1, &rect, DT_SINGLELINE | DT_NOCLIP);
    expected.TextOut(10, 10, "Clipped", 7);
    EXPECT_EQ(inkBox(dc), inkBox(expected));
}

TEST(Advances, AreThoseOfTheToolkit) {
    const std::string_view samples[] = {
        "", "Affinity, office; fluffy AVAWATo", "größe Ñandú", "Ελληνικά", "Кириллица", "日本語", "→ ½ €"};
    for (const char* face : {"MS Sans Serif", "System", "Courier"}) {
        LOGFONT description = pointFont(100, face);
        const auto font = realizeFont(description);
        for (const std::string_view sample : samples) {
            EXPECT_EQ(font->advances.widthOf(sample), font->metrics.horizontalAdvance(shownText(sample))) << sample;
        }
        for (const std::string_view whole : {"e\xCC\x81", "\xD8\xB3\xD9\x84\xD8\xA7\xD9\x85", "a\tb", "\xFF"}) {
            EXPECT_FALSE(font->advances.widthOf(whole)) << "a text whose characters depend on each other";
        }
    }
}

TEST(Advances, AddUpForEveryPairOfLetters) {
    const auto font = realizeFont(pointFont(80, "MS Sans Serif"));
    for (char first = ' '; first <= '~'; ++first) {
        for (char second = ' '; second <= '~'; ++second) {
            const std::string pair{first, second};
            ASSERT_EQ(font->advances.widthOf(pair), font->metrics.horizontalAdvance(shownText(pair))) << pair;
        }
    }
}

} // namespace
