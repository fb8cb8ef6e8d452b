#include "platform/local_drive.h"

#include <wx/filename.h>

#include <cstdio>
#include <map>
#include <memory>
#include <mntent.h>

namespace
{

bool IsServed(const wxString& type)
{
    return type.StartsWith("nfs") || type.StartsWith("cifs") || type.StartsWith("smb") ||
           type.StartsWith("fuse") || type == "9p" || type == "autofs";
}

// For each directory at which a file system is mounted, with a final separator, whether it is on
// this machine.
std::map<wxString, bool> ReadMounts()
{
    std::map<wxString, bool> directories;
    const std::unique_ptr<std::FILE, int (*)(std::FILE*)> mounts(
        setmntent("/proc/self/mounts", "r"), endmntent);
    while (const mntent* mount = mounts ? getmntent(mounts.get()) : nullptr)
    {
        const wxString directory = wxString::FromUTF8(mount->mnt_dir);
        directories[directory == "/" ? directory : directory + "/"] = !IsServed(mount->mnt_type);
    }
    return directories;
}

} // namespace

bool IsOnLocalDrive(const wxString& path)
{
    static const std::map<wxString, bool> mounts = ReadMounts();
    bool isLocal = true;                           // the root of a changed root is not in the list
    for (const auto& [directory, isHere] : mounts) // the longest one that holds the path is last
    {
        if ((path + "/").StartsWith(directory))
            isLocal = isHere;
    }
    return path.StartsWith("/") && isLocal;
}
