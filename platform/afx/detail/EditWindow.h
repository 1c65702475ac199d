#pragma once

/// @file
/// Edit controls, of one line and of many.

#include "platform/afx/detail/Control.h"
#include "platform/afx/detail/TextField.h"

namespace tvx::afx {

/// The "Edit" class. What hosts see is UTF-8 with "\r\n" between lines, positions counted in its bytes.
class TVX_PLATFORM_API EditWindow : public Control {
public:
    explicit EditWindow(const CREATESTRUCT& cs);
    LRESULT defaultProc(UINT message, WPARAM wParam, LPARAM lParam) override;
    QString text() const override;
    void setText(const QString& text) override;
    QWidget* clientWidget() const override;
    UINT dialogCode(const MSG* msg) const override;
    UINT colorMessage() const override;

protected:
    QWidget* makeWidget(QWidget* parent) override;
    void widgetMade() override;
    void styleChanged(DWORD oldStyle, DWORD oldExStyle) override;
    void focusMoved(bool got) override;
    void applyColors(QPalette& palette, const QColor& text, const QColor& background) const override;

private:
    enum class Source { User, Program };
    bool isMultiLine() const {
        return (style() & ES_MULTILINE) != 0;
    }
    bool isReadOnly() const {
        return (style() & ES_READONLY) != 0;
    }
    void applyStyle();
    void changed();
    LRESULT editProc(UINT message, WPARAM wParam, LPARAM lParam, bool& known);
    LRESULT lineProc(UINT message, WPARAM wParam, LPARAM lParam, bool& known);
    bool typed(UINT message, WPARAM character);
    bool editKey(WPARAM key);
    void insert(QString text, Source source);
    void paste(bool selection);
    void select(LONG_PTR start, LONG_PTR end);
    LRESULT selectedBytes(WPARAM start, LPARAM end) const;
    LRESULT copyLine(int line, char* buffer) const;
    LRESULT showMenu(LPARAM place);
    QString lineText(const std::vector<int>& starts, std::size_t line) const;
    int lineAt(int position) const;
    std::unique_ptr<TextField> m_field;
    int m_limit;
    WPARAM m_passwordChar = 0;
    int m_quiet = 0;
};

/// Bytes that the first `units` of a text take for hosts: its line ends are "\r\n" there.
TVX_PLATFORM_API int hostBytes(const QString& text, int units);
/// The position in the toolkit's units of a host's byte position; one within a character is moved to its beginning.
TVX_PLATFORM_API int toolkitUnits(const QString& text, int bytes);

} // namespace tvx::afx
