#include "s/DirDlg.h"

#include "platform/base/SystemPath.h"
#include "res/resource.h"
#include "s/DirDlgRecord.h"
#include "s/Help.h"
#include "s/Record.h"
#include "s/StringOf.h"

#include <shlwapi.h>

BEGIN_MESSAGE_MAP(Gui_DirDlg, CDialog)
ON_CBN_SELCHANGE(GUI_IDC_DIR_DRIVES, &Gui_DirDlg::OnSelchangeDrivecombo)
ON_NOTIFY(NM_DBLCLK, GUI_IDC_DIR_TREE, &Gui_DirDlg::OnDblclkDirpathtree)
ON_NOTIFY(TVN_SELCHANGED, GUI_IDC_DIR_TREE, &Gui_DirDlg::OnSelchangedTree)
ON_EN_CHANGE(GUI_IDC_DIR_NAME, &Gui_DirDlg::OnChangeName)
ON_BN_CLICKED(GUI_IDC_DIR_HIDDEN, &Gui_DirDlg::OnShowHidden)
ON_BN_CLICKED(GUI_IDC_DIR_NEW, &Gui_DirDlg::OnNewFolder)
ON_BN_CLICKED(GUI_IDC_HELP, &Gui_DirDlg::OnHelp)
ON_WM_DRAWITEM()
ON_WM_HELPINFO()
ON_WM_SETCURSOR()
ON_REGISTERED_MESSAGE(Record::listed, &Gui_DirDlg::OnListed)
ON_REGISTERED_MESSAGE(Record::checked, &Gui_DirDlg::OnChecked)
ON_REGISTERED_MESSAGE(Record::created, &Gui_DirDlg::OnCreated)
END_MESSAGE_MAP()

namespace {

constexpr const char* driveImages = "CDDIRDLGBMP";
constexpr const char* folderImages = "CDDIRDLG2BMP";
constexpr int driveImageWidth = 23;
constexpr int folderImageWidth = 16;
constexpr COLORREF transparent = RGB(0, 0, 255);

/// What was typed or pasted as a name, without what is around it, and in the family's form.
CString plainName(const CString& typed) {
    CString name = typed;
    name.Trim();
    const int last = name.GetLength() - 1;
    if (last > 0 && name[0] == name[last] && (name[0] == '"' || name[0] == '\'')) {
        name = name.Mid(1, last - 1);
        name.Trim();
    }
    return tvx::allocating([&name] { return CString(tvx::driveName(name.View())); });
}

} // namespace

Gui_DirDlg::Gui_DirDlg(const char* initialDirectory, const char* title, unsigned int helpId, CWnd* parent, int validate,
                       int mustExist, int mustBeWritable)
    : CDialog(GUI_IDD_DIRECTORY, parent), m_record(MakeRecord<Record>()) {
    m_record->dialog = this;
    m_record->title = title;
    m_record->helpId = helpId;
    m_record->validate = validate;
    m_record->mustExist = mustExist;
    m_record->mustBeWritable = mustBeWritable;
    if (initialDirectory) {
        m_record->directory.SetMountAndPath(initialDirectory);
    }
    m_record->driveImages.Create(driveImages, driveImageWidth, 0, transparent);
    m_record->folderImages.Create(folderImages, folderImageWidth, 0, transparent);
}

Gui_DirDlg::~Gui_DirDlg() = default;

CString Gui_DirDlg::GetPathName(int unc) const {
    return m_record->directory.GetMountAndPath(unc);
}

CTreeCtrl& Gui_DirDlg::tree() {
    return m_record->tree;
}

CComboBox& Gui_DirDlg::drives() {
    return m_record->drives;
}

BOOL Gui_DirDlg::OnInitDialog() {
    CDialog::OnInitDialog();
    tree().SubclassDlgItem(GUI_IDC_DIR_TREE, this);
    drives().SubclassDlgItem(GUI_IDC_DIR_DRIVES, this);
    tree().SetImageList(&m_record->folderImages, TVSIL_NORMAL);
    SHAutoComplete(*GetDlgItem(GUI_IDC_DIR_NAME), SHACF_FILESYS_DIRS);
    m_record->creation = {}; // of the last time
    m_record->toSelect.Empty();
    completeDirectory();
    showDirectory();
    fillDrives();
    selectDrive();
    fillTree();
    if (!m_record->title.IsEmpty()) {
        SetWindowText(m_record->title);
    }
    if (static_cast<int>(m_record->helpId) <= 0) {
        GetDlgItem(GUI_IDC_HELP)->ShowWindow(SW_HIDE);
    }
    return TRUE;
}

// --- the directory ---

/// A name that says neither drive nor where it begins would mean another directory whenever the process's changes.
void Gui_DirDlg::completeDirectory() {
    Gui_FileName& directory = m_record->directory;
    if (!directory.HasMount() || directory.HasRelativePath()) {
        directory.SetMountAndPath(directory.GetMountAndPath(directory.HasPath()));
    }
}

