#include "tests/process.h"

#include <grp.h>
#include <unistd.h>

void Become(const std::vector<std::string>& commandLine, bool asOtherUser)
{
    constexpr unsigned TimeLimitSeconds = 120;
    if (asOtherUser && geteuid() == 0 && (setgroups(0, nullptr) != 0 || setgid(OtherUser) != 0 || setuid(OtherUser) != 0))
        _exit(126);
    alarm(TimeLimitSeconds);
    std::vector<char*> argv;
    for (const std::string& argument : commandLine)
        argv.push_back(const_cast<char*>(argument.c_str()));
    argv.push_back(nullptr);
    execv(argv[0], argv.data());
    _exit(127);
}
