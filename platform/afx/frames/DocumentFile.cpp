#include "platform/afx/frames/Document.h"
#include "platform/afx/frames/detail/MirrorFile.h"

#include <memory>

// The files of documents.

CFile* CDocument::GetFile(LPCSTR fileName, UINT openFlags, CFileException* error) {
    auto file = std::make_unique<tvx::afx::MirrorFile>();
    CFileException ignored;
    return file->Open(fileName, openFlags, error ? error : &ignored) ? file.release() : nullptr;
}

void CDocument::ReleaseFile(CFile* file, BOOL abort) {
    const std::unique_ptr<CFile> owned(file);
    if (abort) {
        owned->Abort();
    } else {
        owned->Close();
    }
}
