#include "platform/afx/controls/ImageList.h"

#include "platform/afx/controls/detail/ImageListData.h"
#include "platform/afx/gdi/detail/DeviceContext.h"

#include <QPainter>

#include <algorithm>
#include <utility>

namespace tvx::afx {

namespace {

constexpr std::uint32_t listTag = 12;

/// A part of a bitmap, its pixels of one colour made transparent.
QImage pictureOf(const QImage& bitmap, const QRect& place, COLORREF mask) {
    QImage picture = bitmap.copy(place).convertToFormat(QImage::Format_ARGB32);
    for (int y = 0; mask != CLR_NONE && y < picture.height(); ++y) {
        auto* line = reinterpret_cast<QRgb*>(picture.scanLine(y));
        std::replace(line, line + picture.width(), QRgb{pixelOf(mask)}, QRgb{0});
    }
    return picture;
}

/// Answers the index of the first one, -1 when there is none.
int addPictures(ImageListData& list, HBITMAP bitmap, COLORREF mask) {
    const QImage row = bitmapImage(bitmap);
    const int count = row.height() < list.size.height() ? 0 : row.width() / list.size.width();
    const auto first = static_cast<int>(list.images.size());
    for (int i = 0; i < count; ++i) {
        list.images.push_back(pictureOf(row, {QPoint(i * list.size.width(), 0), list.size}, mask));
    }
    return count > 0 ? first : -1;
}

HIMAGELIST addList(QSize size, CImageList& owner) {
    if (size.isEmpty()) {
        return nullptr;
    }
    auto list = std::make_shared<ImageListData>();
    list->size = size;
    list->owner = &owner;
    return reinterpret_cast<HIMAGELIST>(imageLists().add(std::move(list)));
}

const QImage* find(const ImageListData* list, int index) {
    const bool exists = list && index >= 0 && std::cmp_less(index, list->images.size());
    return exists ? &list->images[static_cast<std::size_t>(index)] : nullptr;
}

} // namespace

HandleTable<ImageListData>& imageLists() {
    // Never destroyed: static objects of hosts still hold lists when the process ends.
    static auto& table = *new HandleTable<ImageListData>(listTag);
    return table;
}

std::shared_ptr<ImageListData> findImageList(HIMAGELIST list) {
    return imageLists().find(reinterpret_cast<std::uintptr_t>(list));
}

QPixmap imageOf(HIMAGELIST list, int index) {
    const auto data = findImageList(list);
    const QImage* image = find(data.get(), index);
    return image ? QPixmap::fromImage(*image) : QPixmap();
}

QSize imageSizeOf(HIMAGELIST list) {
    const auto data = findImageList(list);
    return data ? data->size : QSize();
}

bool drawImage(HIMAGELIST list, int index, HDC handle, POINT place, UINT style) {
    const auto data = findImageList(list);
    const QImage* image = find(data.get(), index);
    const auto dc = findContext(handle);
    if (!image || !dc) {
        return false;
    }
    Drawing drawing(*dc);
    if (!drawing) {
        return true;
    }
    // As icons, pictures keep their size in every mapping mode.
    const QPoint corner = dc->state.mapping.toPixel(QPoint(place.x, place.y));
    const QRect area = drawing.canvas.pixels(QRect(corner, image->size()));
    QPainter painter(drawing.canvas.image);
    painter.setClipRegion(drawing.canvas.clip);
    if (data->background != CLR_NONE && (style & ILD_TRANSPARENT) == 0) {
        painter.fillRect(area, QColor::fromRgb(pixelOf(data->background)));
    }
    painter.drawImage(area, *image);
    drawing.canvas.touch(area);
    return true;
}

} // namespace tvx::afx

using namespace tvx::afx;

IMPLEMENT_DYNAMIC(CImageList, CObject)

CImageList::~CImageList() {
    DeleteImageList();
}

BOOL CImageList::Create(LPCSTR name, int width, int grow, COLORREF mask) {
    CBitmap bitmap;
    BITMAP description{};
    if (!bitmap.LoadBitmap(name) || !bitmap.GetBitmap(&description) ||
        !Create(width, description.bmHeight, ILC_COLOR32 | (mask == CLR_NONE ? 0U : ILC_MASK), 0, grow)) {
        return FALSE;
    }
    return Add(&bitmap, mask) >= 0 || !DeleteImageList();
}

BOOL CImageList::Create(int width, int height, UINT /*flags*/, int /*initial*/, int /*grow*/) {
    if (m_hImageList) {
        return FALSE;
    }
    m_hImageList = addList(QSize(width, height), *this);
    return m_hImageList != nullptr;
}

BOOL CImageList::DeleteImageList() {
    const HIMAGELIST list = std::exchange(m_hImageList, nullptr);
    return imageLists().take(reinterpret_cast<std::uintptr_t>(list)) != nullptr;
}

CImageList* CImageList::FromHandle(HIMAGELIST list) {
    const auto data = findImageList(list);
    return data ? data->owner : nullptr;
}

int CImageList::Add(CBitmap* bitmap, COLORREF mask) {
    const auto data = findImageList(m_hImageList);
    return data && bitmap ? addPictures(*data, *bitmap, mask) : -1;
}

int CImageList::GetImageCount() const {
    const auto data = findImageList(m_hImageList);
    return data ? static_cast<int>(data->images.size()) : 0;
}

BOOL CImageList::GetImageInfo(int index, IMAGEINFO* info) const {
    const auto data = findImageList(m_hImageList);
    if (!info || !find(data.get(), index)) {
        return FALSE;
    }
    const int left = index * data->size.width();
    *info = IMAGEINFO{nullptr, nullptr, 0, 0, {left, 0, left + data->size.width(), data->size.height()}};
    return TRUE;
}

BOOL CImageList::Draw(CDC* dc, int index, POINT place, UINT style) {
    return dc && drawImage(m_hImageList, index, dc->m_hDC, place, style);
}

COLORREF CImageList::SetBkColor(COLORREF color) {
    const auto data = findImageList(m_hImageList);
    return data ? std::exchange(data->background, color) : CLR_NONE;
}

COLORREF CImageList::GetBkColor() const {
    const auto data = findImageList(m_hImageList);
    return data ? data->background : CLR_NONE;
}
