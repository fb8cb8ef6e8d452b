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
// The first of these calls and its path are written to the file $FAULT_REPORT.
#include <cerrno>
#include <csignal>
#include <cstdarg>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <dirent.h>
#include <dlfcn.h>
#include <fcntl.h>
#include <sys/stat.h>
#include <sys/syscall.h>
#include <sys/xattr.h>
#include <unistd.h>

namespace
{

template <typename Function>
Function Real(Function /*replacement*/, const char* name)
{
    return reinterpret_cast<Function>(dlsym(RTLD_NEXT, name));
}

int FailAfter(int /*result*/)
{
    errno = std::atoi(std::getenv("FAULT_ERROR"));
    return -1;
}

// If the path begins with a descriptor, the path that it leads to.
void Resolve(const char* path, char* resolved, size_t size)
{
    const char* const descriptors = "/proc/self/fd/";
    const size_t length = std::strlen(descriptors);
    std::snprintf(resolved, size, "%s", path);
    if (std::strncmp(path, descriptors, length) != 0)
        return;
    const char* rest = std::strchr(path + length, '/');
    rest = rest ? rest : path + std::strlen(path);
    char link[64] = {};
    char target[4096] = {};
    std::snprintf(link, sizeof link, "%.*s", static_cast<int>(rest - path), path);
    if (readlink(link, target, sizeof target - 1) > 0)
        std::snprintf(resolved, size, "%s%s", target, rest);
}

bool IsListed(const char* call)
{
    static const char* const calls = std::getenv("FAULT_CALLS");
    const char* const found = std::strstr(calls, call);
    return *calls == '\0' || (found && found[std::strlen(call)] == ' ');
}

void Report(const char* call, const char* path)
{
    const int report = open(std::getenv("FAULT_REPORT"), O_WRONLY | O_CREAT, 0600);
    if (dprintf(report, "%s\t%s", call, path) < 0)
        std::abort();
}

void Exchange()
{
    const char* const victim = std::getenv("FAULT_VICTIM");
    char away[4096] = {};
    std::snprintf(away, sizeof away, "%s away", victim);
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
    const char event = events[count - number];
    if (count == number)
        Report(call, resolved);
    if (event == 'e')
        kill(getpid(), SIGKILL);
    if (event == 'x')
        Exchange();
    return event;
}

bool Fails(const char* call, const char* path)
{
    const int before = errno;
    const bool fails = Event(call, path) == 'f';
    errno = before;
    if (fails)
        FailAfter(0);
    return fails;
}

struct PathOf
{
    explicit PathOf(int descriptor)
    {
        std::snprintf(path, sizeof path, "/proc/self/fd/%d", descriptor);
    }

    char path[32] = {};
};

bool Fails(const char* call, int descriptor)
{
    return Fails(call, PathOf(descriptor).path);
}

} // namespace

// Defines a call: its result, name and parameters, its arguments, what identifies its file, and how
// it fails.
#define FAILING(result, name, parameters, arguments, subject, failure)                             \
    extern "C" result name parameters                                                              \
    {                                                                                              \
        static const auto real = Real(&name, #name);                                               \
        return Fails(#name, subject) ? (failure) : real arguments;                                 \
    }
extern "C" int open64(const char* path, int flags, ...)
{
    static const auto real = Real(&open64, "open64");
    va_list rest;
    va_start(rest, flags);
    const mode_t mode = (flags & O_CREAT) != 0 ? va_arg(rest, mode_t) : 0;
    va_end(rest);
    return Fails("open64", path) ? -1 : real(path, flags, mode);
}

extern "C" ssize_t pwrite64(int file, const void* data, size_t size, off64_t offset)
{
    static const auto real = Real(&pwrite64, "pwrite64");
    const char event = Event("pwrite64", PathOf(file).path);
    return event == 'f' ? FailAfter(0) : real(file, data, event == 's' ? size / 2 : size, offset);
}

FAILING(DIR*, opendir, (const char* path), (path), path, nullptr)
FAILING(dirent64*, readdir64, (DIR * dir), (dir), dirfd(dir), nullptr)
FAILING(ssize_t, pread64, (int file, void* data, size_t size, off64_t offset),
        (file, data, size, offset), file, -1)
FAILING(int, ftruncate64, (int file, off64_t length) noexcept, (file, length), file, -1)
FAILING(int, fallocate64, (int file, int mode, off64_t from, off64_t length),
        (file, mode, from, length), file, -1)
FAILING(int, fsync, (int file), (file), file, -1)
FAILING(int, close, (int file), (file), file, FailAfter(real(file))) // it closes the file anyway
FAILING(int, access, (const char* path, int mode) noexcept, (path, mode), path, -1)
FAILING(int, stat64, (const char* path, struct stat64* status) noexcept, (path, status), path, -1)
FAILING(int, lstat64, (const char* path, struct stat64* status) noexcept, (path, status), path, -1)
FAILING(int, fstatat64,
        (int directory, const char* path, struct stat64* status, int flags) noexcept,
        (directory, path, status, flags), path, -1)
FAILING(int, fstat64, (int file, struct stat64* status) noexcept, (file, status), file, -1)
FAILING(int, chmod, (const char* path, mode_t mode) noexcept, (path, mode), path, -1)
FAILING(int, fchmod, (int file, mode_t mode) noexcept, (file, mode), file, -1)
FAILING(int, unlink, (const char* path) noexcept, (path), path, -1)
FAILING(ssize_t, getxattr, (const char* path, const char* name, void* data, size_t size) noexcept,
        (path, name, data, size), path, -1)
FAILING(int, setxattr,
        (const char* path, const char* name, const void* data, size_t size, int flags) noexcept,
        (path, name, data, size, flags), path, -1)
FAILING(int, removexattr, (const char* path, const char* name) noexcept, (path, name), path, -1)
