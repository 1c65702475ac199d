/// @file
/// The common controls' library: what hosts find in it by name. The controls themselves are the layer's own and need no
/// loading; these are the calls for image lists, with which owners draw lines of lists.
///
///     const HMODULE module = LoadLibraryA("comctl32");
///     const auto draw = reinterpret_cast<BOOL (*)(HIMAGELIST, int, HDC, int, int, UINT)>(
///         GetProcAddress(module, "ImageList_Draw"));

#include "platform/afx/controls/detail/ImageListData.h"

#define TVX_ENTRY_POINT extern "C" __attribute__((visibility("default")))

/// As CImageList::SetBkColor; CLR_NONE for a handle that is no list.
TVX_ENTRY_POINT COLORREF ImageList_SetBkColor(HIMAGELIST list, COLORREF color) {
    CImageList* object = CImageList::FromHandle(list);
    return object ? object->SetBkColor(color) : CLR_NONE;
}

/// As CImageList::GetImageInfo; FALSE for a handle that is no list.
TVX_ENTRY_POINT BOOL ImageList_GetImageInfo(HIMAGELIST list, int index, IMAGEINFO* info) {
    const CImageList* object = CImageList::FromHandle(list);
    return object && object->GetImageInfo(index, info);
}

/// As CImageList::Draw; FALSE for a handle that is no list.
TVX_ENTRY_POINT BOOL ImageList_Draw(HIMAGELIST list, int index, HDC dc, int x, int y, UINT style) {
    return tvx::afx::drawImage(list, index, dc, {x, y}, style);
}
