#include "tests/ui/afx/gdi/MemoryDc.h"

#include "platform/afx/gdi/detail/DeviceContext.h"

#include <gtest/gtest.h>

#include <QApplication>
#include <QPalette>

#include <array>
#include <cstring>

using namespace tvx::afx;

namespace {

TEST(Handles, OfDeletedToolsMakeCallsFailAndNothingElse) {
    const HPEN pen = CreatePen(PS_SOLID, 1, RGB(1, 2, 3));
    ASSERT_NE(pen, nullptr);
    EXPECT_EQ(GetObjectType(pen), static_cast<DWORD>(OBJ_PEN));
    EXPECT_TRUE(DeleteObject(pen));
    MemoryDc dc;
    LOGPEN record;
    EXPECT_FALSE(DeleteObject(pen));
    EXPECT_EQ(GetObjectType(pen), 0U);
    EXPECT_EQ(GetObjectA(pen, sizeof record, &record), 0);
    EXPECT_EQ(::SelectObject(dc, pen), nullptr);
    EXPECT_EQ(CPen::FromHandle(pen), nullptr);
    // A new tool must not be taken for the old one.
    const HPEN next = CreatePen(PS_SOLID, 1, 0);
    EXPECT_NE(next, pen);
    EXPECT_EQ(GetObjectType(pen), 0U);
    DeleteObject(next);
}

TEST(Handles, ThatWereNeverGivenOutAreRefused) {
    for (const std::uintptr_t number :
         {std::uintptr_t{1}, std::uintptr_t{0x10000001}, std::uintptr_t{0xFFFFFFFF}, std::uintptr_t{0x7FFF00001234}}) {
        const auto object = reinterpret_cast<HGDIOBJ>(number);
        EXPECT_EQ(GetObjectType(object), 0U);
        EXPECT_FALSE(DeleteObject(object));
        EXPECT_FALSE(DeleteDC(reinterpret_cast<HDC>(number)));
        EXPECT_EQ(CDC::FromHandle(reinterpret_cast<HDC>(number)), nullptr);
        EXPECT_FALSE(DestroyIcon(reinterpret_cast<HICON>(number)));
        EXPECT_EQ(CreateCompatibleDC(reinterpret_cast<HDC>(number)), nullptr);
    }
    MemoryDc dc;
    EXPECT_EQ(GetObjectType(dc.m_hDC), 0U) << "a context is no tool";
    EXPECT_FALSE(BitBlt(dc, 0, 0, 5, 5, reinterpret_cast<HDC>(dc.bitmap.m_hObject), 0, 0, SRCCOPY));
}

TEST(Handles, OfDeletedContextsMakeEveryCallFail) {
    CDC dc;
    dc.CreateCompatibleDC(nullptr);
    CDC* alias = CDC::FromHandle(dc.m_hDC);
    ASSERT_EQ(alias, &dc);
    const HDC handle = dc.m_hDC;
    dc.Detach();
    DeleteDC(handle);
    dc.m_hDC = handle; // as a host does that keeps a handle too long
    RECT rect = {0, 0, 5, 5};
    EXPECT_FALSE(dc.Rectangle(&rect));
    EXPECT_FALSE(dc.LineTo(3, 3));
    EXPECT_FALSE(dc.TextOut(0, 0, "x", 1));
    EXPECT_EQ(dc.DrawText("x", 1, &rect, 0), 0);
    EXPECT_EQ(dc.GetPixel(0, 0), CLR_INVALID);
    EXPECT_EQ(dc.SetPixel(0, 0, 0), CLR_INVALID);
    EXPECT_EQ(dc.SetTextColor(0), CLR_INVALID);
    EXPECT_EQ(dc.SetMapMode(MM_TWIPS), 0);
    EXPECT_EQ(dc.SaveDC(), 0);
    EXPECT_FALSE(dc.RestoreDC(-1));
    EXPECT_FALSE(dc.StretchBlt(0, 0, 1, 1, &dc, 0, 0, 1, 1, SRCCOPY));
    EXPECT_EQ(dc.GetClipBox(&rect), RGN_ERROR);
    EXPECT_EQ(dc.SelectStockObject(NULL_PEN), nullptr);
    EXPECT_EQ(dc.GetTextExtent("x", 1), CSize(0, 0));
    EXPECT_EQ(dc.GetCurrentFont(), nullptr);
    dc.m_hDC = nullptr;
}

TEST(GdiObject, OwnsItsHandle) {
    HGDIOBJ handle = nullptr;
    {
        const LOGPEN described = {PS_DOT, {3, 0}, RGB(9, 8, 7)};
        CPen pen;
        ASSERT_TRUE(pen.CreatePenIndirect(&described));
        handle = pen.GetSafeHandle();
        EXPECT_EQ(CPen::FromHandle(pen), &pen);
        EXPECT_FALSE(pen.CreatePen(PS_SOLID, 1, 0)) << "it holds one already";
        LOGPEN record;
        ASSERT_TRUE(pen.GetLogPen(&record));
        EXPECT_EQ(record.lopnStyle, static_cast<UINT>(PS_DOT));
        EXPECT_EQ(record.lopnWidth.x, 3);
        EXPECT_EQ(record.lopnColor, RGB(9, 8, 7));
    }
    EXPECT_EQ(GetObjectType(handle), 0U);
    CBrush brush(RGB(1, 1, 1));
    handle = brush.Detach();
    EXPECT_EQ(brush.GetSafeHandle(), nullptr);
    EXPECT_TRUE(brush.Attach(handle));
    EXPECT_TRUE(brush.DeleteObject());
    EXPECT_FALSE(brush.DeleteObject());
}

TEST(GdiObject, OfABrushIsMadeFromItsOwnDescription) {
    CBitmap pattern;
    pattern.CreateBitmap(8, 8, 1, 32, nullptr);
    CBrush hatched(HS_CROSS, RGB(1, 2, 3)), solid(RGB(4, 5, 6)), patterned(&pattern), empty, none;
    empty.CreateStockObject(NULL_BRUSH);
    for (const CBrush* brush : {&hatched, &solid, &patterned, &empty}) {
        LOGBRUSH record, again;
        ASSERT_TRUE(brush->GetLogBrush(&record));
        CBrush copy;
        ASSERT_TRUE(copy.CreateBrushIndirect(&record)) << record.lbStyle;
        ASSERT_TRUE(copy.GetLogBrush(&again));
        EXPECT_EQ(again.lbStyle, record.lbStyle);
        EXPECT_EQ(again.lbColor, record.lbColor);
        EXPECT_EQ(again.lbHatch, record.lbHatch);
    }
    const LOGBRUSH unknown = {99, 0, 0};
    EXPECT_FALSE(none.CreateBrushIndirect(&unknown));
    EXPECT_FALSE(none.GetLogBrush(nullptr));
    CBrush system;
    ASSERT_TRUE(system.CreateSysColorBrush(COLOR_WINDOW));
    EXPECT_EQ(system.m_hObject, GetSysColorBrush(COLOR_WINDOW));
}

TEST(GdiObject, OfABareHandleLivesUntilIdleAndOwnsNothing) {
    const HBRUSH handle = CreateSolidBrush(RGB(1, 2, 3));
    CBrush* made = CBrush::FromHandle(handle);
    ASSERT_NE(made, nullptr);
    EXPECT_EQ(CBrush::FromHandle(handle), made);
    EXPECT_EQ(CPen::FromHandle(reinterpret_cast<HPEN>(handle)), nullptr) << "of another kind";
    CGdiObject::DeleteTempMap();
    EXPECT_EQ(GetObjectType(handle), static_cast<DWORD>(OBJ_BRUSH));
    DeleteObject(handle);
}

TEST(StockObjects, SurviveDeletionAndAreShared) {
    for (const int index : {WHITE_BRUSH, NULL_BRUSH, BLACK_PEN, NULL_PEN, SYSTEM_FONT, DEFAULT_GUI_FONT}) {
        const HGDIOBJ stock = GetStockObject(index);
        ASSERT_NE(stock, nullptr);
        EXPECT_TRUE(DeleteObject(stock));
        EXPECT_NE(GetObjectType(stock), 0U);
        EXPECT_EQ(GetStockObject(index), stock);
    }
    EXPECT_EQ(GetStockObject(9), nullptr);
    EXPECT_EQ(GetStockObject(-1), nullptr);
    EXPECT_EQ(GetStockObject(1000), nullptr);
}

TEST(SelectObject, AnswersTheToolBefore) {
    MemoryDc dc;
    CPen red(PS_SOLID, 1, RGB(255, 0, 0));
    CPen* black = dc.SelectObject(&red);
    ASSERT_NE(black, nullptr);
    EXPECT_EQ(black->m_hObject, GetStockObject(BLACK_PEN));
    EXPECT_EQ(dc.GetCurrentPen(), &red);
    EXPECT_EQ(dc.SelectObject(black), &red);
    EXPECT_EQ(dc.SelectStockObject(NULL_BRUSH)->m_hObject, GetStockObject(WHITE_BRUSH));
    EXPECT_EQ(dc.GetCurrentBrush()->m_hObject, GetStockObject(NULL_BRUSH));
    EXPECT_EQ(dc.GetCurrentBitmap(), &dc.bitmap);
    CPen none;
    EXPECT_EQ(dc.SelectObject(&none), nullptr);
    EXPECT_EQ(dc.SelectObject(static_cast<CPen*>(nullptr)), nullptr);
    EXPECT_EQ(dc.GetCurrentPen()->m_hObject, GetStockObject(BLACK_PEN));
}

TEST(SelectObject, KeepsDrawingWithAToolThatWasDeleted) {
    MemoryDc dc(4, 1);
    {
        CPen red(PS_SOLID, 1, RGB(255, 0, 0));
        dc.SelectObject(&red);
    }
    dc.MoveTo(0, 0);
    dc.LineTo(4, 0);
    EXPECT_EQ(dc.picture(), "rrrr\n");
    CPen blue(PS_SOLID, 1, RGB(0, 0, 255));
    CPen* old = dc.SelectObject(&blue);
    ASSERT_NE(old, nullptr) << "the usual way of putting the old tool back must still work";
    EXPECT_NE(dc.SelectObject(old), nullptr);
}

TEST(SelectObject, PutsABitmapIntoOneContextAtATime) {
    CBitmap bitmap;
    bitmap.CreateBitmap(3, 3, 1, 32, nullptr);
    CDC first, second;
    first.CreateCompatibleDC(nullptr);
    second.CreateCompatibleDC(nullptr);
    CBitmap* old = first.SelectObject(&bitmap);
    ASSERT_NE(old, nullptr);
    EXPECT_EQ(second.SelectObject(&bitmap), nullptr);
    first.SelectObject(old);
    EXPECT_NE(second.SelectObject(&bitmap), nullptr);
    second.DeleteDC();
    EXPECT_NE(first.SelectObject(&bitmap), nullptr) << "free again with its context's end";
}

TEST(SaveDc, GoesBackToAnyState) {
    MemoryDc dc;
    dc.SetTextColor(RGB(1, 0, 0));
    const int first = dc.SaveDC();
    dc.SetTextColor(RGB(2, 0, 0));
    dc.SetMapMode(MM_TWIPS);
    dc.SelectStockObject(NULL_PEN);
    dc.SaveDC();
    dc.SetTextColor(RGB(3, 0, 0));
    dc.MoveTo(5, 5);
    dc.IntersectClipRect(0, 0, 1, -1);
    EXPECT_FALSE(dc.RestoreDC(0));
    EXPECT_FALSE(dc.RestoreDC(3));
    EXPECT_FALSE(dc.RestoreDC(-3));
    EXPECT_TRUE(dc.RestoreDC(-1));
    EXPECT_EQ(dc.GetTextColor(), RGB(2, 0, 0));
    EXPECT_EQ(dc.GetCurrentPosition(), CPoint(0, 0));
    EXPECT_TRUE(dc.RestoreDC(first));
    EXPECT_EQ(dc.GetTextColor(), RGB(1, 0, 0));
    EXPECT_EQ(dc.GetMapMode(), MM_TEXT);
    EXPECT_EQ(dc.GetCurrentPen()->m_hObject, GetStockObject(BLACK_PEN));
    EXPECT_FALSE(dc.RestoreDC(-1));
}

TEST(Bitmap, DescribesItself) {
    CBitmap mono, color;
    EXPECT_FALSE(mono.CreateBitmap(0, 5, 1, 1, nullptr));
    EXPECT_FALSE(mono.CreateBitmap(5, 5, 1, 8, nullptr));
    EXPECT_FALSE(mono.CreateBitmap(1 << 20, 1 << 20, 1, 32, nullptr));
    ASSERT_TRUE(mono.CreateBitmap(17, 3, 1, 1, nullptr));
    ASSERT_TRUE(color.CreateBitmap(332, 260, 1, 32, nullptr));
    BITMAP record;
    ASSERT_TRUE(mono.GetBitmap(&record));
    EXPECT_EQ(record.bmWidthBytes, 4);
    EXPECT_EQ(record.bmBitsPixel, 1);
    ASSERT_TRUE(color.GetBitmap(&record));
    EXPECT_EQ(CSize(record.bmWidth, record.bmHeight), CSize(332, 260));
    EXPECT_EQ(record.bmBitsPixel, 32);
    EXPECT_EQ(color.GetObject(8, &record), 8) << "a short buffer gets the beginning";
}

TEST(Bitmap, GivesAndTakesBits) {
    const std::array<BYTE, 6> bits = {0xA5, 0x80, 0x3C, 0x00, 0xFF, 0x80};
    CBitmap mono;
    ASSERT_TRUE(mono.CreateBitmap(9, 3, 1, 1, bits.data()));
    MemoryDc dc(9, 3);
    CDC source;
    source.CreateCompatibleDC(&dc);
    source.SelectObject(&mono);
    dc.BitBlt(0, 0, 9, 3, &source, 0, 0, SRCCOPY);
    EXPECT_EQ(dc.picture(), ".#.##.#..\n"
                            "##....###\n"
                            ".........\n");
    std::array<BYTE, 8> read{};
    EXPECT_EQ(mono.GetBitmapBits(read.size(), read.data()), bits.size());
    EXPECT_TRUE(std::equal(bits.begin(), bits.end(), read.begin()));
    const BYTE firstByte = 0x5A;
    EXPECT_EQ(mono.SetBitmapBits(1, &firstByte), 1U);
    mono.GetBitmapBits(read.size(), read.data());
    EXPECT_EQ(read[0], 0x5A);
    EXPECT_EQ(read[2], 0x3C) << "what lies behind stays";
}

TEST(Bitmap, IsCompatibleWithItsContext) {
    MemoryDc color, mono(8, 8, 1);
    CDC fresh;
    fresh.CreateCompatibleDC(nullptr);
    CBitmap fromColor, fromMono, fromFresh;
    BITMAP record;
    ASSERT_TRUE(fromColor.CreateCompatibleBitmap(&color, 2, 2));
    ASSERT_TRUE(fromMono.CreateCompatibleBitmap(&mono, 2, 2));
    ASSERT_TRUE(fromFresh.CreateCompatibleBitmap(&fresh, 2, 2));
    fromColor.GetBitmap(&record);
    EXPECT_EQ(record.bmBitsPixel, 32);
    fromMono.GetBitmap(&record);
    EXPECT_EQ(record.bmBitsPixel, 1);
    fromFresh.GetBitmap(&record);
    EXPECT_EQ(record.bmBitsPixel, 1) << "a fresh memory context has a monochrome pixel selected";
    EXPECT_EQ(mono.GetDeviceCaps(BITSPIXEL), 1);
    EXPECT_EQ(color.GetDeviceCaps(LOGPIXELSX), 96);
    EXPECT_EQ(color.GetDeviceCaps(HORZRES), GetSystemMetrics(SM_CXSCREEN));
}

TEST(SystemColors, FollowThePalette) {
    const QPalette before = QApplication::palette();
    const HBRUSH brush = GetSysColorBrush(COLOR_HIGHLIGHT);
    QPalette palette = before;
    palette.setColor(QPalette::Highlight, QColor(255, 0, 0));
    QApplication::setPalette(palette);
    EXPECT_EQ(GetSysColor(COLOR_HIGHLIGHT), RGB(255, 0, 0));
    MemoryDc dc(2, 1);
    const RECT all = {0, 0, 2, 1};
    FillRect(dc, &all, brush);
    EXPECT_EQ(dc.picture(), "rr\n");
    const RECT one = {0, 0, 1, 1};
    dc.PatBlt(0, 0, 2, 1, WHITENESS);
    FillRect(dc, &one, reinterpret_cast<HBRUSH>(static_cast<std::uintptr_t>(COLOR_HIGHLIGHT + 1)));
    EXPECT_EQ(dc.picture(), "r.\n");
    QApplication::setPalette(before);
    EXPECT_EQ(GetSysColor(-1), 0U);
    EXPECT_EQ(GetSysColorBrush(99), nullptr);
    for (int i = 0; i <= 1; ++i) {
        EXPECT_GT(GetSystemMetrics(i), 0);
    }
}

TEST(Region, CombinesAreas) {
    CRgn left, right, result;
    left.CreateRectRgn(0, 0, 10, 10);
    right.CreateRectRgn(5, 0, 15, 10);
    result.CreateRectRgn(0, 0, 0, 0);
    RECT box;
    EXPECT_EQ(result.GetRgnBox(&box), NULLREGION);
    EXPECT_EQ(result.CombineRgn(&left, &right, RGN_AND), SIMPLEREGION);
    result.GetRgnBox(&box);
    EXPECT_EQ(CRect(box), CRect(5, 0, 10, 10));
    EXPECT_EQ(result.CombineRgn(&left, &right, RGN_XOR), COMPLEXREGION);
    EXPECT_FALSE(result.PtInRegion(7, 5));
    EXPECT_TRUE(result.PtInRegion(14, 9));
    EXPECT_FALSE(result.PtInRegion(15, 9));
    CRgn none;
    EXPECT_EQ(none.CombineRgn(&left, &right, RGN_OR), RGN_ERROR);
    EXPECT_EQ(none.OffsetRgn(1, 1), RGN_ERROR);
}

TEST(Region, IsMovedReplacedAndFilled) {
    CRgn region;
    const CRect start(2, 2, 6, 6);
    ASSERT_TRUE(region.CreateRectRgnIndirect(&start));
    EXPECT_EQ(region.OffsetRgn(-2, 1), SIMPLEREGION);
    const CRect touching(4, 3, 9, 9), crossing(3, 3, 9, 9);
    EXPECT_FALSE(region.RectInRegion(&touching)) << "right edges do not belong to it";
    EXPECT_TRUE(region.RectInRegion(&crossing));
    MemoryDc dc(8, 5);
    CBrush red(RGB(255, 0, 0)), blue(RGB(0, 0, 255));
    dc.SetWindowOrg(3, 3); // regions are in device units, whatever the mapping
    EXPECT_TRUE(dc.FillRgn(&region, &red));
    region.SetRectRgn(7, 2, 5, 0);
    EXPECT_TRUE(dc.FillRgn(&region, &blue));
    EXPECT_EQ(dc.picture(), ".....bb.\n"
                            ".....bb.\n"
                            "........\n"
                            "rrrr....\n"
                            "rrrr....\n");
    CRgn triangle;
    EXPECT_FALSE(dc.FillRgn(&triangle, &red));
    const POINT corners[] = {{0, 0}, {8, 0}, {0, 8}};
    EXPECT_FALSE(triangle.CreatePolygonRgn(corners, 1, ALTERNATE));
    ASSERT_TRUE(triangle.CreatePolygonRgn(corners, 3, ALTERNATE));
    EXPECT_TRUE(triangle.PtInRegion(3, 3));
    EXPECT_FALSE(triangle.PtInRegion(5, 5));
}

} // namespace
