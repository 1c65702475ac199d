#pragma once

#include "PreferencePage.h"
#include "afxdlgs.h"

/// The folder that Open and Save begin in.
class CFilesPage : public CPreferencePage {
public:
    explicit CFilesPage(CPreferences& sheet);

protected:
    BOOL OnInitDialog() override;
    void DoDataExchange(CDataExchange* dx) override;
    void SetDefaults() override;
    afx_msg void OnBrowse();
    DECLARE_MESSAGE_MAP()
};

/// The keys of commands, which have a dialog of their own.
class CKeyboardPage : public CPreferencePage {
public:
    explicit CKeyboardPage(CPreferences& sheet);

protected:
    void DoDataExchange(CDataExchange* dx) override;
    afx_msg void OnEditKeys();
    afx_msg void OnResetKeys();
    DECLARE_MESSAGE_MAP()
};

/// Where help comes from.
class CHelpPage : public CPreferencePage {
public:
    explicit CHelpPage(CPreferences& sheet);

protected:
    BOOL OnInitDialog() override;
    void DoDataExchange(CDataExchange* dx) override;
    void SetDefaults() override;
};

/// Versions and folders, to be copied into a question to the support.
class CInstallationPage : public CPreferencePage {
public:
    explicit CInstallationPage(CPreferences& sheet);

protected:
    void DoDataExchange(CDataExchange* dx) override;
    afx_msg void OnCopy();
    DECLARE_MESSAGE_MAP()

private:
    CString m_facts;
};

/// What a page that was written for a sheet with tabs does when it is told of something.
void OnTabPage(Gui_PropItem* item, CWnd* page, Gui_PropItem::Notification what);
