#pragma once

#include "afx.h"

/// What the layout of a query dialog is computed from, in pixels.
struct QueryMeasures {
    CSize margin;       ///< seven dialog units of the system font each way
    CSize prompt;       ///< its text
    CSize promptClient; ///< the prompt control as the template has it
    CSize field;        ///< width as asked for, height of the field's client area
    CSize button;
    bool hasHelp = false;
    int widest = 0; ///< the most the contents may take; the prompt and the field are cut down to it
};

/// Where everything in a query dialog stands, in pixels from the corner of the client area.
struct QueryLayout {
    CRect prompt; ///< left of the field, in the middle of its height unless it is the higher one
    CRect field;  ///< takes what the prompt leaves of the row, one pixel at least
    CPoint ok;    ///< the buttons are placed, their size is the template's
    CPoint cancel;
    CPoint help;  ///< not used by a dialog without help
    CSize dialog; ///< the whole window
};

/// The width the prompt can have beside a field of the width asked for. A prompt that needs more is wrapped.
int WidestPrompt(const QueryMeasures& measures);

/// Places the controls. A prompt higher than the field pushes the buttons down.
QueryLayout LayOutQuery(const QueryMeasures& measures);
