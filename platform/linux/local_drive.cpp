#include "platform/local_drive.h"

#include <wx/filename.h>

#include <cstdio>
#include <memory>
#include <mntent.h>

namespace
{

bool IsServed(const wxString& type)
{
    return type.StartsWith("nfs") || type.StartsWith("cifs") || type.StartsWith("smb") ||
           type.StartsWith("fuse") || type == "9p" || type == "autofs";
}

} // namespace

bool IsOnLocalDrive(const wxString& path)
{
    if (!path.StartsWith("/"))
        return false;
    const std::unique_ptr<std::FILE, int (*)(std::FILE*)> mounts(
        setmntent("/proc/self/mounts", "r"), endmntent);
    size_t longest = 0;
    bool isLocal = mounts != nullptr;
    while (const mntent* mount = mounts ? getmntent(mounts.get()) : nullptr)
    {
        const wxString directory = wxString::FromUTF8(mount->mnt_dir);
        const bool holds =
            directory == "/" || path == directory || path.StartsWith(directory + "/");
        if (!holds || directory.length() < longest)
            continue;
        longest = directory.length();
        isLocal = !IsServed(mount->mnt_type);
    }
    return isLocal;
}
