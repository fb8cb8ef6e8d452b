#include "platform/posix/file_bytes.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

bool ReadFileBytes(const std::string& path, std::string& bytes)
{
    struct stat status = {};
    if (stat(path.c_str(), &status) != 0 || !S_ISREG(status.st_mode))
        return false;
    const int file = open(path.c_str(), O_RDONLY | O_CLOEXEC);
    if (file < 0)
        return false;
    bytes.resize(static_cast<size_t>(status.st_size));
    const ssize_t count = read(file, bytes.data(), bytes.size());
    close(file);
    return count == status.st_size;
}

bool WriteFileBytes(const std::string& path, const std::string& bytes)
{
    constexpr mode_t Everybody = S_IRUSR | S_IWUSR | S_IRGRP | S_IWGRP | S_IROTH | S_IWOTH;
    const int file = open(path.c_str(), O_WRONLY | O_CREAT | O_TRUNC | O_CLOEXEC, Everybody);
    if (file < 0)
        return false;
    const ssize_t count = write(file, bytes.data(), bytes.size());
    return close(file) == 0 && count == static_cast<ssize_t>(bytes.size());
}
