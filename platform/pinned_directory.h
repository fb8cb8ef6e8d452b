// A directory that stays the same one while it is worked in; one source for each system.
#pragma once

#include <wx/string.h>

#include <cstdint>
#include <utility>

/// Whether the last part of a path may be a link: a symbolic link, on Windows any reparse point
/// whose tag says that it names another file or directory. A cloud file's placeholder is no link.
enum class Links
{
    Follow,
    Refuse
};

/// Whether there is a link of that name. The link itself is looked at, not what it leads to.
bool IsLink(const wxString& path);

/// Keeps a directory from being exchanged for another one, or for a link, between two looks at it.
///
/// Windows: a handle without FILE_SHARE_DELETE, so that neither the directory nor one above it can
/// be renamed or removed. Elsewhere: a descriptor; what is below it is reached by way of
/// /proc/self/fd.
class PinnedDirectory
{
  public:
    PinnedDirectory(const wxString& path, Links links);
    ~PinnedDirectory();
    PinnedDirectory(const PinnedDirectory&) = delete;
    PinnedDirectory& operator=(const PinnedDirectory&) = delete;

    /// False when there is no such directory, when it cannot be entered, or when it is a refused
    /// link.
    bool IsOpen() const;

    /// The path of an entry, or for an empty name of the directory itself, for the calls of the
    /// system and of the library. Not for people: on Linux it names the descriptor. Of a directory
    /// that is not open it leads nowhere.
    wxString Reach(const wxString& name) const;

    /// What no other directory has while both are open: volume and file index, or device and inode.
    /// Two zeros of one that is not open.
    std::pair<std::uint64_t, std::uint64_t> Identity() const;

  private:
#ifdef _WIN32
    void* m_handle = nullptr;
    wxString m_path;
#else
    int m_descriptor = -1;
#endif
};
