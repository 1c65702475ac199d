// Bitmaps that draw themselves, and bitmap files of every kind of damage.
#include "s/Bitmap.h"

#include "afxwin.h"
#include "tests/ui/afx/gdi/MemoryDc.h"

#include <gtest/gtest.h>

#include <cstdint>
#include <filesystem>
#include <fstream>
#include <string>
#include <sys/stat.h>

namespace {

/// The bytes of a bitmap file.
class FileBytes {
public:
    struct Shape {
        int width = 3;
        int height = 2;
        int bits = 4;
        std::string pixels;
    };
    explicit FileBytes(const Shape& shape) {
        std::string info;
        number(info, 40);
        number(info, shape.width);
        number(info, shape.height);
        number(info, 1, 2);
        number(info, shape.bits, 2);
        info.append(24, '\0');
        if (shape.bits <= 8) {
            for (int i = 0; i < 1 << shape.bits; ++i) {
                number(info, palette[i % 4]);
            }
        }
        bytes = "BM";
        number(bytes, static_cast<std::int64_t>(14 + info.size() + shape.pixels.size()));
        number(bytes, 0);
        number(bytes, static_cast<std::int64_t>(14 + info.size()));
        bytes += info + shape.pixels;
    }
    void patch(std::size_t at, std::int64_t value, int size = 4) {
        std::string field;
        number(field, value, size);
        bytes.replace(at, field.size(), field);
    }
    std::string bytes;

private:
    static void number(std::string& bytes, std::int64_t value, int size = 4) {
        for (int i = 0; i < size; ++i) {
            bytes += static_cast<char>(value >> 8 * i);
        }
    }
    static constexpr std::int64_t palette[] = {0x000000, 0xFF0000, 0x00FF00, 0xFFFFFF}; // blue lowest
};

/// Three by two pixels: red, green, white above black, red, green. Rows come from below.
FileBytes flag() {
    return FileBytes({3, 2, 4, std::string("\x01\x20\0\0\x12\x30\0\0", 8)});
}
constexpr const char* flagPicture = "rg.\n#rg\n";

Gui_Bitmap::LoadError load(const std::string& bytes, Gui_Bitmap* bitmap = nullptr) {
    const auto name = std::filesystem::temp_directory_path() / "BitmapTest.bmp";
    std::ofstream(name, std::ios::binary) << bytes;
    HBITMAP handle = reinterpret_cast<HBITMAP>(1);
    Gui_Bitmap::LoadError error{};
    const int result = Gui_Bitmap::LoadBitmapFromFile(handle, name.c_str(), nullptr, &error);
    EXPECT_EQ(result, error == Gui_Bitmap::Loaded ? 1 : 0);
    EXPECT_EQ(handle != nullptr, result == 1);
    Gui_Bitmap own;
    (bitmap ? *bitmap : own).Attach(handle);
    std::filesystem::remove(name);
    return error;
}

} // namespace

TEST(Bitmap, LoadsPalettesOfEveryDepth) {
    for (const auto& [bits, pixels] : {std::pair(1, std::string("\x40\0\0\0\x80\0\0\0", 8)),
                                       std::pair(4, std::string("\x01\x20\0\0\x12\x30\0\0", 8)),
                                       std::pair(8, std::string("\0\x01\x02\0\x01\x02\x03\0", 8))}) {
        Gui_Bitmap bitmap;
        ASSERT_EQ(load(FileBytes({3, 2, bits, pixels}).bytes, &bitmap), Gui_Bitmap::Loaded);
        EXPECT_EQ(bitmap.GetSize(), CSize(3, 2));
        MemoryDc dc(3, 2);
        EXPECT_EQ(bitmap.Draw(&dc, 0, 0, SRCCOPY), 1);
        EXPECT_EQ(dc.picture(), bits == 1 ? "r##\n#r#\n" : flagPicture);
    }
    FileBytes topDown = flag();
    topDown.patch(22, -2);
    topDown.patch(46, 2); // colours that are said to be used: not looked at
    Gui_Bitmap bitmap;
    ASSERT_EQ(load(topDown.bytes, &bitmap), Gui_Bitmap::Loaded);
    MemoryDc dc(3, 2);
    bitmap.Draw(&dc, CPoint(0, 0), SRCCOPY);
    EXPECT_EQ(dc.picture(), "#rg\nrg.\n");
}

TEST(Bitmap, TellsWhyAFileIsNotLoaded) {
    HBITMAP handle = nullptr;
    Gui_Bitmap::LoadError error{};
    EXPECT_EQ(Gui_Bitmap::LoadBitmapFromFile(handle, "/no/such/file.bmp", nullptr, &error), 0);
    EXPECT_EQ(error, Gui_Bitmap::CannotOpen);
    EXPECT_EQ(Gui_Bitmap::LoadBitmapFromFile(handle, nullptr, nullptr, nullptr), 0);
    const auto pipe = std::filesystem::temp_directory_path() / "pipe";
    ASSERT_EQ(::mkfifo(pipe.c_str(), 0600), 0); // nobody writes to it
    EXPECT_EQ(Gui_Bitmap::LoadBitmapFromFile(handle, pipe.c_str(), nullptr, &error), 0);
    EXPECT_EQ(error, Gui_Bitmap::CannotOpen);
    std::filesystem::remove(pipe);
    EXPECT_EQ(load("This is a text and no picture at all.\n"), Gui_Bitmap::NotSupported);
    EXPECT_EQ(load(""), Gui_Bitmap::NotSupported);
    EXPECT_EQ(load(FileBytes({3, 2, 24, std::string(24, '\x7F')}).bytes), Gui_Bitmap::TooShort);
    EXPECT_EQ(load(FileBytes({3, 2, 32, std::string(24, '\x7F')}).bytes), Gui_Bitmap::TooShort);
    EXPECT_EQ(load(FileBytes({3, 2, 3, std::string(8, '\0')}).bytes), Gui_Bitmap::CannotCreate);
    const std::filesystem::path folder = std::filesystem::temp_directory_path();
    EXPECT_EQ(Gui_Bitmap::LoadBitmapFromFile(handle, folder.c_str(), nullptr, &error), 0);
    EXPECT_NE(error, Gui_Bitmap::Loaded);
}

