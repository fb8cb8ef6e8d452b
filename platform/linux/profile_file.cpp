// Profile files (.ini): one key is read or changed; every other byte of the file stays. Sections,
// keys and values have to be ASCII.
#include "platform/linux/native_path.h"
#include "platform/linux/profile_text.h"
#include "platform/regular_file.h"
#include "platform/system.h"

namespace
{

const char* const LineEnd = "\r\n";

// For writing, refuses a read-only file, even to root, and creates a missing one.
bool Open(LPCWSTR path, bool forWriting, RegularFile& file)
{
    const wxString native = NativePath(path);
    const PinnedDirectory directory(native.BeforeLast('/'), Links::Follow);
    const wxString name = native.AfterLast('/');
    const DWORD attributes = forWriting ? GetFileAttributesW(path) : 0;
    RegularFile::Status status = RegularFile::Status::Refused;
    if (!forWriting)
        status = file.OpenForReading(directory, name);
    else if (attributes == INVALID_FILE_ATTRIBUTES)
        status = file.CreateNew(directory, name);
    else if ((attributes & FILE_ATTRIBUTE_READONLY) == 0)
        status = file.OpenForUpdate(directory, name);
    return status == RegularFile::Status::Open;
}

} // namespace

BOOL WritePrivateProfileStringW(LPCWSTR section, LPCWSTR key, LPCWSTR value, LPCWSTR path)
{
    RegularFile file;
    std::string bytes;
    if (!Open(path, true, file) || !file.Read(bytes))
        return 0;
    ProfileText profile(bytes);
    wxString& text = profile.text;
    const ProfilePlace place = FindInProfile(text, section, key);
    const wxString setting = wxString(key) + "=" + value + LineEnd;
    if (place.hasKey)
    {
        // The name stays as it is spelled.
        const size_t sign = text.find('=', place.begin);
        const bool hasSign = sign < place.next;
        const size_t begin = hasSign ? sign + 1 : place.begin;
        text.replace(begin, place.next - begin, hasSign ? setting.AfterFirst('=') : setting);
    }
    else
    {
        const size_t at = place.hasSection ? place.begin : text.length();
        const wxString title =
            place.hasSection ? wxString() : "[" + wxString(section) + "]" + LineEnd;
        const bool needsEnd = at > 0 && text[at - 1] != '\n';
        text.insert(at, (needsEnd ? LineEnd : "") + title + setting);
    }
    const std::string changed = profile.Bytes();
    return changed == bytes || file.Rewrite(bytes, changed) ? 1 : 0;
}

DWORD GetPrivateProfileStringW(LPCWSTR section, LPCWSTR key, LPCWSTR defaultValue, LPWSTR buffer,
                               DWORD capacity, LPCWSTR path)
{
    RegularFile file;
    std::string bytes;
    ProfilePlace place;
    if (Open(path, false, file) && file.Read(bytes))
        place = FindInProfile(ProfileText(bytes).text, section, key);
    const std::wstring value = place.hasKey ? place.value.ToStdWstring() : defaultValue;
    const size_t length = value.copy(buffer, capacity - 1);
    buffer[length] = L'\0';
    return static_cast<DWORD>(length);
}
