// A hot folder's Desktop.ini, in which Explorer looks for the folder's icon and info tip.
#pragma once

#include "appearance/attribute_change.h"
#include "store/hot_folder.h"

#include <vector>

constexpr const wchar_t* DesktopIniName = L"Desktop.ini";

struct DesktopIniKey
{
    const wchar_t* key;
    wxString value;
};

/// What becomes of a hot folder's Desktop.ini, its attributes and those of the folder.
struct DesktopIniChange
{
    enum class Kind
    {
        Nothing,     // the shell takes no settings from it
        Stays,       // for reasonToStay
        NotAFile,    // stays as it is, apart from its attributes
        NotReadable, // the same
        Create,
        Refresh
    };

    Kind kind = Kind::Nothing;
    const wchar_t* reasonToStay = nullptr;
    FailedCall failure;        // if it is not readable
    bool isCustomised = false; // whether the shell takes settings from it; before 4.72 it does not
    std::vector<DesktopIniKey> keys; // to be written, in this order
    AttributeChange ini;
    AttributeChange folder;
};

/// Of an existing file, only the keys whose value differs are written.
DesktopIniChange DecideDesktopIni(const HotFolder& folder, const wxString& iconName);

/// Sets one key and returns the success flag of WritePrivateProfileStringW, which changes no other
/// key and creates a missing file.
bool WriteIniString(const wxString& section, const wxString& key, const wxString& value,
                    const wxString& path);

/// Creates a Desktop.ini with these keys, unless anything of that name exists. Returns false if the
/// hot folder is not a directory; failed writes are not reported.
bool CreateDesktopIni(const HotFolder& folder, const std::vector<DesktopIniKey>& keys);

/// Removes read-only and system from a Desktop.ini, writes the keys and has the shell force the
/// folder's icon with SHGetSetFolderCustomSettings, which is given the hot folder's path. All other
/// keys stay; no attribute does. Returns the same as above.
bool RefreshDesktopIni(const HotFolder& folder, const std::vector<DesktopIniKey>& keys);