TEST(Bitmap, EndsOnEveryTruncation) {
    const std::string whole = flag().bytes;
    for (std::size_t length = 0; length < whole.size(); ++length) {
        const auto expected = length < 18 ? Gui_Bitmap::NotSupported : Gui_Bitmap::TooShort;
        EXPECT_EQ(load(whole.substr(0, length)), expected) << length;
    }
}

TEST(Bitmap, BelievesNoNumberOfAHostileFile) {
    struct {
        std::size_t at;
        std::int64_t value;
        int size;
        Gui_Bitmap::LoadError expected;
    } const rows[] = {
        {2, 0xFFFFFFFF, 4, Gui_Bitmap::TooShort},         // file size: 4 GB of pixels
        {2, 0, 4, Gui_Bitmap::NotSupported},              //
        {2, 118, 4, Gui_Bitmap::NotSupported},            // no pixels
        {10, 0xFFFFFFF0, 4, Gui_Bitmap::NotSupported},    // offset: -16
        {10, 0, 4, Gui_Bitmap::TooShort},                 //
        {14, 108, 4, Gui_Bitmap::NotSupported},           // header size
        {18, 0x7FFFFFFF, 4, Gui_Bitmap::CannotCreate},    // width
        {18, 0, 4, Gui_Bitmap::CannotCreate},             //
        {18, -3, 4, Gui_Bitmap::CannotCreate},            //
        {22, 0x7FFFFFFF, 4, Gui_Bitmap::CannotCreate},    // height: more rows than there are pixels
        {22, -0x80000000LL, 4, Gui_Bitmap::CannotCreate}, //
        {22, 3, 4, Gui_Bitmap::CannotCreate},             //
        {28, 0xFFFF, 2, Gui_Bitmap::TooShort},            // bits a pixel
        {28, 8, 2, Gui_Bitmap::TooShort},                 //
        {28, 0, 2, Gui_Bitmap::CannotCreate},             //
        {30, 1, 4, Gui_Bitmap::CannotCreate},             // compression
    };
    for (const auto& row : rows) {
        FileBytes file = flag();
        file.patch(row.at, row.value, row.size);
        EXPECT_EQ(load(file.bytes), row.expected) << row.at << ": " << row.value;
    }
}

TEST(Bitmap, DrawsByRasterOperation) {
    Gui_Bitmap bitmap;
    ASSERT_EQ(load(flag().bytes, &bitmap), Gui_Bitmap::Loaded);
    MemoryDc dc(4, 3);
    bitmap.Draw(&dc, 1, 1, SRCCOPY);
    EXPECT_EQ(dc.picture(), "....\n.rg.\n.#rg\n");
    bitmap.Draw(&dc, 1, 1, SRCINVERT); // a picture on itself
    EXPECT_EQ(dc.picture(), "....\n.###\n.###\n");
    bitmap.Draw(&dc, 0, 0, SRCPAINT);
    EXPECT_EQ(dc.picture({1, 1, 3, 2}), "rg\n");
    bitmap.Draw(&dc, 0, 0, DSTINVERT);
    EXPECT_EQ(dc.GetPixel(1, 1), RGB(0, 255, 255));
}

TEST(Bitmap, DrawsUprightInEveryMappingMode) {
    Gui_Bitmap bitmap;
    ASSERT_EQ(load(flag().bytes, &bitmap), Gui_Bitmap::Loaded);
    for (const int mode : {MM_TEXT, MM_LOMETRIC, MM_HIENGLISH, MM_TWIPS, MM_ISOTROPIC, MM_ANISOTROPIC}) {
        MemoryDc dc(5, 4);
        dc.SetMapMode(mode);
        if (mode == MM_ANISOTROPIC) {
            dc.SetWindowExt(10, 100);
            dc.SetViewportExt(20, -7);
        }
        dc.SetViewportOrg(0, 1);
        dc.SetWindowOrg(300, -200);
        CPoint corner(1, 2);
        dc.DPtoLP(&corner);
        CPoint place = corner;
        dc.LPtoDP(&place); // what the units can express
        EXPECT_EQ(bitmap.Draw(&dc, corner, SRCCOPY), 1);
        EXPECT_EQ(dc.GetMapMode(), mode);
        EXPECT_EQ(dc.GetWindowOrg(), CPoint(300, -200));
        EXPECT_EQ(dc.picture({place.x, place.y, place.x + 3, std::min<int>(place.y + 2, 4)}), flagPicture) << mode;
    }
}

TEST(Bitmap, HasNothingToDrawWithoutABitmap) {
    MemoryDc dc(3, 2);
    Gui_Bitmap none;
    EXPECT_EQ(none.GetSize(), CSize(0, 0));
    EXPECT_EQ(none.Draw(&dc, 0, 0, SRCCOPY), 0);
    Gui_Bitmap bitmap;
    bitmap.CreateBitmap(332, 260, 1, 32, nullptr);
    EXPECT_EQ(bitmap.GetSize(), CSize(332, 260));
    EXPECT_EQ(bitmap.Draw(nullptr, 0, 0, SRCCOPY), 0);
    EXPECT_EQ(dc.inked(), 0);
}
