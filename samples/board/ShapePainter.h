#pragma once

#include "Drawing.h"
#include "afxwin.h"

/// Draws one shape.
void DrawShape(CDC& dc, const board::Shape& shape);
