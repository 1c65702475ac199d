// LedgerDoc.cpp : implementation of the CLedgerDoc class

#include "stdafx.h"
#include "Ledger.h"

#include "ledgerdoc.h"

IMPLEMENT_DYNCREATE(CLedgerDoc, CDocument)

CLedgerDoc::CLedgerDoc()
{
}

CLedgerDoc::~CLedgerDoc()
{
}

BOOL CLedgerDoc::OnNewDocument()
{
    if (!CDocument::OnNewDocument())
        return FALSE;
    m_strText.Empty();
    return TRUE;
}

void CLedgerDoc::AddLine(LPCTSTR lpszLine)
{
    m_strText += lpszLine;
    m_strText += _T("\n");
    SetModifiedFlag();
    UpdateAllViews(NULL);
}

void CLedgerDoc::Serialize(CArchive& ar)
{
    if (ar.IsStoring())
        ar << m_strText;
    else
        ar >> m_strText;
}
