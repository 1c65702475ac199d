#pragma once

#include <QImage>
#include <QRect>
#include <QSize>

namespace tvx::afx {

/// How the source's pixels of one direction map to the target's.
struct StretchAxis {
    int from; ///< pixels of the source, above 0
    int to;   ///< pixels of the target, above 0
    bool mirrored = false;

    struct Range {
        int first;
        int last;
    };
    /// The source's pixels that make pixel `index` of the target.
    [[nodiscard]] Range sources(int index) const;
    /// The one of them in the middle.
    [[nodiscard]] int middle(int index) const;
    /// The target's pixels that pixels `first` .. `last` of the source make; `last` below `first` when there are none.
    [[nodiscard]] Range targets(int first, int last) const;
};

/// Scales and mirrors pictures as the stretching modes (BLACKONWHITE, ...) do.
struct Stretch {
    StretchAxis across;
    StretchAxis down;
    int mode;

    /// Where a part of the source comes to lie.
    [[nodiscard]] QRect placeOf(const QRect& part) const;
    /// The scaled picture of the part of the source that begins at `offset`, as large as `placeOf` says.
    [[nodiscard]] QImage apply(const QImage& part, QPoint offset) const;
};

} // namespace tvx::afx
