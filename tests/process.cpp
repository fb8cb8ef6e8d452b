#include "tests/process.h"

#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <grp.h>
#include <sys/resource.h>
#include <sys/wait.h>
#include <thread>
#include <unistd.h>

namespace
{

[[noreturn]] void Become(const Process& process)
{
    for (const auto& [name, value] : process.environment)
        setenv(name.c_str(), value.c_str(), 1);
    if (!std::freopen(process.output.c_str(), "w", stdout) ||
        (!process.errors.empty() && !std::freopen(process.errors.c_str(), "w", stderr)))
        _exit(125);
    if (process.asOtherUser && geteuid() == 0 &&
        (setgroups(0, nullptr) != 0 || setgid(OtherUser) != 0 || setuid(OtherUser) != 0))
        _exit(126);
    alarm(120);
    std::vector<char*> argv;
    for (const std::string& argument : process.commandLine)
        argv.push_back(const_cast<char*>(argument.c_str()));
    argv.push_back(nullptr);
    execv(argv[0], argv.data());
    _exit(127);
}

} // namespace

ProcessResult RunToTheEnd(const Process& process, const std::function<void(double)>& meanwhile)
{
    const auto start = std::chrono::steady_clock::now();
    const auto elapsed = [&]()
    {
        return std::chrono::duration<double>(std::chrono::steady_clock::now() - start).count();
    };
    std::fflush(nullptr); // or the child writes the buffer a second time
    const pid_t child = fork();
    if (child == 0)
        Become(process);
    int status = 0;
    rusage usage = {};
    while (wait4(child, &status, meanwhile ? WNOHANG : 0, &usage) == 0)
    {
        std::this_thread::sleep_for(std::chrono::milliseconds(elapsed() < 1 ? 10 : 100));
        meanwhile(elapsed());
    }
    return {WIFEXITED(status) ? WEXITSTATUS(status) : -WTERMSIG(status), elapsed(),
            usage.ru_maxrss / 1024};
}
