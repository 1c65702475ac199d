// LedgerDoc.cpp : implementation of the CLedgerDoc class

#include "stdafx.h"
#include "ledgerdoc.h"

IMPLEMENT_DYNCREATE(CLedgerDoc, CDocument)

void CLedgerDoc::AddLine(LPCTSTR lpszLine)
{
    m_strText = m_strText + lpszLine + _T("\n");
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
