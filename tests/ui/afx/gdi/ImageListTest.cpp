#include "platform/afx/controls/ImageList.h"
#include "platform/afx/controls/detail/ImageListData.h"
#include "platform/afx/gdi/Gdi.h"
#include "platform/win/Module.h"
#include "platform/win/ResourceLibrary.h"

#include <gtest/gtest.h>

namespace {

constexpr COLORREF blue = RGB(0, 0, 255);
constexpr COLORREF red = RGB(255, 0, 0);
constexpr COLORREF green = RGB(0, 255, 0);

/// A memory context of 8 by 4 pixels, green at first.
class ImageList : public testing::Test {
protected:
    ImageList() {
        dc.CreateCompatibleDC(nullptr);
        canvas.CreateBitmap(8, 4, 1, 32, nullptr);
        dc.SelectObject(&canvas);
        dc.FillSolidRect(CRect(0, 0, 8, 4), green);
        // Two pictures of 2 by 2: one red, one red on its left and transparent on its right.
        const DWORD pixels[] = {0xFF0000, 0xFF0000, 0xFF0000, 0x0000FF, 0xFF0000, 0xFF0000, 0xFF0000, 0x0000FF};
        row.CreateBitmap(4, 2, 1, 32, pixels);
    }
    CDC dc;
    CBitmap canvas;
    CBitmap row;
    CImageList list;
};

} // namespace

TEST_F(ImageList, DrawsItsPicturesThroughTheirMask) {
    ASSERT_TRUE(list.Create(2, 2, ILC_COLOR24 | ILC_MASK, 0, 1));
    EXPECT_FALSE(list.Create(2, 2, ILC_COLOR24, 0, 1));
    EXPECT_EQ(list.Add(&row, blue), 0);
    EXPECT_EQ(list.Add(&row, CLR_NONE), 2);
    EXPECT_EQ(list.GetImageCount(), 4);
    EXPECT_EQ(CImageList::FromHandle(list.GetSafeHandle()), &list);
    EXPECT_EQ(tvx::afx::imageSizeOf(list.GetSafeHandle()), QSize(2, 2));
    EXPECT_TRUE(tvx::afx::imageOf(list.GetSafeHandle(), 4).isNull());
    EXPECT_TRUE(list.Draw(&dc, 1, CPoint(2, 1), ILD_NORMAL));
    EXPECT_EQ(dc.GetPixel(2, 1), red);
    EXPECT_EQ(dc.GetPixel(3, 1), green);
    EXPECT_EQ(dc.GetPixel(4, 1), green);
    EXPECT_EQ(list.SetBkColor(RGB(1, 2, 3)), CLR_NONE);
    EXPECT_EQ(list.GetBkColor(), RGB(1, 2, 3));
    EXPECT_TRUE(list.Draw(&dc, 1, CPoint(2, 1), ILD_TRANSPARENT));
    EXPECT_EQ(dc.GetPixel(3, 1), green);
    EXPECT_TRUE(list.Draw(&dc, 1, CPoint(2, 1), ILD_NORMAL));
    EXPECT_EQ(dc.GetPixel(3, 1), RGB(1, 2, 3));
    EXPECT_TRUE(list.Draw(&dc, 3, CPoint(2, 1), ILD_NORMAL));
    EXPECT_EQ(dc.GetPixel(3, 1), blue);
    EXPECT_FALSE(list.Draw(&dc, 4, CPoint(0, 0), ILD_NORMAL));
    EXPECT_FALSE(list.Draw(nullptr, 0, CPoint(0, 0), ILD_NORMAL));
    const HIMAGELIST gone = list.GetSafeHandle();
    EXPECT_TRUE(list.DeleteImageList());
    EXPECT_FALSE(list.DeleteImageList());
    EXPECT_EQ(CImageList::FromHandle(gone), nullptr);
    EXPECT_EQ(list.Add(&row, blue), -1);
    EXPECT_FALSE(list.Create("NONE", 2, 1, blue));
}

TEST_F(ImageList, IsReachedThroughTheCommonControlsLibrary) {
    list.Create(2, 2, ILC_COLOR24, 0, 1);
    list.Add(&row, blue);
    const HMODULE module = LoadLibraryA("comctl32.dll");
    ASSERT_TRUE(module);
    const auto setBkColor =
        reinterpret_cast<COLORREF (*)(HIMAGELIST, COLORREF)>(GetProcAddress(module, "ImageList_SetBkColor"));
    const auto getInfo =
        reinterpret_cast<BOOL (*)(HIMAGELIST, int, IMAGEINFO*)>(GetProcAddress(module, "ImageList_GetImageInfo"));
    const auto draw =
        reinterpret_cast<BOOL (*)(HIMAGELIST, int, HDC, int, int, UINT)>(GetProcAddress(module, "ImageList_Draw"));
    IMAGEINFO info{};
    EXPECT_TRUE(getInfo(list.GetSafeHandle(), 1, &info));
    EXPECT_EQ(CRect(info.rcImage), CRect(2, 0, 4, 2));
    EXPECT_FALSE(getInfo(list.GetSafeHandle(), 2, &info) || getInfo(nullptr, 0, &info));
    EXPECT_EQ(setBkColor(list.GetSafeHandle(), red), CLR_NONE);
    EXPECT_EQ(setBkColor(nullptr, red), CLR_NONE);
    EXPECT_TRUE(draw(list.GetSafeHandle(), 1, dc.m_hDC, 0, 0, ILD_NORMAL));
    EXPECT_EQ(dc.GetPixel(1, 0), red);
    EXPECT_FALSE(draw(nullptr, 0, dc.m_hDC, 0, 0, ILD_NORMAL));
    FreeLibrary(module);
}
