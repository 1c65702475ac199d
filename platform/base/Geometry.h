#pragma once

/// @file
/// Points, sizes and rectangles in device or logical units, as plain structures and as the framework's classes.
/// A rectangle's right and bottom edges lie outside of it: its width is right - left. Results that no longer fit into
/// 32 bits wrap around, as hosts know it; they never trap.

#include "platform/base/Types.h"

/// A position.
struct POINT {
    /// Pixels or logical units to the right and downwards (upwards where the mapping mode says so).
    LONG x;
    LONG y;
};

/// Width and height.
struct SIZE {
    /// Width and height; both may be negative.
    LONG cx;
    LONG cy;
};

/// A rectangle; `right` and `bottom` are the first coordinates outside.
struct RECT {
    /// The edges.
    LONG left;
    LONG top;
    LONG right;
    LONG bottom;
};

using LPPOINT = POINT*;
using LPSIZE = SIZE*;
using LPRECT = RECT*;
using LPCRECT = const RECT*;

class CPoint;

namespace tvx {

/// Sum and difference modulo 2^32.
/// @{
constexpr LONG wrappingAdd(LONG left, LONG right) noexcept {
    return static_cast<LONG>(static_cast<ULONG>(left) + static_cast<ULONG>(right));
}
constexpr LONG wrappingSubtract(LONG left, LONG right) noexcept {
    return static_cast<LONG>(static_cast<ULONG>(left) - static_cast<ULONG>(right));
}
/// @}

} // namespace tvx

/// A size with operators.
class CSize : public SIZE {
public:
    /// From nothing (0, 0), width and height, or another structure.
    constexpr CSize() noexcept : SIZE{0, 0} {}
    constexpr CSize(int width, int height) noexcept : SIZE{width, height} {}
    constexpr CSize(SIZE size) noexcept : SIZE(size) {}
    constexpr CSize(POINT point) noexcept : SIZE{point.x, point.y} {}
    /// Width in the low half of a packed number, height in the high half, both signed.
    constexpr CSize(DWORD packed) noexcept
        : SIZE{static_cast<SHORT>(LOWORD(packed)), static_cast<SHORT>(HIWORD(packed))} {}
    /// Sets both members.
    constexpr void SetSize(int width, int height) noexcept {
        cx = width;
        cy = height;
    }

    /// Arithmetic member by member.
    /// @{
    constexpr CSize& operator+=(SIZE size) noexcept {
        return *this = *this + size;
    }
    constexpr CSize& operator-=(SIZE size) noexcept {
        return *this = *this - size;
    }
    constexpr CSize operator-() const noexcept {
        return CSize() - *this;
    }
    friend constexpr CSize operator+(const CSize& left, SIZE right) noexcept {
        return {tvx::wrappingAdd(left.cx, right.cx), tvx::wrappingAdd(left.cy, right.cy)};
    }
    friend constexpr CSize operator-(const CSize& left, SIZE right) noexcept {
        return {tvx::wrappingSubtract(left.cx, right.cx), tvx::wrappingSubtract(left.cy, right.cy)};
    }
    /// @}
    friend constexpr bool operator==(const SIZE& left, const SIZE& right) noexcept {
        return left.cx == right.cx && left.cy == right.cy;
    }
    /// The point moved by this size.
    constexpr CPoint operator+(POINT point) const noexcept;
    constexpr CPoint operator-(POINT point) const noexcept;
};

/// A position with operators.
class CPoint : public POINT {
public:
    /// From nothing (0, 0), coordinates, or another structure.
    constexpr CPoint() noexcept : POINT{0, 0} {}
    constexpr CPoint(int x, int y) noexcept : POINT{x, y} {}
    constexpr CPoint(POINT point) noexcept : POINT(point) {}
    constexpr CPoint(SIZE size) noexcept : POINT{size.cx, size.cy} {}
    /// The position of a mouse message: x in the low half of the packed number, y in the high half, both signed.
    constexpr CPoint(LPARAM packed) noexcept
        : POINT{static_cast<SHORT>(LOWORD(static_cast<DWORD>(packed))),
                static_cast<SHORT>(HIWORD(static_cast<DWORD>(packed)))} {}
    /// Sets both members.
    constexpr void SetPoint(int newX, int newY) noexcept {
        x = newX;
        y = newY;
    }
    /// Moves the point.
    constexpr void Offset(int dx, int dy) noexcept {
        x = tvx::wrappingAdd(x, dx);
        y = tvx::wrappingAdd(y, dy);
    }
    constexpr void Offset(POINT point) noexcept {
        Offset(point.x, point.y);
    }
    constexpr void Offset(SIZE size) noexcept {
        Offset(size.cx, size.cy);
    }

