#pragma once

/// @file
/// Positions in edited texts as hosts count them, in bytes of UTF-8 with "\r\n" between lines, and as the toolkit does,
/// in units of UTF-16 with one unit between lines.

#include "platform/base/Export.h"

#include <QString>

#include <deque>
#include <vector>

namespace tvx::afx {

/// Bytes that the first `units` of a text take for hosts: its line ends are "\r\n" there.
TVX_PLATFORM_API int hostBytes(const QString& text, int units);
/// The same for all of it.
TVX_PLATFORM_API int hostBytes(const QString& text);
/// The position in the toolkit's units of a host's byte position; one within a character is moved to its beginning.
TVX_PLATFORM_API int toolkitUnits(const QString& text, int bytes);

/// A text with "\n" between its lines, whatever stood there.
TVX_PLATFORM_API QString plainLines(QString text);

/// What a field of one line takes of a text: up to its first line end, however that is written.
TVX_PLATFORM_API QString firstLine(const QString& text);

/// The bytes of each paragraph of a long text, its line end included, so that positions are found without going through
/// the text. The last paragraph has no line end but is counted with one.
class TVX_PLATFORM_API ParagraphBytes {
public:
    static constexpr int lineEnd = 2;

    int count() const {
        return static_cast<int>(m_sizes.size());
    }
    /// Bytes of the whole text.
    int total() const {
        return m_total - lineEnd;
    }
    /// Puts other paragraphs into the place of `removed` ones from `first` on.
    void replace(int first, int removed, const std::vector<int>& sizes);
    /// Bytes before a paragraph.
    int before(int paragraph) const;

    struct Place {
        int paragraph = 0;
        int bytes = 0; ///< from its beginning
    };
    /// The paragraph that a byte lies in; positions beyond the text lie at its end.
    Place find(int bytes) const;

private:
    std::deque<int> m_sizes;
    int m_total = 0;
};

} // namespace tvx::afx
