#pragma once

#include "afxwin.h"
#include "s/Bitmap.h"

#include <vector>

/// What is read of a bitmap file: the header and the colours as CreateDIBitmap takes them, and the pixels.
struct BitmapFile {
    std::vector<BYTE> info; ///< a BITMAPINFO with its whole colour table
    std::vector<BYTE> bits;

    /// The beginning of `info`, which must have been read.
    const BITMAPINFO& header() const {
        return *reinterpret_cast<const BITMAPINFO*>(info.data());
    }
    /// Whether the pixels that the header describes are all there.
    bool isComplete() const;
};

/// Reads a bitmap file from its beginning. Nothing is allocated that the file does not hold.
/// @return Loaded, TooShort, NotSupported or OutOfMemory
[[nodiscard]] Gui_Bitmap::LoadError ReadBitmapFile(CFile& file, BitmapFile& read);
