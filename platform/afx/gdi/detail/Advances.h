#pragma once

#include "platform/base/Export.h"

#include <QFontMetricsF>

#include <array>
#include <memory>
#include <optional>
#include <string_view>

namespace tvx::afx {

/// Widths of texts in one font, character by character: a hundredth of the time that the toolkit takes for a text.
///
/// Fonts of the layer have no kerning and no ligatures, and whole advances; a text in which no character's shape
/// depends on its neighbours is as wide as its characters together. Other texts, and fonts with broken advances, are
/// left to the toolkit. Like all drawing it belongs to one thread.
class TVX_PLATFORM_API Advances {
public:
    explicit Advances(const QFontMetricsF& metrics) : m_metrics(metrics) {}

    /// Pixels; nothing for a text that has to be measured as a whole.
    /// @param text UTF-8
    std::optional<int> widthOf(std::string_view text) const;

private:
    using Advance = short;
    static constexpr Advance unknown = -1;
    static constexpr Advance unfit = -2;
    using Page = std::array<Advance, 256>;

    Advance of(char32_t character) const;
    Advance measured(char32_t character) const;

    QFontMetricsF m_metrics;
    mutable std::array<std::unique_ptr<Page>, 256> m_pages; ///< of the basic plane
};

} // namespace tvx::afx
