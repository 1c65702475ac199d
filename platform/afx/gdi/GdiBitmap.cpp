#include "platform/afx/gdi/Dc.h"
#include "platform/afx/gdi/Gdi.h"
#include "platform/afx/gdi/detail/DeviceContext.h"

#include <algorithm>
#include <cstring>
#include <vector>

using namespace tvx::afx;

// Bitmaps and bits as hosts give them

namespace {

/// Leaves only the pixels that the host knows of: it reads or writes them by number.
void makePlain(BitmapObject& bitmap) {
    bitmap.image = bitmap.plainImage();
    bitmap.ratio = 1;
}

/// Rows of a bitmap as `GetBitmapBits` gives them: from the top, padded to even numbers of bytes.
std::size_t rowBytes(const BitmapObject& bitmap) {
    const std::size_t bits = bitmap.format == PixelFormat::Monochrome ? 1 : 32;
    return (static_cast<std::size_t>(bitmap.image.width()) * bits + 15) / 16 * 2;
}

void packRow(const BitmapObject& bitmap, int y, BYTE* bytes) {
    const auto* pixels = reinterpret_cast<const Pixel*>(bitmap.image.constScanLine(y));
    if (bitmap.format == PixelFormat::Color) {
        for (int x = 0; x < bitmap.image.width(); ++x) {
            // The fourth byte of a pixel is unused: hosts expect 0 there.
            const Pixel pixel = pixels[x] & ~opaque;
            std::memcpy(bytes + 4 * x, &pixel, sizeof pixel);
        }
        return;
    }
    std::fill_n(bytes, rowBytes(bitmap), BYTE{0});
    for (int x = 0; x < bitmap.image.width(); ++x) {
        if (pixels[x] == whitePixel) {
            bytes[x / 8] |= static_cast<BYTE>(0x80 >> (x % 8));
        }
    }
}

void unpackRow(BitmapObject& bitmap, int y, const BYTE* bytes) {
    auto* pixels = reinterpret_cast<Pixel*>(bitmap.image.scanLine(y));
    for (int x = 0; x < bitmap.image.width(); ++x) {
        if (bitmap.format == PixelFormat::Monochrome) {
            pixels[x] = (bytes[x / 8] & (0x80 >> (x % 8))) ? whitePixel : blackPixel;
        } else {
            std::memcpy(&pixels[x], bytes + 4 * x, sizeof(Pixel));
            pixels[x] |= opaque;
        }
    }
}

std::vector<BYTE> allBits(const BitmapObject& bitmap) {
    std::vector<BYTE> bits(rowBytes(bitmap) * static_cast<std::size_t>(bitmap.image.height()));
    for (int y = 0; y < bitmap.image.height(); ++y) {
        packRow(bitmap, y, bits.data() + static_cast<std::size_t>(y) * rowBytes(bitmap));
    }
    return bits;
}

} // namespace

HBITMAP CreateBitmap(int width, int height, UINT planes, UINT bitsPerPixel, LPCVOID bits) {
    if (planes != 1 || (bitsPerPixel != 1 && bitsPerPixel != 32)) {
        return nullptr;
    }
    const HBITMAP handle = addBitmap(width, height, bitsPerPixel == 1 ? PixelFormat::Monochrome : PixelFormat::Color);
    const auto bitmap = findTool<BitmapObject>(handle);
    if (bitmap && bits) {
        for (int y = 0; y < height; ++y) {
            unpackRow(*bitmap, y, static_cast<const BYTE*>(bits) + static_cast<std::size_t>(y) * rowBytes(*bitmap));
        }
    }
    return handle;
}

HBITMAP CreateCompatibleBitmap(HDC dc, int width, int height) {
    const auto context = findContext(dc);
    return context ? addBitmap(width, height, context->target->format(), context->target->ratio()) : nullptr;
}

BOOL CBitmap::CreateBitmap(int width, int height, UINT planes, UINT bitsPerPixel, LPCVOID bits) {
    return Attach(::CreateBitmap(width, height, planes, bitsPerPixel, bits));
}

BOOL CBitmap::CreateCompatibleBitmap(CDC* dc, int width, int height) {
    return Attach(::CreateCompatibleBitmap(dc ? dc->m_hDC : nullptr, width, height));
}

BOOL CBitmap::GetBitmap(BITMAP* description) const {
    return GetObject(sizeof(BITMAP), description) != 0;
}

DWORD CBitmap::GetBitmapBits(DWORD count, LPVOID bits) const {
    const auto bitmap = findTool<BitmapObject>(m_hObject);
    if (!bitmap || !bits) {
        return 0;
    }
    BitmapObject plain = *bitmap;
    makePlain(plain);
    const std::vector<BYTE> all = allBits(plain);
    const std::size_t copied = std::min<std::size_t>(count, all.size());
    std::memcpy(bits, all.data(), copied);
    return static_cast<DWORD>(copied);
}

DWORD CBitmap::SetBitmapBits(DWORD count, LPCVOID bits) {
    const auto bitmap = findTool<BitmapObject>(m_hObject);
    if (!bitmap || !bits) {
        return 0;
    }
    makePlain(*bitmap);
    std::vector<BYTE> all = allBits(*bitmap);
    const std::size_t copied = std::min<std::size_t>(count, all.size());
    std::memcpy(all.data(), bits, copied);
    for (int y = 0; y < bitmap->image.height(); ++y) {
        unpackRow(*bitmap, y, all.data() + static_cast<std::size_t>(y) * rowBytes(*bitmap));
    }
    return static_cast<DWORD>(copied);
}

// Icons

BOOL DestroyIcon(HICON icon) {
    return icons().take(reinterpret_cast<std::uintptr_t>(icon)) != nullptr;
}

HICON CopyIcon(HICON icon) {
    const auto source = icons().find(reinterpret_cast<std::uintptr_t>(icon));
    return source ? addIcon(source->image, source->hotSpot) : nullptr;
}
