#pragma once

#include "ColorButton.h"
#include "Options.h"
#include "samples/family/Preferences.h"

/// The preferences of the board: its own pages, and those of the family.
class CBoardPreferences : public CPreferences {
public:
    explicit CBoardPreferences(CWnd* parent);
    Options& GetOptions() {
        return m_options;
    }

    void EditKeys() override;
    int CountOwnKeys() const override;
    void ResetKeys() override;

protected:
    void StoreOwn() override;

private:
    Options m_options;
};

/// A page of the board's own.
class CBoardPage : public CPreferencePage {
protected:
    CBoardPage(UINT templateId, CBoardPreferences& sheet) : CPreferencePage(templateId, sheet) {}
    Options& GetOptions() const {
        return static_cast<CBoardPreferences&>(GetPreferences()).GetOptions();
    }
};

/// Shapes that are drawn from now on.
class CShapesPage : public CBoardPage {
public:
    explicit CShapesPage(CBoardPreferences& sheet);

protected:
    void DoDataExchange(CDataExchange* dx) override;
    void SetDefaults() override;
    afx_msg void OnFilled();
    DECLARE_MESSAGE_MAP()

private:
    void ShowState();

    CColorButton m_outline;
    CColorButton m_fill;
};

class CGridPage : public CBoardPage {
public:
    explicit CGridPage(CBoardPreferences& sheet);

protected:
    void DoDataExchange(CDataExchange* dx) override;
    void SetDefaults() override;
};

/// Colours of the drawing's window.
class CColorsPage : public CBoardPage {
public:
    explicit CColorsPage(CBoardPreferences& sheet);

protected:
    void DoDataExchange(CDataExchange* dx) override;
    void SetDefaults() override;

private:
    CColorButton m_paper;
    CColorButton m_grid;
    CColorButton m_handles;
};

/// The font of texts, with a sample of it.
class CFontsPage : public CBoardPage {
public:
    explicit CFontsPage(CBoardPreferences& sheet);

protected:
    void DoDataExchange(CDataExchange* dx) override;
    void SetDefaults() override;
    afx_msg void OnChooseFont();
    DECLARE_MESSAGE_MAP()

private:
    static void TakeFont(Options& to, const Options& from);
    void ShowFont();

    Options m_shown; ///< What the sample shows; only the font counts.
    CFont m_sample;
};

class CConsolePage : public CBoardPage {
public:
    explicit CConsolePage(CBoardPreferences& sheet);

protected:
    void DoDataExchange(CDataExchange* dx) override;
    void SetDefaults() override;
};
