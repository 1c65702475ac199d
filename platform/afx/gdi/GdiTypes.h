#pragma once

/// @file
/// Numbers and records of the drawing calls, as hosts know them.

#include "platform/base/Geometry.h"
#include "platform/base/Types.h"

#include <cstdint>

/// Room for a face name with its NUL.
constexpr int LF_FACESIZE = 32;

/// Describes a font. Zero in every field asks for the default font.
struct LOGFONTA {
    LONG lfHeight;      ///< logical units: below 0 the em height, above 0 the cell height, 0 a default
    LONG lfWidth;       ///< average advance in logical units; 0: as the face is designed
    LONG lfEscapement;  ///< angle of the base line in tenths of a degree, counter-clockwise
    LONG lfOrientation; ///< kept and handed back; characters always follow the base line
    LONG lfWeight;      ///< 0 (any) or 100..900: 400 normal, 700 bold
    BYTE lfItalic;
    BYTE lfUnderline;
    BYTE lfStrikeOut;
    BYTE lfCharSet; ///< kept and handed back; text is UTF-8 in every face
    BYTE lfOutPrecision;
    BYTE lfClipPrecision;
    BYTE lfQuality;        ///< NONANTIALIASED_QUALITY gives hard edges
    BYTE lfPitchAndFamily; ///< helps to choose a face when the name is empty or not installed
    CHAR lfFaceName[LF_FACESIZE];
};
using LOGFONT = LOGFONTA;
using LPLOGFONT = LOGFONTA*;

/// Describes a pen.
struct LOGPEN {
    UINT lopnStyle;  ///< PS_...
    POINT lopnWidth; ///< x: width in logical units; 0 is one pixel
    COLORREF lopnColor;
};

/// Describes a brush.
struct LOGBRUSH {
    UINT lbStyle; ///< BS_...
    COLORREF lbColor;
    UINT_PTR lbHatch; ///< HS_... of BS_HATCHED, the bitmap's handle of BS_PATTERN
};

/// What `GetObjectA` tells of a bitmap.
struct BITMAP {
    LONG bmType;       ///< always 0
    LONG bmWidth;      ///< pixels
    LONG bmHeight;     ///< pixels
    LONG bmWidthBytes; ///< bytes a row, even
    WORD bmPlanes;     ///< always 1
    WORD bmBitsPixel;  ///< 1 or 32
    LPVOID bmBits;     ///< always null: bits are read with GetBitmapBits
};

/// A colour of a bitmap's colour table.
struct RGBQUAD {
    /// Each 0..255; the last one is 0.
    BYTE rgbBlue;
    BYTE rgbGreen;
    BYTE rgbRed;
    BYTE rgbReserved;
};

/// Size and format of device-independent bits.
struct BITMAPINFOHEADER {
    DWORD biSize;         ///< sizeof(BITMAPINFOHEADER), 40
    LONG biWidth;         ///< pixels of a row; each row is padded to a multiple of 4 bytes
    LONG biHeight;        ///< above 0: bottom row first, below 0: top row first
    WORD biPlanes;        ///< always 1
    WORD biBitCount;      ///< bits a pixel: 1, 4, 8, 16, 24 or 32
    DWORD biCompression;  ///< BI_RGB: compressed bits are not understood
    DWORD biSizeImage;    ///< bytes of all rows; not looked at
    LONG biXPelsPerMeter; ///< not looked at
    LONG biYPelsPerMeter; ///< not looked at
    DWORD biClrUsed;      ///< colours in the table; 0: as many as the bits can tell apart
    DWORD biClrImportant; ///< not looked at
};

/// The header of device-independent bits with the colour table that follows it.
struct BITMAPINFO {
    BITMAPINFOHEADER bmiHeader;
    RGBQUAD bmiColors[1]; ///< the first of as many as the header tells
};

#pragma pack(push, 2)
/// What a bitmap file begins with.
struct BITMAPFILEHEADER {
    WORD bfType;  ///< the characters "BM": 0x4D42
    DWORD bfSize; ///< bytes of the whole file
    WORD bfReserved1;
    WORD bfReserved2;
    DWORD bfOffBits; ///< where the pixels begin, from the start of the file
};
#pragma pack(pop)

