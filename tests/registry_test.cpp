// The forms of the registry editor's text that no workstation of the scenarios has.
#include "platform/system.h"
#include "platform/unicode_text.h"

#include <gtest/gtest.h>
#include <wx/ffile.h>
#include <wx/filename.h>

#include <array>

TEST(Registry, EveryFormOfAValueIsRead)
{
    const wxString folder = wxFileName::CreateTempFileName("hive");
    wxRemoveFile(folder);
    wxFileName::Mkdir(folder + "/registry", wxS_DIR_DEFAULT, wxPATH_MKDIR_FULL);
    setenv("XDG_CONFIG_HOME", folder.utf8_str(), 1);
    struct Form
    {
        const char* text;     // behind the key's line
        const wchar_t* value; // none: not there
        DWORD size;           // bytes
    };
    const wchar_t* const none = nullptr;
    for (const Form& form :
         {Form{"\"v\"=\"C:\\\\a \\\"b\\\"\"", L"C:\\a \"b\"", 18}, Form{" \"V\" = \"x\" ", L"x", 4}, Form{"@=\"x\"\n\"v\"=\"y\"", L"y", 4},
          Form{"\"v\"=hex(2):78,00,\\\n  79,00", L"xy", 6}, Form{"\"v\"=hex:78, 00", L"x", 2}, Form{"\"v\"=hex(1):78,00,79", L"x", 3},
          Form{"\"v\"=dword:00000078", L"x", 4}, Form{"\"v\"=\"x\"\n\"v\"=-", none, 0}, Form{"\"v\"=\"x\"\n\"v\"=\"y\"", L"y", 4},
          Form{"\"v\"=\"x\"\n[-HKEY_CURRENT_USER\\K]\n[HKEY_CURRENT_USER\\k]", none, 0}, Form{";\"v\"=\"x\"", none, 0},
          Form{"\"v\"=hex:7x\n\"v\"=hex(g):78\n\"v\"=dword:g\n\"v\"x\n\"v", none, 0}, Form{"\"v\"=\"\U0001F600\"", L"\U0001F600", 6},
          Form{"\"v\"=hex:3d,d8,00,de", L"\U0001F600", 4}})
    {
        wxFFile(folder + "/registry/HKEY_CURRENT_USER.reg", "wb")
            .Write("Windows Registry Editor Version 5.00\n\n[HKEY_CURRENT_USER\\K]\n" + wxString(form.text));
        HKEY key = nullptr;
        ASSERT_EQ(ERROR_SUCCESS, RegOpenKeyExW(HKEY_CURRENT_USER, L"k", 0, KEY_READ, &key)) << form.text;
        std::array<BYTE, 64> data{};
        DWORD type = 0;
        DWORD size = data.size();
        const LSTATUS status = RegQueryValueExW(key, L"v", nullptr, &type, data.data(), &size);
        EXPECT_EQ(form.value == none ? ERROR_FILE_NOT_FOUND : ERROR_SUCCESS, status) << form.text;
        if (form.value != none)
        {
            EXPECT_EQ(form.size, size) << form.text;
            EXPECT_EQ(wxString(form.value), FromUtf16Bytes(data.data(), size)) << form.text;
        }
        RegCloseKey(key);
    }
    wxFileName::Rmdir(folder, wxPATH_RMDIR_RECURSIVE);
}
