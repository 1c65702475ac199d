#pragma once

#include "Drawing.h"
#include "afxwin.h"

/// Draws one shape.
/// @param textFont the typeface of texts
void DrawShape(CDC& dc, const board::Shape& shape, const CString& textFont);

/// A colour as drawings hold it.
board::Color FromColorRef(COLORREF color);

/// An area that holds all that is drawn of a shape, found without measuring its text.
CRect ReachOf(const board::Shape& shape);
