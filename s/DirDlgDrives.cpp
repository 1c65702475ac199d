// The list of drives of the directory dialog.
#include "res/resource.h"
#include "s/DirDlgRecord.h"

#include <algorithm>

namespace {

constexpr UINT imageBits = 0xF; ///< of an entry's data
constexpr int roomAbove = 2;    ///< pixels

/// The image of a kind of drives.
int imageOf(UINT type) {
    switch (type) {
    case DRIVE_REMOVABLE:
        return 4;
    case DRIVE_REMOTE:
        return 6;
    case DRIVE_CDROM:
        return 3;
    case DRIVE_RAMDISK:
        return 5;
    default:
        return 7;
    }
}

/// The kind of the drive of a name. A share is of another machine, also one that is not connected.
UINT typeOf(const Gui_FileName& name) {
    const CString root = name.GetMountAndPath(0);
    return root.Left(2) == "\\\\" ? DRIVE_REMOTE : GetDriveTypeA(root);
}

/// The height of entries: text or image, and the room above that they are drawn with, below too.
int entryHeight(CWnd& list, int imageHeight) {
    CClientDC dc(&list);
    CFont* before = dc.SelectObject(list.GetFont());
    const int textHeight = dc.GetTextExtent("X").cy;
    dc.SelectObject(before);
    return std::max(textHeight, imageHeight) + 2 * roomAbove;
}

template <class Function>
void find(HMODULE module, LPCSTR name, Function& function) {
    function = reinterpret_cast<Function>(GetProcAddress(module, name));
}

} // namespace

ImageListFunctions::ImageListFunctions() : module(LoadLibraryA("comctl32")) {
    if (module) {
        find(module, "ImageList_SetBkColor", setBkColor);
        find(module, "ImageList_GetImageInfo", getImageInfo);
        find(module, "ImageList_Draw", draw);
    }
}

ImageListFunctions::~ImageListFunctions() {
    if (module) {
        FreeLibrary(module);
    }
}

void Gui_DirDlg::fillDrives() {
    IMAGEINFO info{};
    m_record->driveImages.GetImageInfo(0, &info);
    drives().SetItemHeight(0, static_cast<UINT>(entryHeight(drives(), CRect(info.rcImage).Height())));
    bool exists[26]{};
    CString entry;
    drives().ResetContent();
    drives().Dir(DDL_DRIVES | DDL_EXCLUSIVE, "*");
    for (int i = 0; i < drives().GetCount(); ++i) {
        drives().GetLBText(i, entry); // "[-c-]"
        const int letter = entry.MakeUpper().GetLength() > 2 ? entry[2] - 'A' : -1;
        if (letter >= 0 && letter < 26) {
            exists[letter] = true;
        }
    }
    drives().ResetContent();
    for (int letter = 0; letter < 26; ++letter) {
        if (exists[letter]) {
            addDrive(CString(static_cast<char>('A' + letter)) + ":");
        }
    }
}

/// Adds a drive, or a share that no drive is connected to, and answers its place.
int Gui_DirDlg::addDrive(const CString& drive) {
    Gui_FileName root;
    root.SetMount(drive);
    root.SetPath("\\");
    CString text = drive;
    if (const CString mount = root.GetMount(1); mount != drive) {
        text += "  " + mount;
    }
    const int place = drives().AddString(text);
    drives().SetItemData(place, static_cast<DWORD_PTR>(imageOf(typeOf(root))));
    return place;
}

void Gui_DirDlg::selectDrive() {
    CString drive = m_record->directory.GetMount(0);
    drive.MakeUpper();
    CString entry;
    for (int i = 0; i < drives().GetCount(); ++i) {
        drives().GetLBText(i, entry);
        // Not by the beginning alone, which may be that of another share.
        if (entry == drive || entry.Left(drive.GetLength() + 2) == drive + "  ") {
            drives().SetCurSel(i);
            return;
        }
    }
    drives().SetCurSel(addDrive(drive));
}

void Gui_DirDlg::OnSelchangeDrivecombo() {
    const int place = drives().GetCurSel();
    if (place < 0) {
        return;
    }
    CString drive;
    drives().GetLBText(place, drive);
    if (drive.GetLength() > 2 && drive[1] == ':') {
        drive = drive.Left(2); // the share behind it is found by it
    }
    Gui_FileName root;
    root.SetMount(drive);
    root.SetMountAndPath(root.GetMount(0));
    go(root);
}

void Gui_DirDlg::OnDrawItem(int id, DRAWITEMSTRUCT* item) {
    if (id != GUI_IDC_DIR_DRIVES) {
        CDialog::OnDrawItem(id, item);
        return;
    }
    if (static_cast<int>(item->itemID) < 0) {
        return;
    }
    const bool isSelected = (item->itemState & ODS_SELECTED) != 0;
    const COLORREF background = GetSysColor(isSelected ? COLOR_HIGHLIGHT : COLOR_WINDOW);
    const COLORREF foreground = GetSysColor(isSelected ? COLOR_HIGHLIGHTTEXT : COLOR_WINDOWTEXT);
    CDC& dc = *CDC::FromHandle(item->hDC);
    CRect place(item->rcItem);
    dc.FillSolidRect(place, background);
    if (item->itemState & ODS_FOCUS) {
        CBrush frame(foreground);
        dc.FrameRect(place, &frame);
    }
    CString text;
    drives().GetLBText(static_cast<int>(item->itemID), text);
    const ImageListFunctions& imageLists = m_record->imageLists;
    const HIMAGELIST images = m_record->driveImages.GetSafeHandle();
    const auto image = static_cast<int>(item->itemData & imageBits);
    IMAGEINFO info{};
    if (imageLists.getImageInfo) {
        imageLists.getImageInfo(images, image, &info);
    }
    const CRect size(info.rcImage);
    const int textLeft = place.left + 3 * size.Width() / 2;
    const int textTop = place.top + roomAbove;
    dc.SetBkMode(TRANSPARENT);
    dc.SetTextColor(foreground);
    dc.TextOut(textLeft, textTop, text);
    if (imageLists.setBkColor && imageLists.draw) {
        imageLists.setBkColor(images, background);
        imageLists.draw(images, image, item->hDC, textLeft - 5 * size.Width() / 4,
                        textTop + (dc.GetTextExtent(text).cy - size.Height()) / 2, ILD_NORMAL);
    }
}
