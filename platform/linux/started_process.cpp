#include "platform/started_process.h"

#include <array>
#include <cerrno>
#include <csignal>
#include <fcntl.h>
#include <spawn.h>
#include <sys/wait.h>
#include <thread>
#include <unistd.h>

namespace
{

// Returns the system's error, or 0.
int Start(const wxString& path, const wxString& argument, pid_t& child)
{
    std::array<std::string, 2> words = {path.utf8_string(), argument.utf8_string()};
    const std::array<char*, 3> argv = {words[0].data(), words[1].data(), nullptr};
    posix_spawn_file_actions_t actions;
    posix_spawn_file_actions_init(&actions);
    for (const int stream : {STDIN_FILENO, STDOUT_FILENO, STDERR_FILENO})
        posix_spawn_file_actions_addopen(&actions, stream, "/dev/null", O_RDWR, 0);
    posix_spawn_file_actions_addclosefrom_np(&actions, STDERR_FILENO + 1);
    const int error = posix_spawn(&child, argv[0], &actions, nullptr, argv.data(), environ);
    posix_spawn_file_actions_destroy(&actions);
    return error;
}

} // namespace

ProgramRun RunProgram(const wxString& path, const wxString& argument,
                      std::chrono::steady_clock::time_point deadline)
{
    pid_t child = 0;
    errno = Start(path, argument, child);
    if (errno != 0)
        return {FailedCall::Now(FailedCall::Open)};
    int status = 0;
    while (waitpid(child, &status, WNOHANG) == 0)
    {
        const auto late = std::chrono::steady_clock::now() - deadline;
        if (late > std::chrono::seconds(0))
            kill(child, SIGKILL);
        if (late > std::chrono::seconds(5))
            break;
        std::this_thread::sleep_for(std::chrono::milliseconds(10));
    }
    return {{}, WIFEXITED(status) ? static_cast<signed char>(WEXITSTATUS(status)) : 0};
}
