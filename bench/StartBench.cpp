// From the start of a program to the first picture of its window: the board sample beside a bare toolkit window with
// the same menus and tool bar. A virtual display without a window manager is started for the purpose, so that a window
// is on screen as soon as its program asks for it, and nothing but the program draws into it.

#include <benchmark/benchmark.h>
#include <xcb/xcb.h>

#include <array>
#include <chrono>
#include <csignal>
#include <cstdlib>
#include <memory>
#include <spawn.h>
#include <stdexcept>
#include <string>
#include <sys/wait.h>
#include <unistd.h>
#include <vector>

namespace {

template <class T>
using Reply = std::unique_ptr<T, decltype(&std::free)>;
template <class T>
Reply<T> reply(T* pointer) {
    return {pointer, &std::free};
}

pid_t start(std::vector<std::string> words, int keptOpen = -1) {
    std::vector<char*> arguments;
    for (std::string& word : words) {
        arguments.push_back(word.data());
    }
    arguments.push_back(nullptr);
    posix_spawn_file_actions_t actions;
    posix_spawn_file_actions_init(&actions);
    posix_spawn_file_actions_addopen(&actions, STDERR_FILENO, "/dev/null", 1, 0);
    if (keptOpen >= 0) {
        posix_spawn_file_actions_adddup2(&actions, keptOpen, 3);
    }
    pid_t child = 0;
    const int error = posix_spawnp(&child, arguments[0], &actions, nullptr, arguments.data(), environ);
    posix_spawn_file_actions_destroy(&actions);
    if (error != 0) {
        throw std::runtime_error("cannot start " + words[0]);
    }
    return child;
}

// A display of its own, which ends with the object.
class Server {
public:
    Server() {
        std::array<int, 2> ends{};
        if (pipe(ends.data()) != 0) {
            throw std::runtime_error("no pipe");
        }
        m_server = start({"Xvfb", "-displayfd", "3", "-screen", "0", "1280x800x24", "-noreset"}, ends[1]);
        close(ends[1]);
        std::string number;
        for (char c = 0; read(ends[0], &c, 1) == 1 && c != '\n';) {
            number += c;
        }
        close(ends[0]);
        setenv("DISPLAY", (":" + number).c_str(), 1);
        m_connection = xcb_connect(nullptr, nullptr);
        if (xcb_connection_has_error(m_connection) != 0) {
            throw std::runtime_error("the virtual display did not start");
        }
        m_root = xcb_setup_roots_iterator(xcb_get_setup(m_connection)).data->root;
        const std::uint32_t wanted = XCB_EVENT_MASK_SUBSTRUCTURE_NOTIFY;
        xcb_change_window_attributes(m_connection, m_root, XCB_CW_EVENT_MASK, &wanted);
        xcb_flush(m_connection);
    }
    Server(const Server&) = delete;
    Server& operator=(const Server&) = delete;
    ~Server() {
        xcb_disconnect(m_connection);
        kill(m_server, SIGTERM);
        waitpid(m_server, nullptr, 0);
    }

    // Waits until a large window has been mapped and drawn: a window's own background is none here, so that the
    // display's black shows until then.
    void waitForPicture() {
        const auto window = mappedWindow();
        while (isBlack(window)) {
            usleep(100);
        }
    }

    void waitUntilGone() {
        while (windowCount() > 0) {
            usleep(1000);
        }
        while (auto event = reply(xcb_poll_for_event(m_connection))) {
        }
    }

private:
    pid_t m_server = 0;
    xcb_connection_t* m_connection = nullptr;
    xcb_window_t m_root = 0;

    xcb_window_t mappedWindow() {
        while (auto event = reply(xcb_wait_for_event(m_connection))) {
            if ((event->response_type & 0x7f) != XCB_MAP_NOTIFY) {
                continue;
            }
            const xcb_window_t window = reinterpret_cast<xcb_map_notify_event_t*>(event.get())->window;
            const auto size =
                reply(xcb_get_geometry_reply(m_connection, xcb_get_geometry(m_connection, window), nullptr));
            if (size && size->width > 500) {
                return window;
            }
        }
        throw std::runtime_error("the display is gone");
    }

    bool isBlack(xcb_window_t window) {
        const auto cookie = xcb_get_image(m_connection, XCB_IMAGE_FORMAT_Z_PIXMAP, window, 3, 3, 1, 1, 0xffffff);
        const auto image = reply(xcb_get_image_reply(m_connection, cookie, nullptr));
        if (!image) {
            throw std::runtime_error("the window has gone before it was drawn");
        }
        const std::uint8_t* data = xcb_get_image_data(image.get());
        return data[0] == 0 && data[1] == 0 && data[2] == 0;
    }

    int windowCount() {
        const auto tree = reply(xcb_query_tree_reply(m_connection, xcb_query_tree(m_connection, m_root), nullptr));
        return tree ? xcb_query_tree_children_length(tree.get()) : 0;
    }
};

void firstPicture(benchmark::State& state, const std::vector<std::string>& command) {
    static Server server;
    for (auto _ : state) {
        const auto begin = std::chrono::steady_clock::now();
        const pid_t child = start(command);
        server.waitForPicture();
        state.SetIterationTime(std::chrono::duration<double>(std::chrono::steady_clock::now() - begin).count());
        kill(child, SIGKILL);
        waitpid(child, nullptr, 0);
        server.waitUntilGone();
    }
}

void board(benchmark::State& state) {
    firstPicture(state, {TVX_BOARD});
}
void bareWindow(benchmark::State& state) {
    firstPicture(state, {TVX_BARE_WINDOW, TVX_TOOL_BAR_PICTURE});
}

// Interleaved by the runner's option --benchmark_enable_random_interleaving=true.
BENCHMARK(bareWindow)->UseManualTime()->Unit(benchmark::kMillisecond)->Iterations(10)->Repetitions(5);
BENCHMARK(board)->UseManualTime()->Unit(benchmark::kMillisecond)->Iterations(10)->Repetitions(5);

} // namespace

int main(int argc, char** argv) {
    // Both programs as a user has them, but with settings of their own.
    const std::string home = "/tmp/tvx-start-bench." + std::to_string(getpid());
    setenv("HOME", home.c_str(), 1);
    for (const char* name : {"XDG_CONFIG_HOME", "XDG_CACHE_HOME", "TVX_REGISTRY", "WAYLAND_DISPLAY"}) {
        unsetenv(name);
    }
    setenv("QT_QPA_PLATFORM", "xcb", 1);
    benchmark::Initialize(&argc, argv);
    benchmark::RunSpecifiedBenchmarks();
    return 0;
}
