#include "platform/afx/gdi/detail/Stretch.h"

#include "platform/afx/gdi/GdiTypes.h"
#include "platform/afx/gdi/detail/RasterOps.h"

#include <algorithm>
#include <cstdint>

namespace tvx::afx {

StretchAxis::Range StretchAxis::sources(int index) const {
    const std::int64_t place = mirrored ? to - 1 - index : index;
    const auto first = static_cast<int>(place * from / to);
    const auto last = static_cast<int>(((place + 1) * from - 1) / to);
    return {first, std::max(first, to >= from ? first : last)};
}

int StretchAxis::middle(int index) const {
    const std::int64_t place = mirrored ? to - 1 - index : index;
    return static_cast<int>((2 * place + 1) * from / (2 * std::int64_t{to}));
}

StretchAxis::Range StretchAxis::targets(int first, int last) const {
    const auto left = static_cast<int>((std::int64_t{first} * to + from - 1) / from);
    const auto right = static_cast<int>(((std::int64_t{last} + 1) * to + from - 1) / from - 1);
    return mirrored ? Range{to - 1 - right, to - 1 - left} : Range{left, right};
}

namespace {

/// The pixels of a part of a source, by their places in the whole.
class PartReader {
public:
    PartReader(const QImage& part, QPoint offset) : m_part(part), m_area(offset, part.size()) {}
    [[nodiscard]] Pixel at(int x, int y) const {
        const int column = std::clamp(x, m_area.left(), m_area.right()) - m_area.left();
        const int row = std::clamp(y, m_area.top(), m_area.bottom()) - m_area.top();
        return reinterpret_cast<const Pixel*>(m_part.constScanLine(row))[column];
    }

private:
    const QImage& m_part;
    QRect m_area;
};

/// Makes one pixel out of several.
class PixelSum {
public:
    explicit PixelSum(int mode) : m_mode(mode) {}
    void add(Pixel pixel) {
        m_all &= pixel;
        m_any |= pixel;
        for (int channel = 0; channel < 3; ++channel) {
            m_sums[channel] += (pixel >> (8 * channel)) & 0xFF;
        }
        ++m_count;
    }
    [[nodiscard]] Pixel result() const {
        // By bits: black figures survive on white ground when they are made smaller, or white ones on black.
        if (m_mode == BLACKONWHITE) {
            return opaque | m_all;
        }
        if (m_mode == WHITEONBLACK) {
            return opaque | m_any;
        }
        Pixel mean = opaque;
        for (int channel = 0; channel < 3; ++channel) {
            mean |= static_cast<Pixel>((m_sums[channel] + m_count / 2) / m_count) << (8 * channel);
        }
        return mean;
    }

private:
    int m_mode;
    Pixel m_all = whitePixel;
    Pixel m_any = 0;
    std::uint64_t m_sums[3] = {};
    std::uint64_t m_count = 0;
};

Pixel combinedPixel(const PartReader& reader, StretchAxis::Range columns, StretchAxis::Range rows, int mode) {
    PixelSum sum(mode);
    for (int y = rows.first; y <= rows.last; ++y) {
        for (int x = columns.first; x <= columns.last; ++x) {
            sum.add(reader.at(x, y));
        }
    }
    return sum.result();
}

} // namespace

QRect Stretch::placeOf(const QRect& part) const {
    const StretchAxis::Range columns = across.targets(part.left(), part.right());
    const StretchAxis::Range rows = down.targets(part.top(), part.bottom());
    return {QPoint(columns.first, rows.first), QPoint(columns.last, rows.last)};
}

QImage Stretch::apply(const QImage& part, QPoint offset) const {
    const QRect place = placeOf(QRect(offset, part.size()));
    QImage result(place.size(), QImage::Format_RGB32);
    const PartReader reader(part, offset);
    for (int y = 0; y < result.height(); ++y) {
        auto* row = reinterpret_cast<Pixel*>(result.scanLine(y));
        for (int x = 0; x < result.width(); ++x) {
            const int column = place.left() + x;
            const int line = place.top() + y;
            row[x] = mode == COLORONCOLOR ? reader.at(across.middle(column), down.middle(line))
                                          : combinedPixel(reader, across.sources(column), down.sources(line), mode);
        }
    }
    return result;
}

} // namespace tvx::afx
