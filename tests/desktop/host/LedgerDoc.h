// LedgerDoc.h : interface of the CLedgerDoc class

#if !defined(AFX_LEDGERDOC_H__4C1D7B29_INCLUDED_)
#define AFX_LEDGERDOC_H__4C1D7B29_INCLUDED_

class CLedgerDoc : public CDocument
{
protected: // create from serialization only
    CLedgerDoc();
    DECLARE_DYNCREATE(CLedgerDoc)

public:
    CString m_strText;          // lines with "\n" between them
    void AddLine(LPCTSTR lpszLine);

    //{{AFX_VIRTUAL(CLedgerDoc)
    public:
    virtual BOOL OnNewDocument();
    virtual void Serialize(CArchive& ar);
    //}}AFX_VIRTUAL
    virtual ~CLedgerDoc();
};

#endif // !defined(AFX_LEDGERDOC_H__4C1D7B29_INCLUDED_)