    /// Moving by a size or by the coordinates of a point.
    /// @{
    constexpr CPoint& operator+=(SIZE size) noexcept {
        return *this = *this + size;
    }
    constexpr CPoint& operator-=(SIZE size) noexcept {
        return *this = *this - size;
    }
    constexpr CPoint& operator+=(POINT point) noexcept {
        Offset(point);
        return *this;
    }
    constexpr CPoint& operator-=(POINT point) noexcept {
        return *this -= SIZE{point.x, point.y};
    }
    constexpr CPoint operator-() const noexcept {
        return CPoint() - SIZE{x, y};
    }
    friend constexpr CPoint operator+(const CPoint& left, SIZE right) noexcept {
        return {tvx::wrappingAdd(left.x, right.cx), tvx::wrappingAdd(left.y, right.cy)};
    }
    friend constexpr CPoint operator-(const CPoint& left, SIZE right) noexcept {
        return {tvx::wrappingSubtract(left.x, right.cx), tvx::wrappingSubtract(left.y, right.cy)};
    }
    friend constexpr CPoint operator+(const CPoint& left, POINT right) noexcept {
        return {tvx::wrappingAdd(left.x, right.x), tvx::wrappingAdd(left.y, right.y)};
    }
    /// The distance between two points.
    friend constexpr CSize operator-(const CPoint& left, POINT right) noexcept {
        return {tvx::wrappingSubtract(left.x, right.x), tvx::wrappingSubtract(left.y, right.y)};
    }
    /// @}
    friend constexpr bool operator==(const POINT& left, const POINT& right) noexcept {
        return left.x == right.x && left.y == right.y;
    }
};

/// A rectangle with operators. Most members count on a normalised one: left <= right and top <= bottom.
class CRect : public RECT {
public:
    /// From nothing (all 0), the four edges, another rectangle, a corner and a size, or two corners.
    constexpr CRect() noexcept : RECT{0, 0, 0, 0} {}
    constexpr CRect(int left, int top, int right, int bottom) noexcept : RECT{left, top, right, bottom} {}
    constexpr CRect(const RECT& rect) noexcept : RECT(rect) {}
    constexpr CRect(LPCRECT rect) noexcept : RECT(*rect) {}
    constexpr CRect(POINT topLeft, SIZE size) noexcept
        : RECT{topLeft.x, topLeft.y, tvx::wrappingAdd(topLeft.x, size.cx), tvx::wrappingAdd(topLeft.y, size.cy)} {}
    constexpr CRect(POINT topLeft, POINT bottomRight) noexcept
        : RECT{topLeft.x, topLeft.y, bottomRight.x, bottomRight.y} {}

    /// right - left, and bottom - top: negative for a rectangle that is not normalised.
    /// @{
    constexpr int Width() const noexcept {
        return tvx::wrappingSubtract(right, left);
    }
    constexpr int Height() const noexcept {
        return tvx::wrappingSubtract(bottom, top);
    }
    /// @}
    /// Width and height together.
    constexpr CSize Size() const noexcept {
        return {Width(), Height()};
    }
    /// Copies of the corners.
    /// @{
    constexpr CPoint TopLeft() const noexcept {
        return {left, top};
    }
    constexpr CPoint BottomRight() const noexcept {
        return {right, bottom};
    }
    /// @}
    /// The upper left corner itself, to be changed.
    CPoint& TopLeft() noexcept {
        return *reinterpret_cast<CPoint*>(&left);
    }
    /// The lower right corner itself, to be changed.
    CPoint& BottomRight() noexcept {
        return *reinterpret_cast<CPoint*>(&right);
    }
    /// The centre, rounded towards zero.
    constexpr CPoint CenterPoint() const noexcept {
        return {static_cast<LONG>((LONGLONG{left} + right) / 2), static_cast<LONG>((LONGLONG{top} + bottom) / 2)};
    }
    /// For calls that take a pointer.
    constexpr operator LPRECT() noexcept {
        return this;
    }
    constexpr operator LPCRECT() const noexcept {
        return this;
    }

    /// Whether the rectangle has no area: width or height is 0 or negative.
    constexpr BOOL IsRectEmpty() const noexcept {
        return left >= right || top >= bottom;
    }
    /// Whether all four coordinates are 0.
    constexpr BOOL IsRectNull() const noexcept {
        return left == 0 && top == 0 && right == 0 && bottom == 0;
    }
    /// Whether the point lies inside: on the left or top edge counts, on the right or bottom edge does not.
    constexpr BOOL PtInRect(POINT point) const noexcept {
        return point.x >= left && point.x < right && point.y >= top && point.y < bottom;
    }
    /// Whether all four edges are the same.
    constexpr BOOL EqualRect(LPCRECT rect) const noexcept {
        return left == rect->left && top == rect->top && right == rect->right && bottom == rect->bottom;
    }

