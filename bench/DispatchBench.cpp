// Posted messages through the queue, pre-translation and a message map, beside the toolkit's own posted events.

#include "afxwin.h"
#include "platform/afx/core/detail/Loop.h"
#include "platform/afx/toolkit/detail/Gui.h"

#include <QCoreApplication>
#include <QEvent>
#include <QEventLoop>
#include <QObject>

#include <benchmark/benchmark.h>
#include <cstdlib>

namespace {

CWinApp benchApplication("DispatchBench");
constexpr UINT tick = WM_APP + 1;

class Counter : public CWnd {
public:
    long left = 0;
    tvx::afx::ModalLoop* loop = nullptr;

protected:
    afx_msg LRESULT OnTick(WPARAM, LPARAM) {
        if (--left == 0) {
            loop->end(0);
        }
        return 0;
    }
    DECLARE_MESSAGE_MAP()
};

// clang-format off
BEGIN_MESSAGE_MAP(Counter, CWnd)
    ON_MESSAGE(tick, &Counter::OnTick)
END_MESSAGE_MAP()
// clang-format on

class Receiver : public QObject {
public:
    long left = 0;
    QEventLoop* loop = nullptr;
    bool event(QEvent* event) override {
        if (event->type() != QEvent::User) {
            return QObject::event(event);
        }
        if (--left == 0) {
            loop->exit();
        }
        return true;
    }
};

void prepare() {
    setenv("QT_QPA_PLATFORM", "offscreen", 1);
    tvx::afx::ensureGui();
}

void postedMessages(benchmark::State& state) {
    prepare();
    Counter counter;
    counter.CreateEx(0, AfxRegisterWndClass(0), "", WS_OVERLAPPEDWINDOW, 0, 0, 10, 10, nullptr, nullptr);
    for (auto _ : state) {
        tvx::afx::ModalLoop loop;
        counter.left = state.range(0);
        counter.loop = &loop;
        for (long i = 0; i < state.range(0); ++i) {
            counter.PostMessage(tick);
        }
        loop.run();
    }
    state.SetItemsProcessed(state.iterations() * state.range(0));
    counter.DestroyWindow();
}

void postedToolkitEvents(benchmark::State& state) {
    prepare();
    Receiver receiver;
    for (auto _ : state) {
        QEventLoop loop;
        receiver.left = state.range(0);
        receiver.loop = &loop;
        for (long i = 0; i < state.range(0); ++i) {
            QCoreApplication::postEvent(&receiver, new QEvent(QEvent::User));
        }
        loop.exec();
    }
    state.SetItemsProcessed(state.iterations() * state.range(0));
}

BENCHMARK(postedToolkitEvents)->Arg(1000000)->Unit(benchmark::kMillisecond);
BENCHMARK(postedMessages)->Arg(1000000)->Unit(benchmark::kMillisecond);

} // namespace
