// LedgerDoc.h : interface of the CLedgerDoc class

class CLedgerDoc : public CDocument
{
protected: // create from serialization only
    DECLARE_DYNCREATE(CLedgerDoc)

public:
    CString m_strText;          // lines with "\n" between them
    void AddLine(LPCTSTR lpszLine);
    virtual void DeleteContents() { m_strText.Empty(); }
    virtual void Serialize(CArchive& ar);
};
