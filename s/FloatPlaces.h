#pragma once

#include "afxwin.h"

/// Where the windows of floating views stood last, by the number of their resources: the next window from the same
/// resources comes up as large, there, or a step beside one that stands there. Kept in the settings over restarts.
class FloatPlaces {
public:
    /// Shows a new frame where one of its kind stood last; without that over the place that its view comes from, as
    /// large. Always on a screen that is there, and large enough to be seen.
    /// @param from the former frame's rectangle on the screen
    static void show(CFrameWnd& frame, unsigned int resourceId, const CRect& from);
    /// Keeps the place of a frame that is about to go.
    static void remember(const CFrameWnd& frame, unsigned int resourceId);
    /// Writes the places that have changed to the settings.
    static void save();
};
