#pragma once

#include "afxwin.h"

/// What the user of the board has chosen in its preferences. Colours are COLORREFs, lengths pixels.
struct Options {
    // the grid
    BOOL gridShown = TRUE;
    int gridDistance = 10; ///< 0 to 1000; 0: none
    BOOL snap = TRUE;      ///< Whether what is drawn keeps to the grid.
    // colours of the window
    COLORREF paper = RGB(255, 255, 255);
    COLORREF gridColor = RGB(200, 205, 210);
    COLORREF handles = RGB(32, 64, 128);
    // shapes that are drawn from now on
    COLORREF outline = RGB(0, 0, 0);
    BOOL filled = FALSE;
    COLORREF fill = RGB(255, 255, 255);
    int lineWidth = 2; ///< 1 to 20
    // texts
    CString textFont = "Arial"; ///< The typeface of all texts.
    BOOL textBold = FALSE;
    BOOL textItalic = FALSE;
    int textSize = 16; ///< Height of new texts, 4 to 400.
    // the console
    BOOL keepCommands = TRUE;
    BOOL showStatus = TRUE;

    static constexpr int maxGrid = 1000;
    static constexpr int maxLineWidth = 20;

    /// The font of all texts, in a height in pixels.
    LOGFONT GetTextFont(int height) const;

    /// What is stored; a value that is missing or out of its bounds is the one that the board comes with.
    static Options Read();
    /// Stores what differs from `before`. The rest stays as it is stored: another board may have changed it meanwhile,
    /// or it holds for this run only.
    void Write(const Options& before) const;
};
