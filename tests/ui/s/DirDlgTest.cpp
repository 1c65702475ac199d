// The directory dialog as a user meets it: by keys and clicks.
#include "s/DirDlg.h"

#include "res/resource.h"
#include "tests/ui/afx/dialogs/DialogTesting.h"
#include "tests/ui/s/WindowTestApp.h"
#include "tests/unit/base/FileTestFolder.h"
#include "tests/unit/win/HangingFolder.h"

#include <cstdlib>
#include <sys/stat.h>

namespace {

namespace fs = std::filesystem;
using Texts = std::vector<std::string>;

class Dialog : public Gui_DirDlg {
public:
    using Gui_DirDlg::Gui_DirDlg;

    INT_PTR run(std::function<void()> script) {
        m_script = std::move(script);
        return DoModal();
    }
    std::string name() const {
        return textOf(GetDlgItem(GUI_IDC_DIR_NAME));
    }
    std::string state() const {
        return textOf(GetDlgItem(GUI_IDC_DIR_STATE));
    }
    CTreeCtrl& tree() const {
        return *static_cast<CTreeCtrl*>(GetDlgItem(GUI_IDC_DIR_TREE));
    }
    CComboBox& drives() const {
        return *static_cast<CComboBox*>(GetDlgItem(GUI_IDC_DIR_DRIVES));
    }
    HTREEITEM current() const {
        HTREEITEM item = tree().GetRootItem();
        while (imageOf(item) == 0) {
            item = tree().GetChildItem(item);
        }
        return item;
    }
    int imageOf(HTREEITEM item) const {
        int image = -1;
        int selected = -1;
        tree().GetItemImage(item, image, selected);
        EXPECT_EQ(image, selected);
        return image;
    }
    /// The texts from the root to the current directory.
    Texts path() const {
        Texts texts;
        for (HTREEITEM item = current(); item; item = tree().GetParentItem(item)) {
            texts.emplace(texts.begin(), tree().GetItemText(item).GetString());
        }
        return texts;
    }
    Texts subdirectories() const {
        Texts texts;
        for (HTREEITEM item = tree().GetChildItem(current()); item; item = tree().GetNextSiblingItem(item)) {
            EXPECT_EQ(imageOf(item), 2);
            EXPECT_FALSE(tree().ItemHasChildren(item));
            texts.emplace_back(tree().GetItemText(item).GetString());
        }
        return texts;
    }
    std::string selected() const {
        return tree().GetItemText(tree().GetSelectedItem()).GetString();
    }
    /// Each entry of the list of drives with its image.
    Texts driveEntries() const {
        Texts texts;
        for (int i = 0; i < drives().GetCount(); ++i) {
            CString text;
            drives().GetLBText(i, text);
            texts.push_back(std::string(text) + " " + std::to_string(drives().GetItemData(i)));
        }
        return texts;
    }
    std::string drive() const {
        return textOf(&drives());
    }
    int focus() const {
        const CWnd* control = GetFocus();
        return control ? control->GetDlgCtrlID() : 0;
    }
    void push(int id) const {
        click(GetDlgItem(id));
    }
    /// Replaces the name in the field and presses Enter.
    void enter(const std::string& text) const {
        GetDlgItem(GUI_IDC_DIR_NAME)->SetFocus();
        key(Qt::Key_A, Qt::ControlModifier);
        type(text.c_str());
        key(Qt::Key_Enter);
    }
    void doubleClick(HTREEITEM item) const {
        CRect place;
        ASSERT_TRUE(tree().GetItemRect(item, &place, TRUE));
        QWidget* area = tvx::afx::Window::from(tree().m_hWnd)->clientWidget();
        QTest::mouseDClick(area, Qt::LeftButton, {}, QPoint(place.left + 4, place.CenterPoint().y));
    }

protected:
    BOOL OnInitDialog() override {
        const BOOL result = Gui_DirDlg::OnInitDialog();
        PostMessage(WM_APP);
        return result;
    }
    LRESULT WindowProc(UINT message, WPARAM wParam, LPARAM lParam) override {
        if (message != WM_APP) {
            return Gui_DirDlg::WindowProc(message, wParam, lParam);
        }
        EXPECT_TRUE(waitForActive(*this));
        m_script();
        if (m_hWnd && IsWindowVisible()) {
            EndDialog(99);
        }
        return 0;
    }

private:
    std::function<void()> m_script;
};

/// Types a name when the query for a folder comes up and presses Enter; if it comes up again, it is cancelled.
class QueryAnswer {
public:
    explicit QueryAnswer(const char* name) {
        QObject::connect(&m_timer, &QTimer::timeout, &m_timer, [this, name] {
            const QWidget* window = QApplication::activeModalWidget();
            auto* field = window && window->isActiveWindow() && window->windowTitle() == "New Folder"
                              ? qobject_cast<QLineEdit*>(QApplication::focusWidget())
                              : nullptr;
            if (field && std::exchange(m_isTyped, true)) {
                again = field->text().toStdString();
                key(Qt::Key_Escape);
            } else if (field) {
                type(name);
                key(Qt::Key_Enter);
            }
        });
        m_timer.start(0);
    }
    std::string again;

private:
    QTimer m_timer;
    bool m_isTyped = false;
};

/// C: is the system's root, D: a folder with "work" in it, E: a removable medium, F: a disc, X: a share.
class DirDlg : public FileTestFolder {
protected:
    DirDlg() {
        for (const char* folder : {"d/work/src/gui", "d/work/src/Base", "d/work/src/.git", "e", "f/disc", "x/docs"}) {
            fs::create_directories(folder);
        }
        put("d/work/src/file");
        const std::string table = "C=/;D=" + m_folder + "/d;E=" + m_folder + "/e|removable;F=" + m_folder +
                                  "/f|cdrom;X=" + m_folder + "/x|\\\\Srv\\Data";
        ::setenv("TVX_DRIVES", table.c_str(), 1);
    }
    ~DirDlg() override {
        ::unsetenv("TVX_DRIVES");
    }
};

} // namespace