/// Sizes of a font in logical units.
struct TEXTMETRICA {
    LONG tmHeight; ///< ascent + descent
    LONG tmAscent;
    LONG tmDescent;
    LONG tmInternalLeading; ///< the part of the height above the em square
    LONG tmExternalLeading; ///< extra space between lines
    LONG tmAveCharWidth;
    LONG tmMaxCharWidth;
    LONG tmWeight;
    LONG tmOverhang;
    LONG tmDigitizedAspectX;
    LONG tmDigitizedAspectY;
    BYTE tmFirstChar;
    BYTE tmLastChar;
    BYTE tmDefaultChar;
    BYTE tmBreakChar;
    BYTE tmItalic;
    BYTE tmUnderlined;
    BYTE tmStruckOut;
    BYTE tmPitchAndFamily; ///< TMPF_FIXED_PITCH is set for faces of VARIABLE pitch
    BYTE tmCharSet;
};
using TEXTMETRIC = TEXTMETRICA;

/// One painting of a window, filled by `BeginPaint`.
struct PAINTSTRUCT {
    HDC hdc;
    BOOL fErase;  ///< whether the background is still to be erased
    RECT rcPaint; ///< the part to be painted, in client pixels
    BOOL fRestore;
    BOOL fIncUpdate;
    BYTE rgbReserved[32];
};

constexpr COLORREF CLR_INVALID = 0xFFFFFFFFU;

// Pen styles
constexpr int PS_SOLID = 0;
constexpr int PS_DASH = 1;
constexpr int PS_DOT = 2;
constexpr int PS_DASHDOT = 3;
constexpr int PS_DASHDOTDOT = 4;
constexpr int PS_NULL = 5;
constexpr int PS_INSIDEFRAME = 6;

// Brush styles and hatches
constexpr int BS_SOLID = 0;
constexpr int BS_NULL = 1;
constexpr int BS_HOLLOW = BS_NULL;
constexpr int BS_HATCHED = 2;
constexpr int BS_PATTERN = 3;
constexpr int HS_HORIZONTAL = 0;
constexpr int HS_VERTICAL = 1;
constexpr int HS_FDIAGONAL = 2;
constexpr int HS_BDIAGONAL = 3;
constexpr int HS_CROSS = 4;
constexpr int HS_DIAGCROSS = 5;

// Stock objects
constexpr int WHITE_BRUSH = 0;
constexpr int LTGRAY_BRUSH = 1;
constexpr int GRAY_BRUSH = 2;
constexpr int DKGRAY_BRUSH = 3;
constexpr int BLACK_BRUSH = 4;
constexpr int NULL_BRUSH = 5;
constexpr int HOLLOW_BRUSH = NULL_BRUSH;
constexpr int WHITE_PEN = 6;
constexpr int BLACK_PEN = 7;
constexpr int NULL_PEN = 8;
constexpr int OEM_FIXED_FONT = 10;
constexpr int ANSI_FIXED_FONT = 11;
constexpr int ANSI_VAR_FONT = 12;
constexpr int SYSTEM_FONT = 13;
constexpr int DEVICE_DEFAULT_FONT = 14;
constexpr int SYSTEM_FIXED_FONT = 16;
constexpr int DEFAULT_GUI_FONT = 17;

// Kinds of objects, as GetObjectType answers
constexpr int OBJ_PEN = 1;
constexpr int OBJ_BRUSH = 2;
constexpr int OBJ_FONT = 6;
constexpr int OBJ_BITMAP = 7;
constexpr int OBJ_REGION = 8;

// Font descriptions
constexpr int FW_DONTCARE = 0;
constexpr int FW_THIN = 100;
constexpr int FW_LIGHT = 300;
constexpr int FW_NORMAL = 400;
constexpr int FW_MEDIUM = 500;
constexpr int FW_SEMIBOLD = 600;
constexpr int FW_BOLD = 700;
constexpr int FW_HEAVY = 900;
constexpr int ANSI_CHARSET = 0;
constexpr int DEFAULT_CHARSET = 1;
constexpr int SYMBOL_CHARSET = 2;
constexpr int SHIFTJIS_CHARSET = 128;
constexpr int OEM_CHARSET = 255;
constexpr int OUT_DEFAULT_PRECIS = 0;
constexpr int OUT_TT_PRECIS = 4;
constexpr int CLIP_DEFAULT_PRECIS = 0;
constexpr int DEFAULT_QUALITY = 0;
constexpr int DRAFT_QUALITY = 1;
constexpr int PROOF_QUALITY = 2;
constexpr int NONANTIALIASED_QUALITY = 3;
constexpr int ANTIALIASED_QUALITY = 4;
constexpr int DEFAULT_PITCH = 0;
constexpr int FIXED_PITCH = 1;
constexpr int VARIABLE_PITCH = 2;
constexpr int FF_DONTCARE = 0x00;
constexpr int FF_ROMAN = 0x10;
constexpr int FF_SWISS = 0x20;
constexpr int FF_MODERN = 0x30;
constexpr int FF_SCRIPT = 0x40;
constexpr int FF_DECORATIVE = 0x50;
constexpr int TMPF_FIXED_PITCH = 1;
constexpr int TMPF_VECTOR = 2;
constexpr int TMPF_TRUETYPE = 4;

