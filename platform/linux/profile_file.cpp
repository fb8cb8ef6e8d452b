// Profile files (.ini): one key is read or changed; every other byte of the file stays. Sections,
// keys and values have to be ASCII.
#include "platform/linux/native_path.h"
#include "platform/linux/profile_text.h"
#include "platform/regular_file.h"
#include "platform/system.h"

#include <wx/string.h>

#include <algorithm>
#include <string>

namespace
{

const std::wstring LineEnd = L"\r\n";

struct ProfilePath
{
    explicit ProfilePath(const wxString& path)
        : directory(path.BeforeLast('/'), Links::Follow), name(path.AfterLast('/'))
    {
    }

    explicit ProfilePath(LPCWSTR path) : ProfilePath(wxString::FromUTF8(NativePath(path)))
    {
    }

    const PinnedDirectory directory;
    const wxString name;
};

// Returns false for a read-only file, even for root; creates a missing file.
bool OpenForWriting(LPCWSTR path, RegularFile& file)
{
    const ProfilePath profile(path);
    const DWORD attributes = GetFileAttributesW(path);
    if (attributes == INVALID_FILE_ATTRIBUTES)
        return file.CreateNew(profile.directory, profile.name) == RegularFile::Status::Open;
    return (attributes & FILE_ATTRIBUTE_READONLY) == 0 &&
           file.OpenForUpdate(profile.directory, profile.name) == RegularFile::Status::Open;
}

} // namespace

BOOL WritePrivateProfileStringW(LPCWSTR section, LPCWSTR key, LPCWSTR value, LPCWSTR path)
{
    RegularFile file;
    std::string bytes;
    if (!OpenForWriting(path, file) || !file.Read(bytes))
        return 0;
    ProfileText profile(bytes);
    std::wstring& text = profile.text;
    const ProfilePlace place = FindInProfile(text, section, key);
    const std::wstring end = value + LineEnd;
    if (place.hasKey)
    {
        // The name stays as it is spelled.
        const size_t sign = text.find(L'=', place.begin);
        const bool hasSign = sign < place.next;
        const size_t begin = hasSign ? sign + 1 : place.begin;
        text.replace(begin, place.next - begin, hasSign ? end : key + (L"=" + end));
    }
    else
    {
        const size_t at = place.hasSection ? place.begin : text.size();
        const std::wstring title =
            place.hasSection ? L"" : L"[" + std::wstring(section) + L"]" + LineEnd;
        const bool needsEnd = at > 0 && text[at - 1] != L'\n';
        text.insert(at, (needsEnd ? LineEnd : L"") + title + key + L"=" + end);
    }
    const std::string changed = profile.Bytes();
    return changed == bytes || file.Rewrite(bytes, changed) ? 1 : 0;
}

DWORD GetPrivateProfileStringW(LPCWSTR section, LPCWSTR key, LPCWSTR defaultValue, LPWSTR buffer,
                               DWORD capacity, LPCWSTR path)
{
    std::string bytes;
    std::wstring value = defaultValue;
    const ProfilePath profile(path);
    RegularFile file;
    if (file.OpenForReading(profile.directory, profile.name) == RegularFile::Status::Open &&
        file.Read(bytes))
    {
        const ProfilePlace place = FindInProfile(ProfileText(bytes).text, section, key);
        if (place.hasKey)
            value = place.value;
    }
    const size_t length = value.copy(buffer, capacity - 1);
    buffer[length] = L'\0';
    return static_cast<DWORD>(length);
}
