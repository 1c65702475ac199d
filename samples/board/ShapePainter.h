#pragma once

#include "Drawing.h"
#include "afxwin.h"

/// Draws one shape.
void DrawShape(CDC& dc, const board::Shape& shape);

/// An area that holds all that is drawn of a shape, found without measuring its text.
CRect ReachOf(const board::Shape& shape);
