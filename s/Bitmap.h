#pragma once

#include "afxwin.h"
#include "s/Export.h"

/// A bitmap that draws itself, and the loader of bitmap files.
///
/// @code
/// Gui_Bitmap picture;
/// picture.LoadBitmap("CDSPLASHBMP");
/// picture.Draw(&dc, 0, 0, SRCCOPY);
///
/// HBITMAP handle = nullptr;
/// Gui_Bitmap::LoadError error;
/// if (Gui_Bitmap::LoadBitmapFromFile(handle, name, nullptr, &error))
///     picture.Attach(handle); // deleted with the object
/// @endcode
///
/// It adds no data to CBitmap and owns the bitmap it holds.
class GUI_API Gui_Bitmap : public CBitmap {
public:
    /// How loading a file ended.
    enum LoadError {
        Loaded = 0,
        CannotOpen = 1,   ///< the file cannot be opened
        TooShort = 2,     ///< the file ends before its palette or its pixels do
        NotSupported = 3, ///< no bitmap file, or one without a header of 40 bytes
        OutOfMemory = 4,
        CannotCreate = 5, ///< the platform refused the bitmap: impossible size, depth or compression
    };

    /// No bitmap yet.
    Gui_Bitmap();
    ~Gui_Bitmap() override;

    /// Width and height in pixels; 0 by 0 without a bitmap.
    CSize GetSize() const;

    /// Draws the whole bitmap, pixel for pixel.
    /// @param dc in any mapping mode; the picture stands upright in all of them
    /// @param x,y where its left top pixel goes, in logical units
    /// @param rop how it combines with what is there (SRCCOPY, SRCAND, ...)
    /// @return 1; 0 without a bitmap or context, and while the bitmap is selected into another context
    int Draw(CDC* dc, int x, int y, int rop);
    /// The same at a point.
    int Draw(CDC* dc, CPoint point, int rop);

    /// Loads a bitmap file: 1, 4 or 8 bits a pixel, not compressed, with a full colour table and the pixels directly
    /// behind it. Deeper ones end with TooShort. Memory is taken only for what the file really holds.
    /// @param bitmap   receives the new bitmap, which the caller deletes; null when loading failed
    /// @param fileName its name
    /// @param dc       the context that the bitmap is made for; null for that of the application's main window
    /// @param error    receives how it ended; may be null
    /// @return 1, or 0 when it failed
    static int LoadBitmapFromFile(HBITMAP& bitmap, const char* fileName, CDC* dc, LoadError* error);
};
