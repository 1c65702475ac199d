// Opening a property sheet with 10,000 items until it is painted, beside a dialog of the toolkit with as many nodes in
// a tree widget and one page; a sheet of 100 items; and switching from one page to the next, both pages made, until the
// new one is painted; a search among 10,000 items.

#include "afxwin.h"
#include "platform/afx/core/detail/Window.h"
#include "platform/afx/toolkit/detail/Gui.h"
#include "platform/sec/TreeCtrl.h"
#include "s/PropSheet.h"

#include <QApplication>
#include <QDialog>
#include <QDialogButtonBox>
#include <QGridLayout>
#include <QLabel>
#include <QLineEdit>
#include <QTreeWidget>

#include <benchmark/benchmark.h>
#include <cstdlib>
#include <memory>
#include <string>

namespace {

CWinApp benchApplication("PropSheetBench");
constexpr int childrenOfCategory = 100;
constexpr int fieldCount = 12;
constexpr UINT treeId = 1001;
constexpr UINT searchId = 1063;
constexpr UINT templateId = 20008;

void prepare() {
    setenv("QT_QPA_PLATFORM", "offscreen", 1);
    tvx::afx::ensureGui();
}

/// A page of a dozen fields with labels.
CWnd* makePage(Gui_PropItem*, Gui_PropSheet* sheet) {
    auto* page = new CWnd;
    page->Create(nullptr, "", WS_CHILD, CRect(0, 0, 300, 200), sheet, 0);
    for (int i = 0; i < fieldCount; ++i) {
        CWnd label;
        label.Create("Static", "Value", WS_CHILD | WS_VISIBLE, CRect(5, 5 + 20 * i, 80, 20 + 20 * i), page, 100);
        label.Detach();
        CWnd field;
        field.Create("Edit", "12", WS_CHILD | WS_VISIBLE | WS_TABSTOP, CRect(90, 5 + 20 * i, 200, 22 + 20 * i), page,
                     200);
        field.Detach();
    }
    return page;
}

std::string nameOf(int number) {
    return "Item " + std::to_string(number);
}

void fill(Gui_PropSheet& sheet, int count) {
    Gui_PropItem* category = nullptr;
    for (int i = 0; i < count; ++i) {
        const bool isCategory = i % childrenOfCategory == 0;
        auto* item = new Gui_PropItem(nameOf(i).c_str(), makePage, nullptr, Gui_PropItem::StateExpanded);
        sheet.AddItem(item, isCategory ? nullptr : category, false);
        category = isCategory ? item : category;
    }
}

/// Shows a modeless sheet and paints it.
void open(Gui_PropSheet& sheet) {
    sheet.Create(templateId, nullptr);
    sheet.ShowWindow(SW_SHOW);
    QCoreApplication::processEvents();
    sheet.UpdateWindow();
}

void openSheet(benchmark::State& state) {
    prepare();
    for (auto _ : state) {
        auto sheet = std::make_unique<Gui_PropSheet>("Preferences", nullptr, false);
        fill(*sheet, static_cast<int>(state.range(0)));
        open(*sheet);
        state.PauseTiming();
        sheet.reset();
        state.ResumeTiming();
    }
}

QWidget* toolkitPage() {
    auto* page = new QWidget;
    auto* grid = new QGridLayout(page);
    for (int i = 0; i < fieldCount; ++i) {
        grid->addWidget(new QLabel("Value"), i, 0);
        grid->addWidget(new QLineEdit("12"), i, 1);
    }
    return page;
}

void openToolkit(benchmark::State& state) {
    prepare();
    for (auto _ : state) {
        auto* dialog = new QDialog;
        auto* grid = new QGridLayout(dialog);
        auto* tree = new QTreeWidget;
        tree->setHeaderHidden(true);
        QTreeWidgetItem* category = nullptr;
        for (int i = 0; i < state.range(0); ++i) {
            const QStringList label(QString::fromStdString(nameOf(i)));
            if (i % childrenOfCategory == 0) {
                category = new QTreeWidgetItem(tree, label);
                category->setExpanded(true);
            } else {
                new QTreeWidgetItem(category, label);
            }
        }
        grid->addWidget(tree, 0, 0);
        grid->addWidget(toolkitPage(), 0, 1);
        grid->addWidget(new QDialogButtonBox(QDialogButtonBox::Ok | QDialogButtonBox::Cancel | QDialogButtonBox::Apply |
                                             QDialogButtonBox::Help),
                        1, 1);
        dialog->resize(500, 350);
        dialog->show();
        QCoreApplication::processEvents();
        dialog->repaint();
        state.PauseTiming();
        delete dialog;
        state.ResumeTiming();
    }
}

void switchPages(benchmark::State& state) {
    prepare();
    Gui_PropSheet sheet("Preferences", nullptr, false);
    fill(sheet, 100);
    open(sheet);
    auto& tree = static_cast<SECTreeCtrl&>(*sheet.GetDlgItem(treeId));
    const HTREEITEM nodes[] = {tree.GetRootItem(), tree.GetIndexItem(1)};
    int turn = 0;
    for (auto _ : state) {
        tree.SelectItem(nodes[++turn % 2]);
        QCoreApplication::processEvents();
        sheet.UpdateWindow();
    }
    sheet.DestroyWindow();
}

/// A letter typed into the search field and taken back: both times the tree is filled anew and painted.
void search(benchmark::State& state) {
    prepare();
    Gui_PropSheet sheet("Preferences", nullptr, false);
    fill(sheet, static_cast<int>(state.range(0)));
    sheet.SetSearch(true);
    open(sheet);
    CWnd& field = *sheet.GetDlgItem(searchId);
    for (auto _ : state) {
        for (const char* words : {"item 7", "item"}) {
            field.SetWindowText(words);
            QCoreApplication::processEvents();
            sheet.UpdateWindow();
        }
    }
    sheet.DestroyWindow();
}

BENCHMARK(openSheet)->Arg(100)->Arg(10000)->Unit(benchmark::kMillisecond)->Iterations(10)->UseRealTime();
BENCHMARK(openToolkit)->Arg(100)->Arg(10000)->Unit(benchmark::kMillisecond)->Iterations(10)->UseRealTime();
BENCHMARK(search)->Arg(10000)->Unit(benchmark::kMillisecond)->UseRealTime();
BENCHMARK(switchPages)->Unit(benchmark::kMillisecond)->UseRealTime();

} // namespace
