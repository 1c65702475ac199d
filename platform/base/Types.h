#pragma once

/// @file
/// The framework's basic types. Their sizes are those hosts were written against: `LONG` and `DWORD` have 32 bits,
/// message parameters and results are as wide as a pointer. Text is narrow, in UTF-8.

#include <climits>
#include <cstddef>
#include <cstdint>

using BOOL = int;
using BYTE = std::uint8_t;
using WORD = std::uint16_t;
using DWORD = std::uint32_t;
using SHORT = std::int16_t;
using USHORT = std::uint16_t;
using INT = int;
using UINT = unsigned int;
using LONG = std::int32_t;
using ULONG = std::uint32_t;
// Not the fixed-width types, which are "long" here: hosts print these as "%lld", and archives hold a "long" in 32 bits.
using LONGLONG = long long;
using ULONGLONG = unsigned long long;
using CHAR = char;
using TCHAR = char;
using WCHAR = wchar_t;

using INT_PTR = std::intptr_t;
using UINT_PTR = std::uintptr_t;
using LONG_PTR = std::intptr_t;
using DWORD_PTR = std::uintptr_t;
using ULONG_PTR = std::uintptr_t;
using WPARAM = UINT_PTR;
using LPARAM = LONG_PTR;
using LRESULT = LONG_PTR;

using LPSTR = char*;
using LPCSTR = const char*;
using LPTSTR = char*;
using LPCTSTR = const char*;
using LPVOID = void*;
using LPCVOID = const void*;

/// A colour as 0x00BBGGRR.
using COLORREF = DWORD;
/// An identifier drawn from a global table of texts, such as a registered message or clipboard format.
using ATOM = WORD;

#ifndef TRUE
#define TRUE 1
#endif
#ifndef FALSE
#define FALSE 0
#endif

#define MAX_PATH 260

/// Text literals of hosts that were written for two character widths.
#define _T(text) text
#define TEXT(text) text

/// Calling conventions and markers that hosts spell out; they mean nothing here.
#define WINAPI
#define CALLBACK
#define APIENTRY
#define PASCAL
#define AFXAPI
#define AFX_CDECL
#define AFX_MSG_CALL
#define afx_msg
#define AFX_EXT_CLASS
#define UNREFERENCED_PARAMETER(name) (void)(name)

/// A handle is an opaque pointer type of its own, so that kinds of handles cannot be mixed up.
#define DECLARE_HANDLE(name)                                                                                           \
    struct name##__;                                                                                                   \
    using name = name##__*

using HANDLE = void*;
using HGLOBAL = HANDLE;
using HGDIOBJ = HANDLE;

/// A window. Its value is a number of 32 bits: under X11 the id of a top-level window, else a counter.
DECLARE_HANDLE(HWND);
DECLARE_HANDLE(HMENU);
DECLARE_HANDLE(HACCEL);
DECLARE_HANDLE(HDC);
DECLARE_HANDLE(HBITMAP);
DECLARE_HANDLE(HBRUSH);
DECLARE_HANDLE(HPEN);
DECLARE_HANDLE(HFONT);
DECLARE_HANDLE(HRGN);
DECLARE_HANDLE(HPALETTE);
DECLARE_HANDLE(HICON);
using HCURSOR = HICON;
DECLARE_HANDLE(HINSTANCE);
using HMODULE = HINSTANCE;
DECLARE_HANDLE(HRSRC);

/// @{
/// The halves of a number: of the low 32 bits those of 16 bits, of the low 16 bits those of 8 bits.

constexpr WORD LOWORD(std::uintptr_t value) {
    return static_cast<WORD>(value & 0xFFFF);
}
constexpr WORD HIWORD(std::uintptr_t value) {
    return static_cast<WORD>((value >> 16) & 0xFFFF);
}
constexpr BYTE LOBYTE(std::uintptr_t value) {
    return static_cast<BYTE>(value & 0xFF);
}
constexpr BYTE HIBYTE(std::uintptr_t value) {
    return static_cast<BYTE>((value >> 8) & 0xFF);
}
/// @}
/// Two bytes packed into 16 bits, the first in the low half.
constexpr WORD MAKEWORD(int low, int high) {
    return static_cast<WORD>((low & 0xFF) | ((high & 0xFF) << 8));
}
/// Two 16-bit numbers packed into one, the first in the low half.
constexpr LONG MAKELONG(int low, int high) {
    return static_cast<LONG>(static_cast<DWORD>(low & 0xFFFF) | (static_cast<DWORD>(high & 0xFFFF) << 16));
}
/// @{
/// Two 16-bit numbers packed into a message parameter or result, the first in the low half.
constexpr WPARAM MAKEWPARAM(int low, int high) {
    return static_cast<DWORD>(MAKELONG(low, high));
}
constexpr LPARAM MAKELPARAM(int low, int high) {
    return static_cast<DWORD>(MAKELONG(low, high));
}
constexpr LRESULT MAKELRESULT(int low, int high) {
    return static_cast<DWORD>(MAKELONG(low, high));
}
/// @}
/// A colour from its parts, each 0 to 255.
constexpr COLORREF RGB(int red, int green, int blue) {
    return static_cast<COLORREF>((red & 0xFF) | ((green & 0xFF) << 8) | ((blue & 0xFF) << 16));
}
/// @{
/// One part of a colour, 0 to 255.
constexpr BYTE GetRValue(COLORREF color) {
    return static_cast<BYTE>(color & 0xFF);
}
constexpr BYTE GetGValue(COLORREF color) {
    return static_cast<BYTE>((color >> 8) & 0xFF);
}
constexpr BYTE GetBValue(COLORREF color) {
    return static_cast<BYTE>((color >> 16) & 0xFF);
}
/// @}

/// A resource named by number where a name is asked for. Numbers have 16 bits.
#define MAKEINTRESOURCE(id) (reinterpret_cast<LPCSTR>(static_cast<std::uintptr_t>(static_cast<WORD>(id))))
/// Whether a resource name is really a number.
inline bool IS_INTRESOURCE(LPCSTR name) {
    return (reinterpret_cast<std::uintptr_t>(name) >> 16) == 0;
}
