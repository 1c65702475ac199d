#include "platform/afx/gdi/Gdi.h"
#include "platform/afx/gdi/detail/DeviceContext.h"
#include "platform/afx/toolkit/detail/Gui.h"
#include "platform/win/ExtensionModule.h"
#include "platform/win/Picture.h"
#include "platform/win/Resource.h"

#include <QApplication>
#include <QIcon>
#include <QStyle>

#include <cstdlib>
#include <cstring>
#include <map>
#include <string>
#include <vector>

using namespace tvx::afx;

// Bitmaps from resources and device-independent bits

namespace {

HBITMAP addPicture(const tvx::Picture& picture) {
    const QImage pixels(reinterpret_cast<const uchar*>(picture.pixels.data()), picture.width, picture.height,
                        picture.width * 4, QImage::Format_RGB32);
    return addBitmap(pixels, picture.bitsPerPixel == 1 ? PixelFormat::Monochrome : PixelFormat::Color);
}

std::size_t paletteBytes(const BITMAPINFOHEADER& header) {
    if (header.biBitCount > 8) {
        return 0;
    }
    const std::size_t colors = header.biClrUsed ? header.biClrUsed : std::size_t{1} << header.biBitCount;
    return colors * sizeof(RGBQUAD);
}

std::size_t pixelBytes(const BITMAPINFOHEADER& header) {
    const std::int64_t row = (std::int64_t{header.biWidth} * header.biBitCount + 31) / 32 * 4;
    return static_cast<std::size_t>(row * std::abs(std::int64_t{header.biHeight}));
}

bool understood(const BITMAPINFOHEADER& header) {
    const bool depth = header.biBitCount == 1 || header.biBitCount == 4 || header.biBitCount == 8 ||
                       header.biBitCount == 16 || header.biBitCount == 24 || header.biBitCount == 32;
    constexpr LONG largest = 1 << 15;
    return header.biSize == sizeof(BITMAPINFOHEADER) && depth && header.biCompression == BI_RGB && header.biWidth > 0 &&
           header.biWidth <= largest && header.biHeight != 0 && header.biHeight <= largest &&
           header.biHeight >= -largest && header.biClrUsed <= 256;
}

} // namespace

HBITMAP CreateDIBitmap(HDC dc, const BITMAPINFOHEADER* header, DWORD initialise, LPCVOID bits, const BITMAPINFO* info,
                       UINT usage) {
    if (!header || !understood(*header) || usage != DIB_RGB_COLORS || (dc && !findContext(dc))) {
        return nullptr;
    }
    if ((initialise & CBM_INIT) == 0) {
        return addBitmap(header->biWidth, std::abs(header->biHeight), PixelFormat::Color);
    }
    if (!bits || !info || !understood(info->bmiHeader)) {
        return nullptr;
    }
    const BITMAPINFOHEADER& layout = info->bmiHeader;
    const std::size_t head = sizeof(BITMAPINFOHEADER) + paletteBytes(layout);
    std::vector<std::uint8_t> packed(head + pixelBytes(layout));
    std::memcpy(packed.data(), info, head);
    std::memcpy(packed.data() + head, bits, packed.size() - head);
    auto picture = tvx::parseBitmap(packed);
    if (!picture) {
        return nullptr;
    }
    // A bitmap in the format of the screen, however few colours its bits have.
    picture->bitsPerPixel = 32;
    return addPicture(*picture);
}

HBITMAP LoadBitmapA(HINSTANCE module, LPCSTR name) {
    if (!module) {
        module = AfxFindResourceHandle(name, RT_BITMAP);
    }
    const auto picture = tvx::loadBitmapPicture(module, name);
    return picture ? addPicture(*picture) : nullptr;
}

BOOL CBitmap::LoadBitmap(LPCSTR name) {
    return Attach(LoadBitmapA(AfxFindResourceHandle(name, RT_BITMAP), name));
}

BOOL CBitmap::LoadBitmap(UINT id) {
    return LoadBitmap(MAKEINTRESOURCE(id));
}

// Icons

namespace {

constexpr int firstPredefined = 32512;

/// The desktop's own pictures for the predefined icons, in the order of their numbers. The first stands for an
/// application; the style's picture for that is the toolkit's logo, so a plain sheet takes its place.
constexpr QStyle::StandardPixmap predefinedPictures[] = {
    QStyle::SP_FileIcon,          QStyle::SP_MessageBoxCritical,    QStyle::SP_MessageBoxQuestion,
    QStyle::SP_MessageBoxWarning, QStyle::SP_MessageBoxInformation,
};

HICON loadPredefined(LPCSTR name) {
    const std::size_t index = reinterpret_cast<std::uintptr_t>(name) - firstPredefined;
    if (index >= std::size(predefinedPictures) || !ensureGui()) {
        return nullptr;
    }
    const QIcon icon = QApplication::style()->standardIcon(predefinedPictures[index]);
    const int size = GetSystemMetrics(SM_CXICON);
    return addIcon(icon.pixmap(QSize(size, size), 1.0).toImage());
}

HICON loadFromModule(HINSTANCE module, LPCSTR name) {
    const auto picture = tvx::loadIconPicture(module, name, GetSystemMetrics(SM_CXICON));
    if (!picture) {
        return nullptr;
    }
    const QImage pixels(reinterpret_cast<const uchar*>(picture->pixels.data()), picture->width, picture->height,
                        picture->width * 4, QImage::Format_ARGB32);
    return addIcon(pixels.copy());
}

std::string keyOf(HINSTANCE module, LPCSTR name) {
    const std::string own =
        IS_INTRESOURCE(name) ? '#' + std::to_string(reinterpret_cast<std::uintptr_t>(name)) : std::string(name);
    return std::to_string(reinterpret_cast<std::uintptr_t>(module)) + ':' + own;
}

} // namespace

HICON LoadIconA(HINSTANCE module, LPCSTR name) {
    static auto& shared = *new std::map<std::string, HICON>;
    HICON& icon = shared[keyOf(module, name)];
    // A host may have destroyed the shared icon; then it is loaded again.
    if (iconImage(icon).isNull()) {
        icon = module ? loadFromModule(module, name) : loadPredefined(name);
    }
    return icon;
}
