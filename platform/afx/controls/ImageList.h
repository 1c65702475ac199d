#pragma once

/// @file
/// Lists of small pictures of one size, which trees and owner-drawn lists show beside their lines.

#include "platform/afx/gdi/Dc.h"
#include "platform/base/Export.h"
#include "platform/base/Object.h"

DECLARE_HANDLE(HIMAGELIST);

// What a list is made with. Pictures have the colours of the desktop here, whatever is asked for.
#define ILC_MASK 0x0001 ///< Has transparent pixels.
#define ILC_COLOR4 0x0004
#define ILC_COLOR24 0x0018
#define ILC_COLOR32 0x0020

// How a picture is drawn
#define ILD_NORMAL 0x0000      ///< On the list's background colour, where it has one.
#define ILD_TRANSPARENT 0x0001 ///< On what is there already.

#define CLR_NONE 0xFFFFFFFFU ///< No background colour: transparent pixels stay what they were.

/// Where a picture is kept.
struct IMAGEINFO {
    HBITMAP hbmImage; ///< Always null: pictures are not kept in bitmaps here.
    HBITMAP hbmMask;  ///< Always null.
    int Unused1;
    int Unused2;
    RECT rcImage; ///< The place of the picture in a row of all of them; what counts is its size.
};

/// A list of pictures of one size, known by a handle. The object owns the list and destroys it at its end. A control
/// that shows the pictures keeps the handle only: the list must live as long as the control shows them.
///
/// @code
/// CImageList folders;
/// folders.Create("FOLDERS", 16, 1, RGB(0, 0, 255)); // a row of pictures, 16 pixels wide each; blue is transparent
/// folders.Draw(&dc, 1, CPoint(4, 4), ILD_TRANSPARENT);
/// @endcode
class TVX_PLATFORM_API CImageList : public CObject {
    DECLARE_DYNAMIC(CImageList)

public:
    /// Holds nothing until `Create`.
    CImageList() = default;
    /// Destroys the list it holds.
    ~CImageList() override;

    /// The handle; null when nothing is held. For reading only.
    HIMAGELIST m_hImageList = nullptr;

    /// Makes a list of a bitmap resource that holds pictures in a row.
    /// @param width of one picture, in pixels; their height is the bitmap's
    /// @param grow  not used
    /// @param mask  the colour of transparent pixels; CLR_NONE: there are none
    /// @return FALSE when there is no such bitmap, it is narrower than a picture, or a list is held already
    BOOL Create(LPCSTR bitmap, int width, int grow, COLORREF mask);
    BOOL Create(UINT bitmapId, int width, int grow, COLORREF mask) {
        return Create(MAKEINTRESOURCE(bitmapId), width, grow, mask);
    }
    /// Makes an empty list.
    /// @param flags   ILC_...
    /// @param initial,grow not used
    /// @return FALSE for sizes below 1, and when a list is held already
    BOOL Create(int width, int height, UINT flags, int initial, int grow);
    /// Destroys the list. FALSE when none is held.
    BOOL DeleteImageList();

    /// The handle, null when nothing is held.
    HIMAGELIST GetSafeHandle() const {
        return m_hImageList;
    }
    /// The object that holds `list`; null for a handle that is no list (any more).
    static CImageList* FromHandle(HIMAGELIST list);

    /// Adds the pictures of a bitmap, which lie in a row, as wide as the list's.
    /// @param mask the colour of transparent pixels; CLR_NONE: there are none
    /// @return the index of the first one, -1 on failure
    int Add(CBitmap* bitmap, COLORREF mask);
    /// Number of pictures.
    int GetImageCount() const;
    /// The size of a picture, in `info->rcImage`. FALSE for an index that does not exist.
    BOOL GetImageInfo(int index, IMAGEINFO* info) const;

    /// Draws a picture.
    /// @param style ILD_...
    /// @return FALSE for an index that does not exist, and without a context
    BOOL Draw(CDC* dc, int index, POINT place, UINT style);
    /// The colour that pictures are drawn on with ILD_NORMAL; CLR_NONE for none, as at first. The result is the one
    /// before.
    COLORREF SetBkColor(COLORREF color);
    COLORREF GetBkColor() const;
};
