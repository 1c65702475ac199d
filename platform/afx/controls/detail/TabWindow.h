#pragma once

/// @file
/// The tabs of property sheets, with the frame around the page below them.

#include "platform/afx/controls/detail/Control.h"

class QTabBar;

namespace tvx::afx {

/// The class of the layer's own that property sheets make their tabs of.
inline constexpr const char* tabClass = "TvxTabs";

/// The "TvxTabs" class. It tells its parent by WM_NOTIFY, TCN_SELCHANGE, that the user has chosen another tab. Pages
/// are siblings that lie over it.
class TVX_PLATFORM_API TabWindow : public Control {
public:
    using Control::Control;
    QWidget* focusWidget() const override;
    UINT dialogCode(const MSG* msg) const override;

    /// The tab that is in front, -1 when there is none.
    int current() const;
    /// Brings a tab to the front; nobody is told.
    void select(int index);
    /// Changes of the row; nobody is told.
    /// @param caption may mark a mnemonic with "&"
    void insert(int index, const QString& caption);
    void remove(int index);

    /// Where the page stands, in this control.
    QRect pageArea() const;
    /// The size of a control whose page has a size, without regard to the tabs' captions.
    QSize sizeAround(QSize page) const;
    /// The width at which no tab is cut.
    int tabsWidth() const;

protected:
    QWidget* makeWidget(QWidget* parent) override;

private:
    QTabBar& bar() const;
    void tell();
};

} // namespace tvx::afx
