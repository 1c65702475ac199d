// The file dialog on a folder of 25,000 files, beside the toolkit's own: the time from its making until all entries are
// listed and an event that was posted then has been handled, which is when the user can go on.

#include "afxdlgs.h"
#include "platform/afx/toolkit/detail/Gui.h"

#include <QApplication>
#include <QElapsedTimer>
#include <QFileDialog>
#include <QTimer>
#include <QTreeView>

#include <algorithm>
#include <benchmark/benchmark.h>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <string>

namespace {

CWinApp benchApplication("FileDialogBench");
constexpr int fileCount = 25000;

/// A folder of files, some of them of kinds that are known by their contents only.
class BigFolder {
public:
    BigFolder() {
        std::string pattern = (std::filesystem::temp_directory_path() / "files.XXXXXX").string();
        m_path = mkdtemp(pattern.data());
        const char* const suffixes[] = {".brd", ".txt", ".png", ""};
        for (int i = 0; i < fileCount; ++i) {
            std::ofstream(m_path / ("part" + std::to_string(i * 7919LL % fileCount) + suffixes[i % 4])) << "board 1\n";
        }
    }
    ~BigFolder() {
        std::filesystem::remove_all(m_path);
    }
    BigFolder(const BigFolder&) = delete;
    BigFolder& operator=(const BigFolder&) = delete;
    QString path() const {
        return QString::fromStdString(m_path.string());
    }

private:
    std::filesystem::path m_path;
};

const BigFolder& bigFolder() {
    static const BigFolder folder;
    return folder;
}

/// Leaves the modal dialog that comes next as soon as it can be used, and measures the longest time without an answer
/// to the user meanwhile.
class Watch {
public:
    Watch() {
        // An interval of 0 would keep the toolkit's reading thread from the dialog's locks.
        QObject::connect(&m_timer, &QTimer::timeout, &m_timer, [this] { look(); });
        m_timer.start(2);
        m_clock.start();
    }
    double longest = 0; ///< in milliseconds

private:
    void look() {
        longest = std::max(longest, static_cast<double>(m_clock.nsecsElapsed()) / 1e6);
        m_clock.start();
        auto* dialog = qobject_cast<QFileDialog*>(QApplication::activeModalWidget());
        const auto* list = dialog ? dialog->findChild<QTreeView*>("treeView") : nullptr;
        if (!list || list->model()->rowCount(list->rootIndex()) < fileCount) {
            return;
        }
        if (m_isAll) {
            dialog->reject();
        }
        m_isAll = true; // and once more: what the last entries have caused has been done then
    }
    QTimer m_timer;
    QElapsedTimer m_clock;
    bool m_isAll = false;
};

void prepare() {
    setenv("QT_QPA_PLATFORM", "offscreen", 1);
    tvx::afx::ensureGui();
    bigFolder();
}

template <class Ask>
void measure(benchmark::State& state, Ask ask) {
    prepare();
    double longest = 0;
    for (auto _ : state) {
        Watch watch;
        ask();
        longest = std::max(longest, watch.longest);
    }
    state.counters["longest_turn_ms"] = longest;
}

void ours(benchmark::State& state) {
    measure(state, [] {
        CFileDialog dialog(TRUE);
        const std::string folder = bigFolder().path().toStdString();
        dialog.m_ofn.lpstrInitialDir = folder.c_str();
        dialog.DoModal();
    });
}

void toolkit(benchmark::State& state) {
    measure(state, [] {
        QFileDialog dialog;
        dialog.setOption(QFileDialog::DontUseNativeDialog);
        dialog.setDirectory(bigFolder().path());
        dialog.exec();
    });
}

BENCHMARK(ours)->Unit(benchmark::kMillisecond)->Iterations(5)->UseRealTime();
BENCHMARK(toolkit)->Unit(benchmark::kMillisecond)->Iterations(5)->UseRealTime();

} // namespace