// Background modes, polygon filling, arcs, stretching
constexpr int TRANSPARENT = 1;
constexpr int OPAQUE = 2;
constexpr int ALTERNATE = 1;
constexpr int WINDING = 2;
constexpr int AD_COUNTERCLOCKWISE = 1;
constexpr int AD_CLOCKWISE = 2;
constexpr int BLACKONWHITE = 1;
constexpr int WHITEONBLACK = 2;
constexpr int COLORONCOLOR = 3;
constexpr int HALFTONE = 4;
constexpr int STRETCH_ANDSCANS = BLACKONWHITE;
constexpr int STRETCH_ORSCANS = WHITEONBLACK;
constexpr int STRETCH_DELETESCANS = COLORONCOLOR;

// Text alignment
constexpr int TA_NOUPDATECP = 0;
constexpr int TA_UPDATECP = 1;
constexpr int TA_LEFT = 0;
constexpr int TA_RIGHT = 2;
constexpr int TA_CENTER = 6;
constexpr int TA_TOP = 0;
constexpr int TA_BOTTOM = 8;
constexpr int TA_BASELINE = 24;

// Text output options
constexpr int ETO_OPAQUE = 0x0002;
constexpr int ETO_CLIPPED = 0x0004;

// DrawText formats
constexpr int DT_TOP = 0x0000;
constexpr int DT_LEFT = 0x0000;
constexpr int DT_CENTER = 0x0001;
constexpr int DT_RIGHT = 0x0002;
constexpr int DT_VCENTER = 0x0004;
constexpr int DT_BOTTOM = 0x0008;
constexpr int DT_WORDBREAK = 0x0010;
constexpr int DT_SINGLELINE = 0x0020;
constexpr int DT_EXPANDTABS = 0x0040;
constexpr int DT_TABSTOP = 0x0080;
constexpr int DT_NOCLIP = 0x0100;
constexpr int DT_EXTERNALLEADING = 0x0200;
constexpr int DT_CALCRECT = 0x0400;
constexpr int DT_NOPREFIX = 0x0800;
constexpr int DT_PATH_ELLIPSIS = 0x4000;
constexpr int DT_END_ELLIPSIS = 0x8000;
constexpr int DT_MODIFYSTRING = 0x10000;
constexpr int DT_WORD_ELLIPSIS = 0x40000;
constexpr int DT_HIDEPREFIX = 0x100000;

// Binary raster operations
constexpr int R2_BLACK = 1;
constexpr int R2_NOTMERGEPEN = 2;
constexpr int R2_MASKNOTPEN = 3;
constexpr int R2_NOTCOPYPEN = 4;
constexpr int R2_MASKPENNOT = 5;
constexpr int R2_NOT = 6;
constexpr int R2_XORPEN = 7;
constexpr int R2_NOTMASKPEN = 8;
constexpr int R2_MASKPEN = 9;
constexpr int R2_NOTXORPEN = 10;
constexpr int R2_NOP = 11;
constexpr int R2_MERGENOTPEN = 12;
constexpr int R2_COPYPEN = 13;
constexpr int R2_MERGEPENNOT = 14;
constexpr int R2_MERGEPEN = 15;
constexpr int R2_WHITE = 16;

