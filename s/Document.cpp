#include "s/Document.h"

#include "platform/base/SystemPath.h"

#include <cerrno>
#include <memory>

IMPLEMENT_DYNCREATE(Gui_Document, CDocument)

BEGIN_MESSAGE_MAP(Gui_Document, CDocument)
END_MESSAGE_MAP()

CFile* Gui_Document::GetFile(const char* fileName, unsigned int openFlags, CFileException* error) {
    if (tvx::isNamedPipe(fileName ? fileName : "")) {
        if (error) {
            error->m_cause = CFileException::genericException;
            error->m_lOsError = ESPIPE;
            error->m_strFileName = fileName;
        }
        return nullptr;
    }
    auto file = std::make_unique<CFile>();
    return file->Open(fileName, openFlags, error) ? file.release() : nullptr;
}
