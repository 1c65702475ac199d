// Items of a tree: 100,000 below one parent that are inserted when it is opened, until they are painted, beside the
// toolkit's tree widget and its view over a model of the same items; and as many in sorted order. The counter is what
// the tree takes of the memory, in bytes an item.

#include "afxcmn.h"
#include "afxwin.h"
#include "platform/afx/core/detail/Window.h"
#include "platform/afx/toolkit/detail/Gui.h"

#include <QAbstractItemModel>
#include <QApplication>
#include <QTreeView>
#include <QTreeWidget>

#include <benchmark/benchmark.h>
#include <cstdlib>
#include <malloc.h>
#include <string>
#include <vector>

namespace {

CWinApp benchApplication("TreeBench");
constexpr int itemCount = 100000;
constexpr int treeId = 1;

/// Names in the order in which a folder's entries come: none.
const std::vector<std::string>& names() {
    static const std::vector<std::string> made = [] {
        std::vector<std::string> texts;
        for (int i = 0; i < itemCount; ++i) {
            texts.push_back("part " + std::to_string(i * 7919LL % itemCount + itemCount));
        }
        return texts;
    }();
    return made;
}

const std::vector<QString>& toolkitNames() {
    static const std::vector<QString> made = [] {
        std::vector<QString> texts;
        for (const std::string& text : names()) {
            texts.push_back(QString::fromStdString(text));
        }
        return texts;
    }();
    return made;
}

void prepare() {
    setenv("QT_QPA_PLATFORM", "offscreen", 1);
    tvx::afx::ensureGui();
    names();
    toolkitNames();
}

/// Notes what was allocated from the beginning on.
class Memory {
public:
    Memory() : m_before(allocated()) {}
    void note(benchmark::State& state) const {
        state.counters["bytes/item"] = static_cast<double>(allocated() - m_before) / itemCount;
    }

private:
    static std::size_t allocated() {
        const struct mallinfo2 info = mallinfo2();
        return info.uordblks + info.hblkhd;
    }
    std::size_t m_before;
};

enum class Order { AsTheyCome, Sorted };

class Host : public CWnd {
public:
    explicit Host(Order order) : m_order(order) {
        CreateEx(0, AfxRegisterWndClass(0), "", WS_OVERLAPPEDWINDOW | WS_VISIBLE, 0, 0, 400, 300, nullptr, nullptr);
        tree.Create(WS_CHILD | WS_VISIBLE | TVS_HASBUTTONS | TVS_HASLINES | TVS_LINESATROOT, CRect(0, 0, 400, 300),
                    this, treeId);
        TVINSERTSTRUCT insert{TVI_ROOT, TVI_LAST, {}};
        insert.item.mask = TVIF_TEXT | TVIF_CHILDREN;
        insert.item.pszText = const_cast<LPSTR>("all");
        insert.item.cChildren = 1;
        root = tree.InsertItem(&insert);
        QApplication::processEvents();
    }
    ~Host() override {
        DestroyWindow();
    }
    void show() {
        tree.Expand(root, TVE_EXPAND);
        QApplication::processEvents();
        tvx::afx::peerOf(tree.m_hWnd)->grab();
    }
    CTreeCtrl tree;
    HTREEITEM root = nullptr;

protected:
    BOOL OnNotify(WPARAM wParam, LPARAM lParam, LRESULT* result) override {
        if (reinterpret_cast<const NMHDR*>(lParam)->code == TVN_ITEMEXPANDING) {
            for (const std::string& name : names()) {
                tree.InsertItem(name.c_str(), root, m_order == Order::Sorted ? TVI_SORT : TVI_LAST);
            }
        }
        return CWnd::OnNotify(wParam, lParam, result);
    }

private:
    Order m_order;
};

void ours(benchmark::State& state, Order order) {
    prepare();
    for (auto _ : state) {
        state.PauseTiming();
        const Memory memory;
        Host host(order);
        state.ResumeTiming();
        host.show();
        state.PauseTiming();
        memory.note(state);
        host.DestroyWindow();
        QApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
        QApplication::processEvents();
        state.ResumeTiming();
    }
}

/// All of a tree's lines once down and up again, a page at a time, painted.
void pages(benchmark::State& state) {
    prepare();
    Host host(Order::AsTheyCome);
    host.show();
    QWidget* area = tvx::afx::peerOf(host.tree.m_hWnd);
    HTREEITEM item = host.tree.GetChildItem(host.root);
    for (auto _ : state) {
        for (int step = 0; step < 15; ++step) {
            item = host.tree.GetNextSiblingItem(item);
        }
        host.tree.Select(item, TVGN_FIRSTVISIBLE);
        area->repaint();
    }
}

void widget(benchmark::State& state, Order order) {
    prepare();
    for (auto _ : state) {
        state.PauseTiming();
        const Memory memory;
        {
            QTreeWidget tree;
            tree.setHeaderHidden(true);
            tree.setUniformRowHeights(true);
            tree.resize(400, 300);
            auto* root = new QTreeWidgetItem(&tree, {"all"});
            root->setChildIndicatorPolicy(QTreeWidgetItem::ShowIndicator);
            QObject::connect(&tree, &QTreeWidget::itemExpanded, &tree, [&](QTreeWidgetItem* opened) {
                QList<QTreeWidgetItem*> children;
                for (const QString& name : toolkitNames()) {
                    children.append(new QTreeWidgetItem(QStringList(name)));
                }
                opened->addChildren(children);
                if (order == Order::Sorted) {
                    opened->sortChildren(0, Qt::AscendingOrder);
                }
            });
            tree.show();
            QApplication::processEvents();
            state.ResumeTiming();
            root->setExpanded(true);
            QApplication::processEvents();
            tree.viewport()->grab();
            state.PauseTiming();
            memory.note(state);
        }
        state.ResumeTiming();
    }
}

/// One item with the others below it, which it has from the first time that it is asked for them.
class DemandModel : public QAbstractItemModel {
public:
    QModelIndex index(int row, int column, const QModelIndex& parent) const override {
        return createIndex(row, column, parent.isValid() ? quintptr{1} : quintptr{0});
    }
    QModelIndex parent(const QModelIndex& index) const override {
        return index.internalId() == 1 ? createIndex(0, 0, quintptr{0}) : QModelIndex();
    }
    int rowCount(const QModelIndex& parent) const override {
        return !parent.isValid() ? 1 : parent.internalId() == 0 ? static_cast<int>(m_texts.size()) : 0;
    }
    int columnCount(const QModelIndex&) const override {
        return 1;
    }
    bool hasChildren(const QModelIndex& parent) const override {
        return !parent.isValid() || parent.internalId() == 0;
    }
    bool canFetchMore(const QModelIndex& parent) const override {
        return parent.isValid() && parent.internalId() == 0 && m_texts.empty();
    }
    void fetchMore(const QModelIndex& parent) override {
        beginInsertRows(parent, 0, itemCount - 1);
        m_texts = names(); // copied, as a model that owns its items does
        endInsertRows();
    }
    QVariant data(const QModelIndex& index, int role) const override {
        if (role != Qt::DisplayRole) {
            return {};
        }
        return index.internalId() == 0 ? QString("all")
                                       : QString::fromStdString(m_texts[static_cast<std::size_t>(index.row())]);
    }

private:
    std::vector<std::string> m_texts;
};

void demandModel(benchmark::State& state) {
    prepare();
    for (auto _ : state) {
        state.PauseTiming();
        const Memory memory;
        {
            DemandModel model;
            QTreeView view;
            view.setHeaderHidden(true);
            view.setUniformRowHeights(true);
            view.setModel(&model);
            view.resize(400, 300);
            view.show();
            QApplication::processEvents();
            state.ResumeTiming();
            view.expand(model.index(0, 0, {}));
            QApplication::processEvents();
            view.viewport()->grab();
            state.PauseTiming();
            memory.note(state);
        }
        state.ResumeTiming();
    }
}

BENCHMARK_CAPTURE(ours, opened, Order::AsTheyCome)->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(widget, opened, Order::AsTheyCome)->Unit(benchmark::kMillisecond);
BENCHMARK(demandModel)->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(ours, sorted, Order::Sorted)->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(widget, sorted, Order::Sorted)->Unit(benchmark::kMillisecond);
BENCHMARK(pages)->Unit(benchmark::kMicrosecond);

} // namespace
