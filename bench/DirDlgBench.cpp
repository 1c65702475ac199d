// The directory dialog opened on a folder of 100,000 subfolders until its tree is painted, beside the same by hand with
// the toolkit's tree, and beside the toolkit's file dialog.

#include "afxwin.h"
#include "platform/afx/core/detail/Window.h"
#include "platform/afx/toolkit/detail/Gui.h"
#include "res/resource.h"
#include "s/DirDlg.h"

#include <QApplication>
#include <QDialog>
#include <QFileDialog>
#include <QFileSystemModel>
#include <QTreeView>
#include <QTreeWidget>
#include <QVBoxLayout>

#include <algorithm>
#include <benchmark/benchmark.h>
#include <cstdlib>
#include <dirent.h>
#include <filesystem>
#include <memory>
#include <string>
#include <vector>

namespace {

namespace fs = std::filesystem;

CWinApp benchApplication("DirDlgBench");
constexpr int folderCount = 100000;

/// The folder, made once; on a file system in memory, so that no disk is measured.
const std::string& folder() {
    static const struct Folder {
        Folder() {
            std::string pattern = "/dev/shm/folders.XXXXXX";
            name = ::mkdtemp(pattern.data());
            for (int i = 0; i < folderCount; ++i) {
                fs::create_directory(name + "/Part " + std::to_string(i * 7919LL % folderCount));
            }
        }
        ~Folder() {
            fs::remove_all(name);
        }
        std::string name;
    } made;
    return made.name;
}

void prepare(benchmark::State& state) {
    setenv("QT_QPA_PLATFORM", "offscreen", 1);
    tvx::afx::ensureGui();
    state.counters["folders"] = folderCount;
    folder();
}

class Dialog : public Gui_DirDlg {
public:
    using Gui_DirDlg::Gui_DirDlg;

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
        const auto& tree = *static_cast<CTreeCtrl*>(GetDlgItem(GUI_IDC_DIR_TREE));
        if (tree.GetCount() < folderCount) {
            QApplication::processEvents(QEventLoop::WaitForMoreEvents);
            PostMessage(WM_APP);
            return 0;
        }
        tvx::afx::peerOf(tree.m_hWnd)->repaint();
        EndDialog(IDOK);
        return 0;
    }
};

void directoryDialog(benchmark::State& state) {
    prepare(state);
    for (auto _ : state) {
        Dialog dialog(folder().c_str());
        dialog.DoModal();
    }
}

std::vector<std::string> sortedFolders() {
    std::vector<std::string> names;
    const std::unique_ptr<DIR, int (*)(DIR*)> entries(::opendir(folder().c_str()), &::closedir);
    while (const dirent* entry = ::readdir(entries.get())) {
        if (entry->d_type == DT_DIR && entry->d_name[0] != '.') {
            names.emplace_back(entry->d_name);
        }
    }
    std::ranges::sort(names,
                      [](const auto& left, const auto& right) { return strcasecmp(left.c_str(), right.c_str()) < 0; });
    return names;
}

void treeWidget(benchmark::State& state) {
    prepare(state);
    for (auto _ : state) {
        QDialog dialog;
        auto* tree = new QTreeWidget;
        (new QVBoxLayout(&dialog))->addWidget(tree);
        tree->setHeaderHidden(true);
        tree->setUniformRowHeights(true);
        dialog.resize(400, 300);
        dialog.show();
        auto* root = new QTreeWidgetItem(tree, {QString::fromStdString(folder())});
        QList<QTreeWidgetItem*> items;
        for (const std::string& name : sortedFolders()) {
            items.append(new QTreeWidgetItem({QString::fromStdString(name)}));
        }
        root->addChildren(items);
        root->setExpanded(true);
        QApplication::processEvents();
        tree->repaint();
    }
}

void fileDialog(benchmark::State& state) {
    prepare(state);
    for (auto _ : state) {
        QFileDialog dialog(nullptr, QString(), QString::fromStdString(folder()));
        dialog.setOption(QFileDialog::DontUseNativeDialog);
        dialog.setFileMode(QFileDialog::Directory);
        dialog.show();
        const auto* model = dialog.findChild<QFileSystemModel*>();
        while (model->rowCount(model->index(QString::fromStdString(folder()))) < folderCount) {
            QApplication::processEvents(QEventLoop::WaitForMoreEvents);
        }
        dialog.repaint();
    }
}

BENCHMARK(directoryDialog)->Unit(benchmark::kMillisecond)->MeasureProcessCPUTime()->UseRealTime();
BENCHMARK(treeWidget)->Unit(benchmark::kMillisecond)->MeasureProcessCPUTime()->UseRealTime();
BENCHMARK(fileDialog)->Unit(benchmark::kMillisecond)->MeasureProcessCPUTime()->UseRealTime()->Iterations(1);

} // namespace