// Ternary raster operations: the third byte is the truth table of brush, source and destination
constexpr DWORD SRCCOPY = 0x00CC0020U;
constexpr DWORD SRCPAINT = 0x00EE0086U;
constexpr DWORD SRCAND = 0x008800C6U;
constexpr DWORD SRCINVERT = 0x00660046U;
constexpr DWORD SRCERASE = 0x00440328U;
constexpr DWORD NOTSRCCOPY = 0x00330008U;
constexpr DWORD NOTSRCERASE = 0x001100A6U;
constexpr DWORD MERGECOPY = 0x00C000CAU;
constexpr DWORD MERGEPAINT = 0x00BB0226U;
constexpr DWORD PATCOPY = 0x00F00021U;
constexpr DWORD PATPAINT = 0x00FB0A09U;
constexpr DWORD PATINVERT = 0x005A0049U;
constexpr DWORD DSTINVERT = 0x00550009U;
constexpr DWORD BLACKNESS = 0x00000042U;
constexpr DWORD WHITENESS = 0x00FF0062U;

// Mapping modes
constexpr int MM_TEXT = 1;
constexpr int MM_LOMETRIC = 2;
constexpr int MM_HIMETRIC = 3;
constexpr int MM_LOENGLISH = 4;
constexpr int MM_HIENGLISH = 5;
constexpr int MM_TWIPS = 6;
constexpr int MM_ISOTROPIC = 7;
constexpr int MM_ANISOTROPIC = 8;

// Regions
constexpr int ERROR = 0;
constexpr int NULLREGION = 1;
constexpr int SIMPLEREGION = 2;
constexpr int COMPLEXREGION = 3;
constexpr int RGN_ERROR = ERROR;
constexpr int RGN_AND = 1;
constexpr int RGN_OR = 2;
constexpr int RGN_XOR = 3;
constexpr int RGN_DIFF = 4;
constexpr int RGN_COPY = 5;

// Device capabilities
constexpr int TECHNOLOGY = 2;
constexpr int HORZSIZE = 4;
constexpr int VERTSIZE = 6;
constexpr int HORZRES = 8;
constexpr int VERTRES = 10;
constexpr int BITSPIXEL = 12;
constexpr int PLANES = 14;
constexpr int NUMCOLORS = 24;
constexpr int RASTERCAPS = 38;
constexpr int ASPECTX = 40;
constexpr int ASPECTY = 42;
constexpr int ASPECTXY = 44;
constexpr int LOGPIXELSX = 88;
constexpr int LOGPIXELSY = 90;
constexpr int DT_RASDISPLAY = 1;

// Bitmaps from device-independent bits
constexpr int BI_RGB = 0;
constexpr int CBM_INIT = 4;
constexpr int DIB_RGB_COLORS = 0;

// DrawEdge
constexpr int BDR_RAISEDOUTER = 0x0001;
constexpr int BDR_SUNKENOUTER = 0x0002;
constexpr int BDR_RAISEDINNER = 0x0004;
constexpr int BDR_SUNKENINNER = 0x0008;
/// The usual combinations.
constexpr int EDGE_RAISED = (BDR_RAISEDOUTER | BDR_RAISEDINNER);
constexpr int EDGE_SUNKEN = (BDR_SUNKENOUTER | BDR_SUNKENINNER);
constexpr int EDGE_ETCHED = (BDR_SUNKENOUTER | BDR_RAISEDINNER);
constexpr int EDGE_BUMP = (BDR_RAISEDOUTER | BDR_SUNKENINNER);
constexpr int BF_LEFT = 0x0001;
constexpr int BF_TOP = 0x0002;
constexpr int BF_RIGHT = 0x0004;
constexpr int BF_BOTTOM = 0x0008;
constexpr int BF_RECT = 0x000F;
constexpr int BF_MIDDLE = 0x0800;
constexpr int BF_SOFT = 0x1000;
constexpr int BF_ADJUST = 0x2000;
constexpr int BF_FLAT = 0x4000;
constexpr int BF_MONO = 0x8000;

