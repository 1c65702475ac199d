#pragma once

#include "FileText.h"
#include "afxwin.h"

/// A text with its file. What is typed lives in the view's control until the text is saved.
class CNotesDoc : public CDocument {
    DECLARE_DYNCREATE(CNotesDoc)

public:
    /// The text as it was read or saved last.
    const FileText& GetText() const {
        return m_text;
    }

    BOOL OnOpenDocument(LPCSTR path) override;
    BOOL OnSaveDocument(LPCSTR path) override;
    void Serialize(CArchive& archive) override;
    void DeleteContents() override;

private:
    /// Whether somebody else has written the document's file since it was read or saved.
    bool hasChangedFile(LPCSTR path) const;

    FileText m_text;
    /// What is being written.
    std::string m_bytes;
};
