// A directory that cannot be replaced while it is in use; one source for each system.
#pragma once

#include <wx/string.h>

#include <cstdint>
#include <utility>

/// Whether the last part of a path may be a link: a symbolic link, on Windows any reparse point
/// whose tag is a name surrogate. A cloud file's placeholder is not a link.
enum class Links
{
    Follow,
    Refuse
};

/// Whether the path itself, not its target, is a link.
bool IsLink(const wxString& path);

/// Prevents a directory from being replaced with another one, or with a link, between two accesses.
///
/// Windows: a handle without FILE_SHARE_DELETE, so that neither the directory nor one above it can
/// be renamed or removed. Elsewhere: a descriptor; entries are reached through /proc/self/fd.
class PinnedDirectory
{
  public:
    PinnedDirectory(const wxString& path, Links links);
    ~PinnedDirectory();
    PinnedDirectory(const PinnedDirectory&) = delete;
    PinnedDirectory& operator=(const PinnedDirectory&) = delete;

    /// False if there is no such directory, if it cannot be opened, or if it is a refused link.
    bool IsOpen() const;

    /// The path of an entry, or of the directory itself if the name is empty, for calls but not for
    /// messages: on Linux it names the descriptor. It leads nowhere if the directory is not open.
    wxString Reach(const wxString& name) const;

    /// Volume and file index, or device and inode. Two zeros if it is not open.
    std::pair<std::uint64_t, std::uint64_t> Identity() const;

#ifdef _WIN32
    /// Whether an open file is directly in the directory, and was not reached over a link.
    bool Holds(void* file) const;
#endif

  private:
#ifdef _WIN32
    void* m_handle = nullptr;
    wxString m_finalPath;
    wxString m_path;
#else
    int m_descriptor = -1;
#endif
};
