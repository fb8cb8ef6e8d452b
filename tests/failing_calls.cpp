// Preloaded before the C library (LD_PRELOAD): makes something happen at one of the program's
// calls.
//
// It counts the calls that concern a path below $FAULT_ROOT, by name or by descriptor, or only
// those of them that $FAULT_CALLS lists. The letters of $FAULT_EVENTS say what happens at call
// number $FAULT_NUMBER and at those that follow it:
//   f  the call does nothing and fails with the error number $FAULT_ERROR
//   s  it writes half of what it is given
//   e  the process ends before the call
//   x  before the call, $FAULT_VICTIM is replaced with a symbolic link to $FAULT_TARGET
// The path of the first of these calls is written to the file $FAULT_REPORT.
#include <cerrno>
#include <csignal>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <dlfcn.h>
#include <sys/syscall.h>
#include <unistd.h>

namespace
{

// The path; if it begins with a descriptor, the one that it leads to.
void Resolve(const char* path, char* resolved, size_t size)
{
    char link[64] = {};
    char target[4096] = {};
    int length = 0;
    if (std::sscanf(path, "/proc/self/fd/%*d%n", &length) == 0 && length > 0)
        std::snprintf(link, sizeof link, "%.*s", length, path);
    const bool isLink = length > 0 && readlink(link, target, sizeof target - 1) > 0;
    std::snprintf(resolved, size, "%s%s", target, isLink ? path + length : path);
}

bool IsListed(const char* call)
{
    static const char* const calls = std::getenv("FAULT_CALLS");
    const char* const found = std::strstr(calls, call);
    return *calls == '\0' || (found && found[std::strlen(call)] == ' ');
}

void Exchange()
{
    const char* const victim = std::getenv("FAULT_VICTIM");
    char away[4096] = {};
    std::snprintf(away, sizeof away, "%s away", std::getenv("FAULT_REPORT"));
    syscall(SYS_rename, victim, away);
    if (symlink(std::getenv("FAULT_TARGET"), victim) != 0)
        std::abort();
}

// What happens at this call; in plain C, because calls also come before and after main.
char Event(const char* call, const char* path)
{
    static const char* const root = std::getenv("FAULT_ROOT");
    static const char* const events = std::getenv("FAULT_EVENTS");
    static const long number = std::atol(std::getenv("FAULT_NUMBER"));
    static long count = 0;
    char resolved[8192] = {};
    Resolve(path, resolved, sizeof resolved);
    if (!IsListed(call) || std::strncmp(resolved, root, std::strlen(root)) != 0 ||
        ++count < number || count - number >= static_cast<long>(std::strlen(events)))
        return '\0';
    if (count == number)
    {
        std::FILE* const report = std::fopen(std::getenv("FAULT_REPORT"), "w");
        std::fputs(resolved, report);
        std::fclose(report);
    }
    const char event = events[count - number];
    if (event == 'e')
        kill(getpid(), SIGKILL);
    if (event == 'x')
        Exchange();
    return event;
}

using Call = long (*)(long, long, long, long, long);

// The arguments are integers and pointers, which are all passed alike.
long Try(Call real, const char* name, bool isPath, long failure, long a, long b, long c, long d,
         long e)
{
    char path[32] = {};
    std::snprintf(path, sizeof path, "/proc/self/fd/%ld", a);
    const int before = errno;
    const char event = Event(name, isPath ? reinterpret_cast<const char*>(a) : path);
    errno = before;
    if (event == 'f' && std::strcmp(name, "close") == 0)
        real(a, b, c, d, e); // it closes the file anyway
    if (event == 'f')
        errno = std::atoi(std::getenv("FAULT_ERROR"));
    if (event != 'f' && std::strcmp(name, "fsync") == 0)
        return 0; // the disk need not keep anything
    return event == 'f' ? failure : real(a, b, event == 's' ? c / 2 : c, d, e);
}

} // namespace

#define WRAP(name, isPath, failure)                                                                \
    extern "C" long Wrapped_##name(long a, long b, long c, long d, long e) __asm__(#name);         \
    long Wrapped_##name(long a, long b, long c, long d, long e)                                    \
    {                                                                                              \
        static const auto real = reinterpret_cast<Call>(dlsym(RTLD_NEXT, #name));                  \
        return Try(real, #name, isPath, failure, a, b, c, d, e);                                   \
    }

WRAP(open64, true, -1)
WRAP(opendir, true, 0)
WRAP(access, true, -1)
WRAP(stat64, true, -1)
WRAP(lstat64, true, -1)
WRAP(chmod, true, -1)
WRAP(unlink, true, -1)
WRAP(getxattr, true, -1)
WRAP(setxattr, true, -1)
WRAP(removexattr, true, -1)
WRAP(fstat64, false, -1)
WRAP(pread64, false, -1)
WRAP(pwrite64, false, -1)
WRAP(ftruncate64, false, -1)
WRAP(fallocate64, false, -1)
WRAP(fsync, false, -1)
WRAP(fchmod, false, -1)
WRAP(close, false, -1)
