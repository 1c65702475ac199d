#pragma once

#include "Drawing.h"
#include "Options.h"

/// Draws one shape.
/// @param options the font of texts
void DrawShape(CDC& dc, const board::Shape& shape, const Options& options);

/// A colour as drawings hold it.
board::Color FromColorRef(COLORREF color);

/// An area that holds all that is drawn of a shape, found without measuring its text.
CRect ReachOf(const board::Shape& shape);
