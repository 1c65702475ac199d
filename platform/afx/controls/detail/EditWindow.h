#pragma once

/// @file
/// Edit controls, of one line and of many.

#include "platform/afx/controls/detail/Control.h"
#include "platform/afx/controls/detail/FieldCommands.h"
#include "platform/afx/controls/detail/FolderCompletion.h"
#include "platform/afx/controls/detail/HostText.h"
#include "platform/afx/controls/detail/TextField.h"

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
    /// Has the names of folders completed; see SHAutoComplete. False for a control of many lines.
    bool completeFolders();

protected:
    QWidget* makeWidget(QWidget* parent) override;
    void widgetMade() override;
    void styleChanged(DWORD oldStyle, DWORD oldExStyle) override;
    void focusMoved(bool got) override;
    QPalette ownPalette() const override;
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
    void insert(QString text, Source source, Undo undo = Undo::Keep);
    void paste();
    FieldControl fieldControl();
    FieldEvents fieldEvents();
    void select(LONG_PTR start, LONG_PTR end);
    LRESULT selectedBytes(WPARAM start, LPARAM end) const;
    LRESULT copyLine(int number, char* buffer) const;
    bool hasLine(int number) const;
    std::unique_ptr<TextField> m_field;
    std::unique_ptr<FolderCompletion> m_completion; ///< null where nothing is completed
    int m_limit;
    WPARAM m_passwordChar = 0;
    int m_quiet = 0;
};

} // namespace tvx::afx