TEST_F(DirDlg, ShowsTheWayToTheDirectoryAndWhatIsInIt) {
    Dialog dialog("D:/work/src", "Sources");
    dialog.run([&] {
        EXPECT_EQ(textOf(&dialog), "Sources");
        EXPECT_EQ(dialog.name(), "D:\\work\\src\\");
        EXPECT_EQ(dialog.path(), (Texts{"D:\\", "work", "src"}));
        EXPECT_EQ(dialog.imageOf(dialog.current()), 1);
        EXPECT_EQ(dialog.selected(), "src");
        EXPECT_EQ(dialog.subdirectories(), (Texts{"Base", "gui"}));
        EXPECT_EQ(dialog.drive(), "D:");
        EXPECT_EQ(dialog.state(), "");
        click(dialog.GetDlgItem(GUI_IDC_DIR_HIDDEN), {8, 8});
        EXPECT_EQ(dialog.subdirectories(), (Texts{".git", "Base", "gui"}));
    });
    fs::current_path("d/work");
    Dialog plain;
    plain.run([&] {
        EXPECT_EQ(textOf(&plain), "Directory");
        EXPECT_EQ(plain.name(), "D:\\work\\");
    });
}

TEST_F(DirDlg, OkGoesToATypedNameAndThenTakesIt) {
    Dialog dialog("D:\\");
    EXPECT_EQ(dialog.run([&] {
        dialog.enter("  \"D:\\WORK/src\" ");
        EXPECT_EQ(dialog.name(), "D:\\WORK\\src\\");
        EXPECT_EQ(dialog.subdirectories(), (Texts{"Base", "gui"}));
        EXPECT_EQ(dialog.focus(), GUI_IDC_DIR_TREE);
        dialog.enter("gui"); // below the current one
        EXPECT_EQ(dialog.path(), (Texts{"D:\\", "WORK", "src", "gui"}));
        EXPECT_EQ(dialog.subdirectories(), Texts());
        dialog.enter(m_folder + "/x/docs"); // the system's form
        EXPECT_EQ(dialog.name(), "X:\\docs\\");
        EXPECT_EQ(dialog.drive(), "X:  \\\\srv\\data");
        key(Qt::Key_Enter);
    }),
              IDOK);
    EXPECT_STREQ(dialog.GetPathName(1), "\\\\srv\\data\\docs\\");
    EXPECT_STREQ(dialog.GetPathName(0), "X:\\docs\\");
}