    /// Sets the edges, or all of them to 0.
    /// @{
    constexpr void SetRect(int newLeft, int newTop, int newRight, int newBottom) noexcept {
        *this = CRect(newLeft, newTop, newRight, newBottom);
    }
    constexpr void SetRect(POINT topLeft, POINT bottomRight) noexcept {
        *this = CRect(topLeft, bottomRight);
    }
    constexpr void SetRectEmpty() noexcept {
        *this = CRect();
    }
    /// @}
    /// Becomes a copy.
    constexpr void CopyRect(LPCRECT rect) noexcept {
        *this = CRect(rect);
    }
    /// Swaps edges so that left <= right and top <= bottom.
    constexpr void NormalizeRect() noexcept {
        *this = CRect(left < right ? left : right, top < bottom ? top : bottom, left < right ? right : left,
                      top < bottom ? bottom : top);
    }
    /// Moves each edge outwards: `dx` on the left and right, `dy` at the top and bottom. Negative moves inwards.
    constexpr void InflateRect(int dx, int dy) noexcept {
        InflateRect(dx, dy, dx, dy);
    }
    constexpr void InflateRect(SIZE size) noexcept {
        InflateRect(size.cx, size.cy);
    }
    /// Moves each edge outwards by the matching edge of `rect`.
    constexpr void InflateRect(LPCRECT rect) noexcept {
        InflateRect(rect->left, rect->top, rect->right, rect->bottom);
    }
    constexpr void InflateRect(int leftBy, int topBy, int rightBy, int bottomBy) noexcept {
        *this = CRect(tvx::wrappingSubtract(left, leftBy), tvx::wrappingSubtract(top, topBy),
                      tvx::wrappingAdd(right, rightBy), tvx::wrappingAdd(bottom, bottomBy));
    }
    /// Moves each edge inwards: the opposite of InflateRect.
    constexpr void DeflateRect(int dx, int dy) noexcept {
        DeflateRect(dx, dy, dx, dy);
    }
    constexpr void DeflateRect(SIZE size) noexcept {
        DeflateRect(size.cx, size.cy);
    }
    constexpr void DeflateRect(LPCRECT rect) noexcept {
        DeflateRect(rect->left, rect->top, rect->right, rect->bottom);
    }
    constexpr void DeflateRect(int leftBy, int topBy, int rightBy, int bottomBy) noexcept {
        *this = CRect(tvx::wrappingAdd(left, leftBy), tvx::wrappingAdd(top, topBy),
                      tvx::wrappingSubtract(right, rightBy), tvx::wrappingSubtract(bottom, bottomBy));
    }
    /// Moves the rectangle; its size stays.
    constexpr void OffsetRect(int dx, int dy) noexcept {
        *this = CRect(tvx::wrappingAdd(left, dx), tvx::wrappingAdd(top, dy), tvx::wrappingAdd(right, dx),
                      tvx::wrappingAdd(bottom, dy));
    }
    constexpr void OffsetRect(POINT point) noexcept {
        OffsetRect(point.x, point.y);
    }
    constexpr void OffsetRect(SIZE size) noexcept {
        OffsetRect(size.cx, size.cy);
    }
    /// Moves the rectangle so that its left edge lies at `x`; its size stays.
    constexpr void MoveToX(int x) noexcept {
        OffsetRect(tvx::wrappingSubtract(x, left), 0);
    }
    /// Moves the rectangle so that its top edge lies at `y`.
    constexpr void MoveToY(int y) noexcept {
        OffsetRect(0, tvx::wrappingSubtract(y, top));
    }
    /// Moves the rectangle so that its upper left corner lies there.
    constexpr void MoveToXY(int x, int y) noexcept {
        MoveToX(x);
        MoveToY(y);
    }
    constexpr void MoveToXY(POINT point) noexcept {
        MoveToXY(point.x, point.y);
    }

