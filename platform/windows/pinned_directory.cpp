#include "platform/pinned_directory.h"

#include "platform/path_normal_form.h"
#include "platform/windows/link_handle.h"

#include <wx/filename.h>

#include <vector>

namespace
{

// With a separator at the end of the path, a link might be followed.
HANDLE Open(const wxString& path, DWORD access, Links links)
{
    const DWORD flags =
        FILE_FLAG_BACKUP_SEMANTICS | (links == Links::Refuse ? FILE_FLAG_OPEN_REPARSE_POINT : 0);
    const wxString name = links == Links::Refuse ? WithoutFinalSeparators(path) : path;
    return CreateFileW(name.wc_str(), access, FILE_SHARE_READ | FILE_SHARE_WRITE, nullptr,
                       OPEN_EXISTING, flags, nullptr);
}

// Only a handle with the right to list or traverse the directory prevents others from renaming it.
// While the handle is open, the name leads to the same directory or link. The name is checked too,
// because under Wine only that reveals a link of the underlying system.
HANDLE Pin(const wxString& path, Links links)
{
    HANDLE handle = Open(path, FILE_LIST_DIRECTORY | FILE_READ_ATTRIBUTES, links);
    if (handle == INVALID_HANDLE_VALUE)
        handle = Open(path, FILE_TRAVERSE | FILE_READ_ATTRIBUTES, links);
    if (handle == INVALID_HANDLE_VALUE ||
        ((AttributesOf(handle) & FILE_ATTRIBUTE_DIRECTORY) != 0 &&
         !(links == Links::Refuse && (IsLinkHandle(handle) || IsLink(path)))))
        return handle;
    CloseHandle(handle);
    return INVALID_HANDLE_VALUE;
}

// The path without links, which begins with \\?\; empty if the system does not say.
wxString FinalPath(HANDLE handle)
{
    constexpr DWORD Longest = 32767; // characters
    std::vector<wchar_t> buffer(Longest + 1);
    DWORD length = GetFinalPathNameByHandleW(handle, buffer.data(), Longest, FILE_NAME_NORMALIZED);
    if (length == 0) // some network file systems do not normalise
        length = GetFinalPathNameByHandleW(handle, buffer.data(), Longest, FILE_NAME_OPENED);
    return length <= Longest ? wxString(buffer.data(), length) : wxString();
}

// The path by which entries are reached: without links, because a link's target may be replaced.
// The given one if the other is too long for calls that accept only MAX_PATH characters, including
// the file name.
wxString ReachedPath(const wxString& final, const wxString& path)
{
    constexpr size_t Longest = MAX_PATH - 40;
    if (final.empty() || final.length() > Longest)
        return path;
    if (final.StartsWith(L"\\\\?\\UNC\\"))
        return L"\\" + final.Mid(7);
    return final.StartsWith(L"\\\\?\\") ? final.Mid(4) : final;
}

} // namespace

bool IsLink(const wxString& path)
{
    WIN32_FIND_DATAW found = {};
    const HANDLE search = FindFirstFileW(WithoutFinalSeparators(path).wc_str(), &found);
    if (search == INVALID_HANDLE_VALUE)
    {
        const DWORD error = GetLastError();
        return error != ERROR_FILE_NOT_FOUND && error != ERROR_PATH_NOT_FOUND &&
               error != ERROR_INVALID_NAME;
    }
    FindClose(search);
    // Wine shows a symbolic link of the underlying system with a tag of 0; Windows has no such tag.
    return (found.dwFileAttributes & FILE_ATTRIBUTE_REPARSE_POINT) != 0 &&
           (found.dwReserved0 == 0 || IsReparseTagNameSurrogate(found.dwReserved0));
}

PinnedDirectory::PinnedDirectory(const wxString& path, Links links)
    : m_handle(Pin(path, links)), m_finalPath(IsOpen() ? FinalPath(m_handle) : wxString()),
      m_path(links == Links::Follow ? ReachedPath(m_finalPath, path) : path)
{
}

PinnedDirectory::~PinnedDirectory()
{
    if (IsOpen())
        CloseHandle(m_handle);
}

bool PinnedDirectory::IsOpen() const
{
    return m_handle != INVALID_HANDLE_VALUE;
}

wxString PinnedDirectory::Reach(const wxString& name) const
{
    if (!IsOpen())
        return "|"; // no file name has this character
    if (name.empty() || m_path.empty() || wxFileName::IsPathSeparator(m_path.Last()))
        return m_path + name;
    return m_path + wxFileName::GetPathSeparator() + name;
}

bool PinnedDirectory::Holds(void* file) const
{
    const wxString path = FinalPath(file);
    return !path.empty() && WithoutFinalSeparators(m_finalPath) == path.BeforeLast('\\');
}

std::pair<std::uint64_t, std::uint64_t> PinnedDirectory::Identity() const
{
    BY_HANDLE_FILE_INFORMATION information = {};
    // Some network file systems do not number files.
    if (!IsOpen() || GetFileInformationByHandle(m_handle, &information) == 0 ||
        (information.nFileIndexHigh == 0 && information.nFileIndexLow == 0))
        return {};
    return {information.dwVolumeSerialNumber,
            std::uint64_t{information.nFileIndexHigh} << 32 | information.nFileIndexLow};
}
