#include "s/Document.h"

#include <memory>

IMPLEMENT_DYNCREATE(Gui_Document, CDocument)

BEGIN_MESSAGE_MAP(Gui_Document, CDocument)
END_MESSAGE_MAP()

CFile* Gui_Document::GetFile(const char* fileName, unsigned int openFlags, CFileException* error) {
    auto file = std::make_unique<CFile>();
    return file->Open(fileName, openFlags, error) ? file.release() : nullptr;
}
