#include "tools/rc/Process.h"

#include <spawn.h>
#include <sys/wait.h>
#include <unistd.h>

#include <cstdio>
#include <cstring>
#include <memory>
#include <stdexcept>

extern char** environ;

namespace rc {

namespace {

using TemporaryFile = std::unique_ptr<std::FILE, int (*)(std::FILE*)>;

// Temporary files instead of pipes: a child may write to both outputs before it has read its input.
TemporaryFile temporaryFile() {
    TemporaryFile file(std::tmpfile(), &std::fclose);
    if (!file) {
        throw std::runtime_error(std::string("no temporary file: ") + std::strerror(errno));
    }
    return file;
}

std::string contents(std::FILE* file) {
    std::string text;
    char buffer[4096];
    std::rewind(file);
    while (const std::size_t count = std::fread(buffer, 1, sizeof buffer, file)) {
        text.append(buffer, count);
    }
    return text;
}

int exitCodeOf(int status) {
    return WIFEXITED(status) ? WEXITSTATUS(status) : 128 + WTERMSIG(status);
}

} // namespace

ChildResult run(const std::vector<std::string>& arguments, const std::string& input) {
    const TemporaryFile files[] = {temporaryFile(), temporaryFile(), temporaryFile()};
    std::fwrite(input.data(), 1, input.size(), files[0].get());
    std::rewind(files[0].get());

    posix_spawn_file_actions_t actions;
    posix_spawn_file_actions_init(&actions);
    for (int i = 0; i < 3; ++i) {
        posix_spawn_file_actions_adddup2(&actions, fileno(files[i].get()), i);
    }
    std::vector<char*> words;
    for (const std::string& argument : arguments) {
        words.push_back(const_cast<char*>(argument.c_str()));
    }
    words.push_back(nullptr);
    pid_t child = 0;
    const int error = posix_spawnp(&child, words[0], &actions, nullptr, words.data(), environ);
    posix_spawn_file_actions_destroy(&actions);
    if (error != 0) {
        return {127, {}, arguments[0] + ": " + std::strerror(error) + "\n"};
    }

    int status = 0;
    while (waitpid(child, &status, 0) < 0 && errno == EINTR) {
    }
    return {exitCodeOf(status), contents(files[1].get()), contents(files[2].get())};
}

} // namespace rc
