// Put in front of the C library with LD_PRELOAD: one call of the program fails.
//
// Of the calls that concern a path below $FAULT_ROOT, by name or by descriptor, number
// $FAULT_NUMBER does nothing and fails with the error number $FAULT_ERROR. The call and its path
// then stand in the file $FAULT_REPORT.
#include <cerrno>
#include <cstdarg>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <dirent.h>
#include <dlfcn.h>
#include <fcntl.h>
#include <sys/stat.h>
#include <sys/xattr.h>
#include <unistd.h>

namespace
{

constexpr int StreamError = 0x20; // the flag of a stream that ferror reads

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

// Whether it is this call's turn. Plain C, since calls come before main and after it, too.
bool IsHit(const char* call, const char* path)
{
    static const char* const root = std::getenv("FAULT_ROOT");
    static const long number = std::atol(std::getenv("FAULT_NUMBER"));
    static long count = 0;
    if (std::strncmp(path, root, std::strlen(root)) != 0 || ++count != number)
        return false;
    const int report = open(std::getenv("FAULT_REPORT"), O_WRONLY | O_CREAT, 0600);
    if (dprintf(report, "%s\t%s", call, path) < 0)
        std::abort();
    FailAfter(0);
    return true;
}

bool IsHit(const char* call, int descriptor)
{
    const int before = errno;
    char link[32] = {};
    char path[4096] = {};
    std::snprintf(link, sizeof link, "/proc/self/fd/%d", descriptor);
    const bool isKnown = readlink(link, path, sizeof path - 1) > 0;
    errno = before;
    return isKnown && IsHit(call, path);
}

bool IsHit(const char* call, FILE* stream)
{
    const bool isHit = stream && IsHit(call, fileno(stream));
    if (isHit)
        stream->_flags |= StreamError;
    return isHit;
}

} // namespace

// The call with its parameters, what it is given, by what it is recognised, and how it fails.
#define FAILING(result, name, parameters, arguments, subject, failure)                                                                     \
    extern "C" result name parameters                                                                                                      \
    {                                                                                                                                      \
        static const auto real = Real(&name, #name);                                                                                       \
        return IsHit(#name, subject) ? (failure) : real arguments;                                                                         \
    }
extern "C" int open64(const char* path, int flags, ...)
{
    static const auto real = Real(&open64, "open64");
    va_list rest;
    va_start(rest, flags);
    const mode_t mode = (flags & O_CREAT) != 0 ? va_arg(rest, mode_t) : 0;
    va_end(rest);
    return IsHit("open64", path) ? -1 : real(path, flags, mode);
}

FAILING(int, mkstemp64, (char* path), (path), path, -1)
FAILING(FILE*, fopen64, (const char* path, const char* mode), (path, mode), path, nullptr)
FAILING(DIR*, opendir, (const char* path), (path), path, nullptr)
FAILING(dirent64*, readdir64, (DIR * dir), (dir), dirfd(dir), nullptr)
FAILING(ssize_t, read, (int file, void* data, size_t size), (file, data, size), file, -1)
FAILING(ssize_t, write, (int file, const void* data, size_t size), (file, data, size), file, -1)
FAILING(size_t, fread, (void* data, size_t size, size_t count, FILE* file), (data, size, count, file), file, 0)
FAILING(size_t, fwrite, (const void* data, size_t size, size_t count, FILE* file), (data, size, count, file), file, 0)
FAILING(int, fflush, (FILE * file), (file), file, EOF)
FAILING(int, fsync, (int file), (file), file, -1)
// These close all the same.
FAILING(int, close, (int file), (file), file, FailAfter(real(file)))
FAILING(int, fclose, (FILE * file), (file), file, FailAfter(real(file)))
FAILING(int, access, (const char* path, int mode) noexcept, (path, mode), path, -1)
FAILING(int, stat64, (const char* path, struct stat64* status) noexcept, (path, status), path, -1)
FAILING(int, lstat64, (const char* path, struct stat64* status) noexcept, (path, status), path, -1)
FAILING(int, fstat64, (int file, struct stat64* status) noexcept, (file, status), file, -1)
FAILING(int, chmod, (const char* path, mode_t mode) noexcept, (path, mode), path, -1)
FAILING(int, unlink, (const char* path) noexcept, (path), path, -1)
FAILING(int, rename, (const char* from, const char* to) noexcept, (from, to), to, -1)
FAILING(ssize_t, getxattr, (const char* path, const char* name, void* data, size_t size) noexcept, (path, name, data, size), path, -1)
FAILING(int, setxattr, (const char* path, const char* name, const void* data, size_t size, int flags) noexcept,
        (path, name, data, size, flags), path, -1)
FAILING(int, removexattr, (const char* path, const char* name) noexcept, (path, name), path, -1)
