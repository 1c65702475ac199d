#pragma once

/// @file
/// The panes of status bars.

#include "platform/base/Export.h"
#include "platform/base/String.h"

#include <QWidget>

namespace tvx::afx {

/// One pane: a border and a line of text, which ends in "…" where there is no room for all of it.
///
/// Texts come in rows, from loops of the host's, and few of them are ever seen: a text is kept as it came until
/// somebody looks at it.
class TVX_PLATFORM_API StatusPane : public QWidget {
public:
    explicit StatusPane(QWidget* bar);

    /// @param style SBPS_... @param textWidth width of the text area that the pane asks for
    void setShape(unsigned style, int textWidth);
    /// The width of the pane that it asks for.
    [[nodiscard]] int wantedWidth() const;
    [[nodiscard]] bool stretches() const;

    /// Keeps a text. It is seen when the pane is next painted.
    void setText(const CString& text);
    /// Whether the text is the one that was painted last.
    [[nodiscard]] bool isPainted() const {
        return m_isPainted;
    }
    /// Asks for a paint if it is not.
    void showSoon();
    /// Paints such a text at once, and nothing else of the window.
    void showNow();
    /// What the pane shows; the whole of a text that is cut off.
    [[nodiscard]] const QString& text() const;
    [[nodiscard]] bool isCut() const;

protected:
    void paintEvent(QPaintEvent* event) override;

private:
    [[nodiscard]] QRect textArea() const;
    void painted();

    unsigned m_style = 0;
    int m_textWidth = 0;
    CString m_given;               ///< the text as it came
    mutable QString m_text;        ///< the same for the toolkit
    mutable bool m_isTaken = true; ///< whether m_text follows m_given
    QString m_told;                ///< what assistive tools were told of last
    bool m_isPainted = true;
    bool m_isAskedFor = false; ///< whether a paint is on its way
};

/// Height of a pane in a font.
[[nodiscard]] int statusPaneHeight(const QFontMetrics& metrics);

} // namespace tvx::afx
