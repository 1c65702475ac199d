#pragma once

#include "afxwin.h"
#include "s/Export.h"

/// The base class of the family's documents. It opens its files themselves, for reading and for writing, where
/// CDocument writes beside the old file and replaces it with the last step: what is written is in the file at once, and
/// a write that fails leaves what there is of it.
///
/// @code
/// class CPlanDoc : public Gui_Document {
///     DECLARE_DYNCREATE(CPlanDoc)
/// public:
///     void Serialize(CArchive& archive) override;
/// };
/// @endcode
///
/// A document whose old file must survive a failed save derives from CDocument, or calls CDocument::GetFile for
/// writing.
class GUI_API Gui_Document : public CDocument {
    DECLARE_DYNCREATE(Gui_Document)

public:
    /// Opens the named file itself. A named pipe is refused, as by CDocument: it would wait for its other end.
    /// @param openFlags  the modes of CFile
    /// @param error      receives the reason of a failure; may be null
    /// @return a file that ReleaseFile ends; null when it cannot be opened
    CFile* GetFile(const char* fileName, unsigned int openFlags, CFileException* error) override;

protected:
    DECLARE_MESSAGE_MAP()
};