void Gui_DirDlg::setDirectory(const Gui_FileName& directory) {
    m_record->directory = directory;
    completeDirectory();
}

void Gui_DirDlg::showDirectory() {
    SetDlgItemText(GUI_IDC_DIR_NAME, m_record->directory.GetMountAndPath(0));
    // The field shows one line only; what it shows of a name is what tells a typed one from it.
    GetDlgItemText(GUI_IDC_DIR_NAME, m_record->shownName);
}

/// Makes a directory the current one in all parts of the dialog.
void Gui_DirDlg::go(const Gui_FileName& directory) {
    setDirectory(directory);
    showDirectory();
    selectDrive();
    fillTree();
}

CString Gui_DirDlg::typedName() {
    CString text;
    GetDlgItemText(GUI_IDC_DIR_NAME, text);
    return text;
}

// --- OK ---

void Gui_DirDlg::OnOK() {
    if (const CString typed = typedName(); typed != m_record->shownName) {
        const CString name = plainName(typed);
        Gui_FileName directory;
        directory.SetMountAndPath(name);
        if (!directory.HasMount() && directory.HasRelativePath()) {
            directory = m_record->directory;
            directory.PushPathEnd(name);
        }
        go(directory);
        tree().SetFocus();
        return;
    }
    if (const HTREEITEM item = tree().GetSelectedItem()) {
        const Gui_FileName selected = directoryOf(item);
        if (selected.GetMountAndPath() != m_record->directory.GetMountAndPath()) {
            go(selected);
            tree().SetFocus();
            return;
        }
    }
    check();
}

/// Asks whether the directory may be taken, and takes it if so.
void Gui_DirDlg::check() {
    if (!m_record->validate || !m_record->mustExist) {
        CDialog::OnOK();
        return;
    }
    if (!m_record->verdict) {
        const bool asksWritable = m_record->mustBeWritable != 0;
        m_record->verdict = tvx::Question<Record::Verdict>([directory = m_record->directory, asksWritable] {
            return !directory.Exists()                       ? Record::Verdict::Missing
                   : asksWritable && !directory.IsWritable() ? Record::Verdict::ReadOnly
                                                             : Record::Verdict::Fine;
        });
    }
    if (m_record->isAnswered(m_record->verdict, Record::checked)) {
        finishCheck();
    } else {
        showState();
    }
}

void Gui_DirDlg::finishCheck() {
    const Record::Verdict verdict = m_record->verdict.answer();
    m_record->verdict = {};
    showState();
    if (verdict == Record::Verdict::Fine) {
        CDialog::OnOK();
        return;
    }
    const UINT id = verdict == Record::Verdict::Missing ? GUI_IDS_DIRECTORY_MISSING : GUI_IDS_DIRECTORY_READ_ONLY;
    MessageBox(StringOf(id), AfxGetAppName(), MB_OK | MB_ICONEXCLAMATION);
}

LRESULT Gui_DirDlg::OnChecked(WPARAM, LPARAM) {
    if (m_record->verdict.isAnswered()) {
        finishCheck();
    }
    return 0;
}

/// Who goes on typing or choosing does not want the answer any more.
void Gui_DirDlg::OnChangeName() {
    m_record->verdict = {};
    showState();
}

void Gui_DirDlg::OnSelchangedTree(NMHDR*, LRESULT* result) {
    m_record->verdict = {};
    showState();
    *result = 0;
}

// --- what goes on ---

/// Says what the dialog waits for.
void Gui_DirDlg::showState() {
    const UINT id = m_record->creation  ? GUI_IDS_DIRECTORY_CREATING
                    : m_record->verdict ? GUI_IDS_DIRECTORY_CHECKING
                    : m_record->listing ? GUI_IDS_DIRECTORY_READING
                                        : 0U;
    SetDlgItemText(GUI_IDC_DIR_STATE, id ? StringOf(id) : CString());
    GetDlgItem(GUI_IDC_DIR_NEW)->EnableWindow(!m_record->creation);
}

BOOL Gui_DirDlg::OnSetCursor(CWnd* window, UINT part, UINT message) {
    if (part == HTCLIENT && (m_record->creation || m_record->verdict || m_record->listing)) {
        SetCursor(::LoadCursor(nullptr, IDC_APPSTARTING));
        return TRUE;
    }
    return CDialog::OnSetCursor(window, part, message);
}

// --- help ---

void Gui_DirDlg::OnHelp() {
    if (m_record->helpId != 0) {
        Gui_Help::OnDialog(m_record->helpId);
    }
}

BOOL Gui_DirDlg::OnHelpInfo(HELPINFO*) {
    OnHelp();
    return TRUE;
}
