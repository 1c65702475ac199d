#pragma once

#include "platform/win/Background.h"
#include "platform/win/FolderNames.h"
#include "s/DirDlg.h"
#include "s/FileName.h"

/// The image-list functions of the common controls' library, each null where it is missing.
struct ImageListFunctions {
    /// Loads the library, which lives as long as the object.
    ImageListFunctions();
    ~ImageListFunctions();
    ImageListFunctions(const ImageListFunctions&) = delete;
    ImageListFunctions& operator=(const ImageListFunctions&) = delete;

    /// As the functions of those names.
    HMODULE module = nullptr;
    COLORREF (*setBkColor)(HIMAGELIST list, COLORREF color) = nullptr;
    BOOL (*getImageInfo)(HIMAGELIST list, int index, IMAGEINFO* info) = nullptr;
    BOOL (*draw)(HIMAGELIST list, int index, HDC dc, int x, int y, UINT style) = nullptr;
};

/// What the dialog knows.
struct Gui_DirDlg::Record {
    /// What OK is told of the directory.
    enum class Verdict { Fine, Missing, ReadOnly };
    /// Places in the image list of folders.
    enum FolderImage { PathImage, CurrentImage, SubdirectoryImage };

    /// The dialog, its pictures and what it was made with.
    Gui_DirDlg* dialog = nullptr;
    CImageList driveImages;
    CImageList folderImages;
    Gui_FileName directory; ///< the current choice; only its mount and path count
    CString title;
    unsigned int helpId = 0;
    int validate = 1;
    int mustExist = 1;
    int mustBeWritable = 1;

    /// Its controls.
    CTreeCtrl tree;
    CComboBox drives;
    CString shownName;           ///< what the field was given: what differs from it was typed
    HTREEITEM current = nullptr; ///< the tree's item of the directory
    CString toSelect;            ///< the subdirectory to be selected when they have been read
    CString newFolder;           ///< the name of the folder that is being made
    ImageListFunctions imageLists;

    /// What was asked and is not answered yet. A question that is dropped is answered to nobody.
    tvx::Question<tvx::FolderNames> listing;
    tvx::Question<Verdict> verdict;
    tvx::Question<DWORD> creation; ///< the error, 0 for none

    /// Milliseconds for which an answer is waited for: a disk of this machine answers sooner, and what takes longer
    /// must not keep the window from being used.
    static constexpr DWORD patience = 50;

    /// The messages that tell of answers.
    inline static const UINT listed = RegisterWindowMessageA("Gui_DirDlg.listed");
    inline static const UINT checked = RegisterWindowMessageA("Gui_DirDlg.checked");
    inline static const UINT created = RegisterWindowMessageA("Gui_DirDlg.created");

    /// Whether an answer has come. Otherwise the dialog is told of it by a message.
    template <class Answer>
    bool isAnswered(const tvx::Question<Answer>& question, UINT message) const;
};

#include "platform/afx/core/HandleWatch.h"

template <class Answer>
bool Gui_DirDlg::Record::isAnswered(const tvx::Question<Answer>& question, UINT message) const {
    if (question.isAnswered(patience)) {
        return true;
    }
    const HANDLE handle = question.handle();
    tvx::postWhenSignalled({&handle, 1}, dialog->m_hWnd, message, INFINITE);
    return false;
}
