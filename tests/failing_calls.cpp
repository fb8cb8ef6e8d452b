// Preloaded before the C library (LD_PRELOAD): makes something happen at one of the program's
// calls. It counts those that concern a path below $FAULT_ROOT, by name or by descriptor, and that
// $FAULT_CALLS names, if any. The letters of $FAULT_EVENTS say what happens at call number
// $FAULT_NUMBER and at those that follow it:
//   f  the call does nothing and fails with the error number $FAULT_ERROR
//   s  it writes half of what it is given
//   e  the process ends before the call
//   x  before the call, the symbolic link $FAULT_LINK takes the place of $FAULT_VICTIM
// The path of the first of these calls is printed.
#include <cerrno>
#include <climits>
#include <csignal>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <dlfcn.h>
#include <fcntl.h>
#include <unistd.h>

namespace
{

// What happens at this call; in plain C, because calls also come before and after main.
char Event(const char* call, const char* path)
{
    static const char* const calls = std::getenv("FAULT_CALLS");
    static const char* const root = std::getenv("FAULT_ROOT");
    static const char* const events = std::getenv("FAULT_EVENTS");
    static const char* const victim = std::getenv("FAULT_VICTIM");
    static const char* const link = std::getenv("FAULT_LINK");
    static const long number = std::atol(std::getenv("FAULT_NUMBER"));
    static long count = 0;
    char resolved[PATH_MAX] = {}; // what there is of the path, without links
    if ((*calls != '\0' && !std::strstr(calls, call)) ||
        (!realpath(path, resolved) && *resolved == '\0') ||
        std::strncmp(resolved, root, std::strlen(root)) != 0 || ++count < number ||
        count - number >= static_cast<long>(std::strlen(events)))
        return '\0';
    if (count == number)
        dprintf(STDOUT_FILENO, "%s", resolved);
    const char event = events[count - number];
    if (event == 'e')
        std::raise(SIGKILL);
    if (event == 'x' && renameat2(AT_FDCWD, link, AT_FDCWD, victim, RENAME_EXCHANGE) != 0 &&
        std::rename(link, victim) != 0)
        std::abort();
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
    if (event == 'f' && std::strcmp(name, "close") == 0)
        real(a, b, c, d, e); // it closes the file anyway
    errno = event == 'f' ? std::atoi(std::getenv("FAULT_ERROR")) : before;
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