TEST_F(DirDlg, OkGoesToTheSelectedDirectoryAndThenTakesIt) {
    Dialog dialog("D:\\work\\src");
    EXPECT_EQ(dialog.run([&] {
        dialog.tree().SetFocus();
        key(Qt::Key_Down);
        EXPECT_EQ(dialog.selected(), "Base");
        key(Qt::Key_Enter);
        EXPECT_EQ(dialog.name(), "D:\\work\\src\\Base\\");
        EXPECT_EQ(dialog.focus(), GUI_IDC_DIR_TREE);
        dialog.doubleClick(dialog.tree().GetRootItem());
        EXPECT_EQ(dialog.name(), "D:\\");
        EXPECT_EQ(dialog.subdirectories(), (Texts{"work"}));
        dialog.doubleClick(dialog.tree().GetChildItem(dialog.current()));
        EXPECT_EQ(dialog.path(), (Texts{"D:\\", "work"}));
        EXPECT_EQ(dialog.subdirectories(), (Texts{"src"}));
        dialog.push(IDOK);
    }),
              IDOK);
    EXPECT_STREQ(dialog.GetPathName(1), "D:\\work\\");
}

TEST_F(DirDlg, ADirectoryIsCheckedAsFarAsItIsAskedFor) {
    constexpr const char* missing = "The specified directory does not exist.\nPlease make another selection.";
    constexpr const char* readOnly = "The specified directory is not writable.\nPlease make another selection or "
                                     "adjust the directory permissions.";
    const auto refusal = [](Dialog& dialog) {
        BoxAnswer box;
        EXPECT_EQ(dialog.run([] { key(Qt::Key_Enter); }), 99);
        return box.text;
    };
    Dialog none("D:\\none\\deep");
    EXPECT_EQ(refusal(none), missing);
    Dialog disc("F:\\disc");
    EXPECT_EQ(refusal(disc), readOnly);
    ::chmod("d/work/src", 0555);
    Dialog closed("D:\\work\\src");
    EXPECT_EQ(refusal(closed), readOnly);
    ::chmod("d/work/src", 0755);
    for (const auto& [name, validate, exist, writable] :
         {std::tuple("D:\\none", 0, 1, 1), std::tuple("D:\\none", 1, 0, 1), std::tuple("F:\\disc", 1, 1, 0),
          std::tuple("E:\\", 1, 1, 1)}) {
        Dialog dialog(name, nullptr, 0, nullptr, validate, exist, writable);
        EXPECT_EQ(dialog.run([] { key(Qt::Key_Enter); }), IDOK) << name;
    }
}

TEST_F(DirDlg, DrivesAreListedWithTheirKindAndChosen) {
    const Texts connected{"C: 7", "D: 7", "E: 4", "F: 3", "X:  \\\\srv\\data 6"};
    Dialog dialog("D:\\work");
    EXPECT_EQ(dialog.run([&] {
        EXPECT_EQ(dialog.driveEntries(), connected);
        dialog.drives().SetFocus();
        key(Qt::Key_End);
        EXPECT_EQ(dialog.name(), "X:\\");
        EXPECT_EQ(dialog.path(), (Texts{"X:\\"}));
        EXPECT_EQ(dialog.subdirectories(), (Texts{"docs"}));
        key(Qt::Key_Up);
        EXPECT_EQ(dialog.subdirectories(), (Texts{"disc"}));
        key(Qt::Key_Down);
        key(Qt::Key_Enter);
    }),
              IDOK);
    EXPECT_STREQ(dialog.GetPathName(1), "\\\\srv\\data\\");
    Dialog share("\\\\Srv2\\data\\docs");
    share.run([&] {
        Texts entries = connected;
        entries.emplace_back("\\\\SRV2\\DATA 6");
        EXPECT_EQ(share.driveEntries(), entries);
        EXPECT_EQ(share.drive(), "\\\\SRV2\\DATA");
        EXPECT_EQ(share.path(), (Texts{"\\\\Srv2\\data\\", "docs"}));
    });
}

TEST_F(DirDlg, HelpIsThereWithANumberOnly) {
    Dialog helped("D:\\", nullptr, 7);
    windowTestApp.help.clear();
    helped.run([&] {
        helped.push(GUI_IDC_HELP);
        key(Qt::Key_F1);
        const std::pair<DWORD_PTR, UINT> request(HID_BASE_RESOURCE + 7, HELP_CONTEXT);
        EXPECT_EQ(windowTestApp.help, (std::vector{request, request}));
    });
    Dialog plain("D:\\");
    windowTestApp.help.clear();
    plain.run([&] {
        EXPECT_FALSE(plain.GetDlgItem(GUI_IDC_HELP)->IsWindowVisible());
        key(Qt::Key_F1);
        EXPECT_TRUE(windowTestApp.help.empty());
    });
}

