#pragma once

/// @file
/// What stands behind the handles of image lists.

#include "platform/afx/controls/ImageList.h"
#include "platform/afx/gdi/detail/HandleTable.h"

#include <QImage>
#include <QPixmap>
#include <QSize>

#include <memory>
#include <vector>

namespace tvx::afx {

struct ImageListData {
    QSize size; ///< of each picture, in pixels
    COLORREF background = CLR_NONE;
    std::vector<QImage> images; ///< Format_ARGB32
    CImageList* owner = nullptr;
};

[[nodiscard]] TVX_PLATFORM_API HandleTable<ImageListData>& imageLists();
/// Null for a handle that is no list (any more).
[[nodiscard]] TVX_PLATFORM_API std::shared_ptr<ImageListData> findImageList(HIMAGELIST list);
/// A picture as the toolkit draws it, null for a list or an index that does not exist.
[[nodiscard]] TVX_PLATFORM_API QPixmap imageOf(HIMAGELIST list, int index);
/// The size of the list's pictures, an empty one for a handle that is no list.
[[nodiscard]] TVX_PLATFORM_API QSize imageSizeOf(HIMAGELIST list);
/// As CImageList::Draw, for a context's handle.
TVX_PLATFORM_API bool drawImage(HIMAGELIST list, int index, HDC dc, POINT place, UINT style);

} // namespace tvx::afx
