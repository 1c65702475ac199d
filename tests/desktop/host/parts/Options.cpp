// Options.cpp : the dialog of the options

#include "..\stdafx.h"
#include "options.h"

COptions::COptions(CWnd* pParent /*=NULL*/)
    : CDialog(COptions::IDD, pParent)
{
    //{{AFX_DATA_INIT(COptions)
    m_strName = _T("");
    m_nCurrency = -1;
    //}}AFX_DATA_INIT
}

void COptions::DoDataExchange(CDataExchange* pDX)
{
    CDialog::DoDataExchange(pDX);
    //{{AFX_DATA_MAP(COptions)
    DDX_Control(pDX, IDC_CURRENCY, m_wndCurrency);
    DDX_Text(pDX, IDC_NAME, m_strName);
    DDV_MaxChars(pDX, m_strName, 20);
    DDX_CBIndex(pDX, IDC_CURRENCY, m_nCurrency);
    //}}AFX_DATA_MAP
}

BEGIN_MESSAGE_MAP(COptions, CDialog)
    //{{AFX_MSG_MAP(COptions)
    ON_CBN_SELENDOK(IDC_CURRENCY, OnSelendokCurrency)
    //}}AFX_MSG_MAP
END_MESSAGE_MAP()

BOOL COptions::OnInitDialog()
{
    static LPCTSTR names[] = { _T("Crowns"), _T("Guilders"), _T("Thalers") };
    CDialog::OnInitDialog();
    for (int i = 0; i < (int)_countof(names); i++)
        m_wndCurrency.AddString(names[i]);
    m_wndCurrency.SetCurSel(0);
    return TRUE;  // return TRUE unless you set the focus to a control
}

void COptions::OnSelendokCurrency()
{
    CString strCurrency;
    m_wndCurrency.GetLBText(m_wndCurrency.GetCurSel(), strCurrency);
    SetDlgItemText(IDC_SHOWN, _T("Amounts are in ") + strCurrency);
}