TEST_F(DirDlg, NewFoldersAreMadeAndSelected) {
    Dialog dialog("D:\\work\\src");
    dialog.run([&] {
        for (const char* name : {"New Folder", "New Folder (2)"}) {
            const QueryAnswer query("");
            dialog.push(GUI_IDC_DIR_NEW);
            EXPECT_EQ(dialog.selected(), name);
        }
        {
            // One that cannot be made is asked for again, as it was typed.
            const QueryAnswer query("gui");
            const BoxAnswer box;
            dialog.push(GUI_IDC_DIR_NEW);
            EXPECT_EQ(box.text.substr(0, 36), "The folder gui could not be created.");
            EXPECT_EQ(query.again, "gui");
        }
        EXPECT_TRUE(waitForActive(dialog));
        dialog.tree().SetFocus();
        EXPECT_EQ(dialog.subdirectories(), (Texts{"Base", "gui", "New Folder", "New Folder (2)"}));
        key(Qt::Key_Enter); // the keyboard is in the tree
        EXPECT_EQ(dialog.name(), "D:\\work\\src\\New Folder (2)\\");
    });
    EXPECT_TRUE(fs::is_directory("d/work/src/New Folder (2)"));
}

TEST_F(DirDlg, NamesOfAnyBytesCanBeChosen) {
    for (const char* name : {"d/\xFF\xFE", "d/line\nend", "d/50%s", "d/back\\slash"}) {
        fs::create_directory(name);
    }
    for (const std::string name : {"\xFF\xFE", "line\nend", "50%s"}) {
        Dialog dialog("D:\\");
        EXPECT_EQ(dialog.run([&] {
            EXPECT_EQ(dialog.subdirectories(), (Texts{"50%s", "line\nend", "work", "\xFF\xFE"}));
            HTREEITEM item = dialog.tree().GetChildItem(dialog.current());
            while (dialog.tree().GetItemText(item) != name.c_str()) {
                item = dialog.tree().GetNextSiblingItem(item);
            }
            dialog.doubleClick(item);
            key(Qt::Key_Enter);
        }),
                  IDOK);
        EXPECT_EQ(dialog.GetPathName(1).GetString(), "D:\\" + name + "\\");
    }
}

TEST_F(DirDlg, AFolderThatDoesNotAnswerKeepsNobody) {
    fs::create_directories("d/dead/late");
    HangingFolder dead(m_folder + "/d/dead");
    Dialog dialog("D:\\dead");
    EXPECT_EQ(dialog.run([&] {
        EXPECT_EQ(dialog.state(), "Reading the directory...");
        EXPECT_EQ(dialog.path(), (Texts{"D:\\", "dead"}));
        key(Qt::Key_Enter); // it is there, so it may be taken
    }),
              IDOK);
    Dialog asking("D:\\dead\\LATE"); // to be looked for in the folder
    EXPECT_EQ(asking.run([&] {
        key(Qt::Key_Enter);
        EXPECT_EQ(asking.state(), "Checking the directory...");
        key(Qt::Key_Escape);
    }),
              IDCANCEL);
    Dialog leaving("D:\\dead");
    EXPECT_EQ(leaving.run([&] {
        leaving.enter("D:\\work");
        EXPECT_EQ(leaving.state(), "");
        EXPECT_EQ(leaving.subdirectories(), (Texts{"src"}));
        leaving.enter("D:\\dead\\LATE");
        key(Qt::Key_Enter);
        dead.answer();
        // The answer to the second OK ends the dialog.
        EXPECT_TRUE(QTest::qWaitFor([&] { return !leaving.m_hWnd || !leaving.IsWindowVisible(); }));
    }),
              IDOK);
    Dialog waiting("D:\\dead");
    HangingFolder again(m_folder + "/d/dead");
    waiting.run([&] {
        again.answer();
        EXPECT_TRUE(QTest::qWaitFor([&] { return waiting.subdirectories() == Texts{"late"}; }));
        EXPECT_EQ(waiting.state(), "");
    });
}
