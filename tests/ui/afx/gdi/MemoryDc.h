#pragma once

#include "platform/afx/gdi/Dc.h"

#include <string>

/// A memory context with a white bitmap to draw on and to look at.
class MemoryDc : public CDC {
public:
    explicit MemoryDc(int width = 40, int height = 40, UINT bitsPerPixel = 32) {
        CreateCompatibleDC(nullptr);
        bitmap.CreateBitmap(width, height, 1, bitsPerPixel, nullptr);
        SelectObject(&bitmap);
        PatBlt(0, 0, width, height, WHITENESS);
        this->width = width;
        this->height = height;
    }

    /// The pixels of `rect` in device units as rows of characters: '.' white, '#' black, 'r' red, 'g' green, 'b' blue,
    /// '?' anything else. Mapping and clipping of the context do not matter.
    std::string picture(RECT rect) {
        const int saved = SaveDC();
        SelectClipRgn(nullptr);
        SetMapMode(MM_TEXT);
        SetWindowOrg(0, 0);
        SetViewportOrg(0, 0);
        std::string text;
        for (int y = rect.top; y < rect.bottom; ++y) {
            for (int x = rect.left; x < rect.right; ++x) {
                text += character(GetPixel(x, y));
            }
            text += '\n';
        }
        RestoreDC(saved);
        return text;
    }
    std::string picture() {
        return picture({0, 0, width, height});
    }
    /// Number of pixels that are not white.
    int inked() {
        int count = 0;
        for (const char c : picture()) {
            count += c != '.' && c != '\n';
        }
        return count;
    }

    CBitmap bitmap;
    int width;
    int height;

private:
    static char character(COLORREF color) {
        switch (color) {
        case RGB(255, 255, 255):
            return '.';
        case RGB(0, 0, 0):
            return '#';
        case RGB(255, 0, 0):
            return 'r';
        case RGB(0, 255, 0):
            return 'g';
        case RGB(0, 0, 255):
            return 'b';
        default:
            return '?';
        }
    }
};
