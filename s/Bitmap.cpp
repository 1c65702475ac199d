#include "s/Bitmap.h"

#include "platform/win/Files.h"
#include "s/BitmapFile.h"

#include <new>

Gui_Bitmap::Gui_Bitmap() = default;
Gui_Bitmap::~Gui_Bitmap() = default;

CSize Gui_Bitmap::GetSize() const {
    BITMAP description{};
    GetBitmap(&description);
    return {description.bmWidth, description.bmHeight};
}

int Gui_Bitmap::Draw(CDC* dc, CPoint point, int rop) {
    return Draw(dc, point.x, point.y, rop);
}

int Gui_Bitmap::Draw(CDC* dc, int x, int y, int rop) {
    CDC memory;
    if (!dc || !m_hObject || !memory.CreateCompatibleDC(dc)) {
        return 0;
    }
    CBitmap* old = memory.SelectObject(static_cast<CBitmap*>(this));
    if (!old) {
        return 0;
    }
    // Drawn in pixels: in modes whose y axis points upwards a size in logical units would put the picture above the
    // point, and in scaled ones it could be a pixel off.
    CPoint corner(x, y);
    dc->LPtoDP(&corner);
    const CSize size = GetSize();
    const int saved = dc->SaveDC();
    dc->SetMapMode(MM_TEXT);
    dc->SetViewportOrg(0, 0);
    dc->SetWindowOrg(0, 0);
    const BOOL drawn = dc->BitBlt(corner.x, corner.y, size.cx, size.cy, &memory, 0, 0, static_cast<DWORD>(rop));
    dc->RestoreDC(saved);
    memory.SelectObject(old);
    return drawn ? 1 : 0;
}

// Loading

namespace {

HBITMAP createFor(HDC dc, const BitmapFile& file) {
    const BITMAPINFO& info = file.header();
    return CreateDIBitmap(dc, &info.bmiHeader, CBM_INIT, file.bits.data(), &info, DIB_RGB_COLORS);
}

HBITMAP createBitmap(CDC* dc, const BitmapFile& file) {
    CWnd* main = dc ? nullptr : AfxGetMainWnd();
    if (!main) {
        return createFor(dc ? dc->GetSafeHdc() : nullptr, file);
    }
    CDC* screen = main->GetDC();
    const HBITMAP bitmap = createFor(screen ? screen->GetSafeHdc() : nullptr, file);
    main->ReleaseDC(screen);
    return bitmap;
}

Gui_Bitmap::LoadError load(HBITMAP& bitmap, const char* fileName, CDC* dc) {
    CFile file;
    // A pipe would keep the caller waiting, a device might never end.
    if (!fileName || tvx::fileKind(fileName) != tvx::FileKind::File ||
        !file.Open(fileName, CFile::modeRead | CFile::shareDenyNone)) {
        return Gui_Bitmap::CannotOpen;
    }
    BitmapFile read;
    const Gui_Bitmap::LoadError error = ReadBitmapFile(file, read);
    if (error != Gui_Bitmap::Loaded) {
        return error;
    }
    try {
        bitmap = read.isComplete() ? createBitmap(dc, read) : nullptr;
    } catch (const std::bad_alloc&) {
        return Gui_Bitmap::OutOfMemory;
    }
    return bitmap ? Gui_Bitmap::Loaded : Gui_Bitmap::CannotCreate;
}

} // namespace

int Gui_Bitmap::LoadBitmapFromFile(HBITMAP& bitmap, const char* fileName, CDC* dc, LoadError* error) {
    bitmap = nullptr;
    const LoadError result = load(bitmap, fileName, dc);
    if (error) {
        *error = result;
    }
    return result == Loaded ? 1 : 0;
}
