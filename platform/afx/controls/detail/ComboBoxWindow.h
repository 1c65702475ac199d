#pragma once

/// @file
/// Combo boxes.

#include "platform/afx/controls/detail/FieldCommands.h"
#include "platform/afx/controls/detail/ListControl.h"

class QAbstractItemModel;
class QComboBox;
class QLineEdit;

namespace tvx::afx {

class ComboModel;

/// The "ComboBox" class. Its height in templates and calls is that of the opened box; closed it is one line high. A box
/// whose list is always open (CBS_SIMPLE) opens its list like the others.
class TVX_PLATFORM_API ComboBoxWindow : public ListControl {
public:
    explicit ComboBoxWindow(const CREATESTRUCT& cs);
    ~ComboBoxWindow() override;
    LRESULT defaultProc(UINT message, WPARAM wParam, LPARAM lParam) override;
    void setWindowRect(const QRect& rect) override;
    QString text() const override;
    void setText(const QString& text) override;
    UINT dialogCode(const MSG* msg) const override;
    UINT colorMessage() const override;

    bool isEditable() const {
        return (style() & 3U) != CBS_DROPDOWNLIST;
    }
    int itemHeight() const {
        return m_itemHeight;
    }
    /// Has the parent paint line `index` into a picture of this size.
    QImage paintItem(int index, QSize size, UINT state);
    /// The user opened or closed the list.
    void listShown(bool shown);

protected:
    QWidget* makeWidget(QWidget* parent) override;
    void widgetMade() override;
    void fontChanged() override;
    void focusMoved(bool got) override;

private:
    QComboBox* box() const;
    QLineEdit* field() const;
    void makeField(QWidget* face);
    FieldControl fieldControl();
    std::optional<LRESULT> editProc(UINT message, WPARAM wParam, LPARAM lParam);
    void paste();
    void measure();
    int fieldHeight() const;
    void setItemHeight(int height);
    void applyHeights();
    void chosen(int index);
    LRESULT add(LONG_PTR index, LPARAM text, bool sorted);
    LRESULT addDrives(WPARAM attributes);
    LRESULT removeItem(LONG_PTR index);
    void reset();
    LRESULT setCurrent(LONG_PTR index);
    LRESULT itemProc(UINT message, WPARAM wParam, LPARAM lParam, bool& known);
    LRESULT listProc(UINT message, WPARAM wParam, LPARAM lParam, bool& known);
    LRESULT fieldProc(UINT message, WPARAM wParam, LPARAM lParam, bool& known);
    std::unique_ptr<ComboModel> m_model;
    std::unique_ptr<TextField> m_field;      ///< Null for a box that is not typed into.
    QAbstractItemModel* m_noLines = nullptr; ///< Of the widget, for the time after this window.
    int m_itemHeight = 15;
    int m_openHeight = 0;
    bool m_chosenWhileOpen = false;
};

} // namespace tvx::afx
