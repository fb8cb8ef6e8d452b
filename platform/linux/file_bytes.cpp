#include "platform/linux/file_bytes.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

bool ReadFileBytes(const std::string& path, std::string& bytes, mode_t* mode)
{
    // So that a pipe in the file's place holds nobody up.
    const int file = open(path.c_str(), O_RDONLY | O_NONBLOCK | O_CLOEXEC);
    if (file < 0)
        return false;
    struct stat status = {};
    bool isWhole = false;
    if (fstat(file, &status) == 0 && S_ISREG(status.st_mode))
    {
        bytes.resize(static_cast<size_t>(status.st_size));
        isWhole = read(file, bytes.data(), bytes.size()) == status.st_size;
    }
    close(file);
    if (mode)
        *mode = status.st_mode;
    return isWhole;
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