    /// Becomes the part that both rectangles share; all zero and FALSE when they share none.
    constexpr BOOL IntersectRect(LPCRECT first, LPCRECT second) noexcept {
        const CRect common(first->left > second->left ? first->left : second->left,
                           first->top > second->top ? first->top : second->top,
                           first->right < second->right ? first->right : second->right,
                           first->bottom < second->bottom ? first->bottom : second->bottom);
        *this = CRect(first).IsRectEmpty() || CRect(second).IsRectEmpty() || common.IsRectEmpty() ? CRect() : common;
        return !IsRectEmpty();
    }
    /// Becomes the smallest rectangle that holds both; an empty one adds nothing. FALSE when both are empty.
    constexpr BOOL UnionRect(LPCRECT first, LPCRECT second) noexcept {
        const CRect a(first);
        const CRect b(second);
        if (a.IsRectEmpty() || b.IsRectEmpty()) {
            *this = !a.IsRectEmpty() ? a : !b.IsRectEmpty() ? b : CRect();
        } else {
            *this = CRect(a.left < b.left ? a.left : b.left, a.top < b.top ? a.top : b.top,
                          a.right > b.right ? a.right : b.right, a.bottom > b.bottom ? a.bottom : b.bottom);
        }
        return !IsRectEmpty();
    }
    /// Becomes `first` without the part under `second`, where what is left is a rectangle: `second` must cover `first`
    /// completely in one direction. Else it becomes `first`. FALSE when nothing is left.
    constexpr BOOL SubtractRect(LPCRECT first, LPCRECT second) noexcept {
        const CRect whole(first);
        CRect common;
        CRect rest = whole;
        if (common.IntersectRect(first, second)) {
            if (common.top == whole.top && common.bottom == whole.bottom) {
                if (common.left == whole.left) {
                    rest.left = common.right;
                } else if (common.right == whole.right) {
                    rest.right = common.left;
                }
            } else if (common.left == whole.left && common.right == whole.right) {
                if (common.top == whole.top) {
                    rest.top = common.bottom;
                } else if (common.bottom == whole.bottom) {
                    rest.bottom = common.top;
                }
            }
        }
        *this = rest.IsRectEmpty() ? CRect() : rest;
        return !IsRectEmpty();
    }

    /// Moving by a point or size; moving the edges by those of a rectangle (+ outwards, - inwards); & is
    /// IntersectRect, | is UnionRect.
    /// @{
    constexpr CRect& operator+=(POINT point) noexcept {
        OffsetRect(point);
        return *this;
    }
    constexpr CRect& operator+=(SIZE size) noexcept {
        OffsetRect(size);
        return *this;
    }
    constexpr CRect& operator+=(LPCRECT rect) noexcept {
        InflateRect(rect);
        return *this;
    }
    constexpr CRect& operator-=(POINT point) noexcept {
        OffsetRect(-CPoint(point));
        return *this;
    }
    constexpr CRect& operator-=(SIZE size) noexcept {
        OffsetRect(-CSize(size));
        return *this;
    }
    constexpr CRect& operator-=(LPCRECT rect) noexcept {
        DeflateRect(rect);
        return *this;
    }
    constexpr CRect& operator&=(const RECT& rect) noexcept {
        IntersectRect(this, &rect);
        return *this;
    }
    constexpr CRect& operator|=(const RECT& rect) noexcept {
        UnionRect(this, &rect);
        return *this;
    }
    friend constexpr CRect operator+(const CRect& rect, POINT point) noexcept {
        return CRect(rect) += point;
    }
    friend constexpr CRect operator+(const CRect& rect, SIZE size) noexcept {
        return CRect(rect) += size;
    }
    friend constexpr CRect operator+(POINT point, const CRect& rect) noexcept {
        return CRect(rect) += point;
    }
    friend constexpr CRect operator+(SIZE size, const CRect& rect) noexcept {
        return CRect(rect) += size;
    }
    friend constexpr CRect operator+(const CRect& rect, LPCRECT by) noexcept {
        return CRect(rect) += by;
    }
    friend constexpr CRect operator-(const CRect& rect, POINT point) noexcept {
        return CRect(rect) -= point;
    }
    friend constexpr CRect operator-(const CRect& rect, SIZE size) noexcept {
        return CRect(rect) -= size;
    }
    friend constexpr CRect operator-(const CRect& rect, LPCRECT by) noexcept {
        return CRect(rect) -= by;
    }
    friend constexpr CRect operator&(const CRect& left, const RECT& right) noexcept {
        return CRect(left) &= right;
    }
    friend constexpr CRect operator|(const CRect& left, const RECT& right) noexcept {
        return CRect(left) |= right;
    }
    /// @}
    friend constexpr bool operator==(const RECT& left, const RECT& right) noexcept {
        return CRect(left).EqualRect(&right);
    }
};

constexpr CPoint CSize::operator+(POINT point) const noexcept {
    return CPoint(point) + *this;
}
constexpr CPoint CSize::operator-(POINT point) const noexcept {
    return {tvx::wrappingSubtract(cx, point.x), tvx::wrappingSubtract(cy, point.y)};
}