// System colours
constexpr int COLOR_SCROLLBAR = 0;
constexpr int COLOR_BACKGROUND = 1;
constexpr int COLOR_ACTIVECAPTION = 2;
constexpr int COLOR_INACTIVECAPTION = 3;
constexpr int COLOR_MENU = 4;
constexpr int COLOR_WINDOW = 5;
constexpr int COLOR_WINDOWFRAME = 6;
constexpr int COLOR_MENUTEXT = 7;
constexpr int COLOR_WINDOWTEXT = 8;
constexpr int COLOR_CAPTIONTEXT = 9;
constexpr int COLOR_ACTIVEBORDER = 10;
constexpr int COLOR_INACTIVEBORDER = 11;
constexpr int COLOR_APPWORKSPACE = 12;
constexpr int COLOR_HIGHLIGHT = 13;
constexpr int COLOR_HIGHLIGHTTEXT = 14;
constexpr int COLOR_BTNFACE = 15;
constexpr int COLOR_3DFACE = COLOR_BTNFACE;
constexpr int COLOR_BTNSHADOW = 16;
constexpr int COLOR_3DSHADOW = COLOR_BTNSHADOW;
constexpr int COLOR_GRAYTEXT = 17;
constexpr int COLOR_BTNTEXT = 18;
constexpr int COLOR_INACTIVECAPTIONTEXT = 19;
constexpr int COLOR_BTNHIGHLIGHT = 20;
constexpr int COLOR_3DHIGHLIGHT = COLOR_BTNHIGHLIGHT;
constexpr int COLOR_3DHILIGHT = COLOR_BTNHIGHLIGHT;
constexpr int COLOR_3DDKSHADOW = 21;
constexpr int COLOR_3DLIGHT = 22;
constexpr int COLOR_INFOTEXT = 23;
constexpr int COLOR_INFOBK = 24;
constexpr int COLOR_HOTLIGHT = 26;

// Sizes and counts of the desktop
constexpr int SM_CXSCREEN = 0;
constexpr int SM_CYSCREEN = 1;
constexpr int SM_CXVSCROLL = 2;
constexpr int SM_CYHSCROLL = 3;
constexpr int SM_CYCAPTION = 4;
constexpr int SM_CXBORDER = 5;
constexpr int SM_CYBORDER = 6;
constexpr int SM_CXDLGFRAME = 7;
constexpr int SM_CYDLGFRAME = 8;
constexpr int SM_CXFIXEDFRAME = SM_CXDLGFRAME;
constexpr int SM_CYFIXEDFRAME = SM_CYDLGFRAME;
constexpr int SM_CXICON = 11;
constexpr int SM_CYICON = 12;
constexpr int SM_CXCURSOR = 13;
constexpr int SM_CYCURSOR = 14;
constexpr int SM_CYMENU = 15;
constexpr int SM_CXFULLSCREEN = 16;
constexpr int SM_CYFULLSCREEN = 17;
constexpr int SM_MOUSEPRESENT = 19;
constexpr int SM_CYVSCROLL = 20;
constexpr int SM_CXHSCROLL = 21;
constexpr int SM_CXMIN = 28;
constexpr int SM_CYMIN = 29;
constexpr int SM_CXSIZE = 30;
constexpr int SM_CYSIZE = 31;
constexpr int SM_CXFRAME = 32;
constexpr int SM_CYFRAME = 33;
constexpr int SM_CXSIZEFRAME = SM_CXFRAME;
constexpr int SM_CYSIZEFRAME = SM_CYFRAME;
constexpr int SM_CXDOUBLECLK = 36;
constexpr int SM_CYDOUBLECLK = 37;
constexpr int SM_CMOUSEBUTTONS = 43;
constexpr int SM_CXEDGE = 45;
constexpr int SM_CYEDGE = 46;
constexpr int SM_CXSMICON = 49;
constexpr int SM_CYSMICON = 50;
constexpr int SM_CYSMCAPTION = 51;
constexpr int SM_CXMENUSIZE = 54;
constexpr int SM_CYMENUSIZE = 55;
constexpr int SM_CXMENUCHECK = 71;
constexpr int SM_CYMENUCHECK = 72;
constexpr int SM_XVIRTUALSCREEN = 76;
constexpr int SM_YVIRTUALSCREEN = 77;
constexpr int SM_CXVIRTUALSCREEN = 78;
constexpr int SM_CYVIRTUALSCREEN = 79;
constexpr int SM_CMONITORS = 80;
constexpr int SM_CXDRAG = 68;
constexpr int SM_CYDRAG = 69;

// Ways of drawing an icon
constexpr int DI_MASK = 1;
constexpr int DI_IMAGE = 2;
constexpr int DI_NORMAL = 3;

// Predefined icons
#define IDI_APPLICATION MAKEINTRESOURCE(32512)
#define IDI_HAND MAKEINTRESOURCE(32513)
#define IDI_QUESTION MAKEINTRESOURCE(32514)
#define IDI_EXCLAMATION MAKEINTRESOURCE(32515)
#define IDI_ASTERISK MAKEINTRESOURCE(32516)
