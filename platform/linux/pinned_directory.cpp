#include "platform/pinned_directory.h"

#include "platform/path_normal_form.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

bool IsLink(const wxString& path)
{
    struct stat status = {};
    return lstat(WithoutFinalSeparators(path).utf8_str(), &status) == 0 && S_ISLNK(status.st_mode);
}

// With a separator at the end of the path, a link would be followed.
PinnedDirectory::PinnedDirectory(const wxString& path, Links links)
    : m_descriptor(links == Links::Follow ? open(path.utf8_str(), O_PATH | O_DIRECTORY | O_CLOEXEC)
                                          : open(WithoutFinalSeparators(path).utf8_str(),
                                                 O_PATH | O_DIRECTORY | O_CLOEXEC | O_NOFOLLOW))
{
}

PinnedDirectory::~PinnedDirectory()
{
    if (IsOpen())
        close(m_descriptor);
}

bool PinnedDirectory::IsOpen() const
{
    return m_descriptor >= 0;
}

wxString PinnedDirectory::Reach(const wxString& name) const
{
    // No descriptor has the number -1.
    return "/proc/self/fd/" + std::to_string(m_descriptor) + "/" + name;
}

std::pair<std::uint64_t, std::uint64_t> PinnedDirectory::Identity() const
{
    struct stat status = {};
    if (!IsOpen() || fstat(m_descriptor, &status) != 0)
        return {};
    return {status.st_dev, status.st_ino};
}
