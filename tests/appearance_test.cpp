// Calls to the shell, which leave no trace on the workstation, and the bytes of profile files.
#include "appearance/folder_icon.h"
#include "tests/recording_shell.h"
#include "tests/text_files.h"

#include <gtest/gtest.h>
#include <wx/ffile.h>
#include <wx/filename.h>

namespace
{

class Appearance : public testing::Test
{
  protected:
    Appearance() : m_folder(wxFileName::CreateTempFileName("hot folder ü"))
    {
        wxRemoveFile(m_folder);
        wxMkdir(m_folder);
        ShellCalls.clear();
        ShellMajorVersion = 6;
        ShellVersionResult = 0;
    }

    ~Appearance() override
    {
        wxFileName::Rmdir(m_folder, wxPATH_RMDIR_RECURSIVE);
    }

    wxString Ini() const
    {
        return m_folder + "/Desktop.ini";
    }

    void WriteIni(const wxString& text) const
    {
        wxFFile(Ini(), "wb").Write(text);
    }

    wxString Text() const
    {
        return wxString::FromUTF8(ReadFile(Ini().utf8_string()));
    }

    static std::vector<std::string> Version()
    {
        return {"load shell32.dll", "find DllGetVersion", "free"};
    }

    std::vector<std::string> Calls(bool isForced, const std::string& iconFile) const
    {
        const std::string folder = m_folder.utf8_string();
        const std::string ini = folder + "/Desktop.ini";
        std::vector<std::string> calls = Version();
        if (isForced)
            calls.push_back("force " + folder + " 10 " + iconFile + " 0 0 2");
        for (const std::string& call : {"notify 800 1005 " + ini, "info " + ini + " 0 1 4000",
                                        std::string("notify 8000 1003 -7"), "notify 8 1005 " + ini,
                                        std::string("notify 8000000 1000 0")})
            calls.push_back(call);
        return calls;
    }

    const wxString m_folder;
};

TEST_F(Appearance, ANewDesktopIniIsAnnouncedButNotForced)
{
    EXPECT_TRUE(ApplyFolderIcon(m_folder, "i.ico"));
    EXPECT_EQ(Calls(false, ""), ShellCalls);
}

TEST_F(Appearance, AnExistingIniIsForcedWithTheValueRead)
{
    const wxString name = wxString('n', 300) + ".ico";
    WriteIni("");
    EXPECT_TRUE(ApplyFolderIcon(m_folder, name));
    EXPECT_EQ(Calls(true, (".\\[_ORX_HotFolder_]\\" + name).Left(199).utf8_string()), ShellCalls);
}

TEST_F(Appearance, WithAnOldOrUnknownShellOnlyAttributesChange)
{
    const auto isCustomised = [&](DWORD major, DWORD minor, HRESULT result = 0)
    {
        WriteIni("");
        ShellMajorVersion = major;
        ShellMinorVersion = minor;
        ShellVersionResult = result;
        ShellCalls.clear();
        EXPECT_TRUE(ApplyFolderIcon(m_folder, "i.ico"));
        EXPECT_EQ(ShellCalls == Version(), Text().empty()) << major << "." << minor;
        EXPECT_EQ(FILE_ATTRIBUTE_READONLY | FILE_ATTRIBUTE_SYSTEM,
                  GetFileAttributesW(Ini().wc_str()))
            << major << "." << minor;
        wxRemoveFile(Ini());
        return ShellCalls != Version();
    };
    EXPECT_TRUE(isCustomised(4, 72));
    EXPECT_FALSE(isCustomised(4, 71));
    EXPECT_TRUE(isCustomised(0x8004, 72));
    EXPECT_FALSE(isCustomised(0x10004, 71));
    EXPECT_FALSE(isCustomised(6, 0, -1));
    EXPECT_FALSE(ApplyFolderIcon(m_folder + "/missing", "i.ico"));
}

TEST_F(Appearance, APathBeyondTheShellsBuffersIsNotForced)
{
    for (const size_t length : {size_t{MAX_PATH} - 1, size_t{MAX_PATH}})
    {
        const wxString folder = m_folder + "/" + wxString('d', length - m_folder.length() - 1);
        wxMkdir(folder);
        wxFFile(folder + "/Desktop.ini", "wb");
        ShellCalls.clear();
        EXPECT_TRUE(ApplyFolderIcon(folder, "i.ico"));
        EXPECT_EQ(Calls(length < MAX_PATH, "").size(), ShellCalls.size()) << length;
    }
}

TEST_F(Appearance, AProfileWriteChangesOneLine)
{
    struct Change
    {
        wxString before;
        wxString after;
    };
    for (const Change& change :
         {Change{"[s]\nK = a\nk=b", "[s]\nK =v\r\nk=b"},
          Change{"k=a\n[ S ]\n[s] ; c\nk", "k=a\n[ S ]\n[s] ; c\nk=v\r\n"},
          Change{"[s]\n;k=a\n\n\n[t]\nk=a", "[s]\n;k=a\nk=v\r\n\n\n[t]\nk=a"},
          Change{"[s]\nx", "[s]\nx\r\nk=v\r\n"}, Change{"[s\nk=a", "[s\nk=a\r\n[s]\r\nk=v\r\n"},
          Change{"[s]\r\nk=v\r\n", "[s]\r\nk=v\r\n"},
          Change{wxString::FromUTF8("ü\xEF\xBB\xBF[s]\nk=ä"),
                 wxString::FromUTF8("ü\xEF\xBB\xBF[s]\nk=ä\r\n[s]\r\nk=v\r\n")}})
    {
        WriteIni(change.before);
        EXPECT_NE(0, WritePrivateProfileStringW(L"s", L"k", L"v", Ini().wc_str()));
        EXPECT_EQ(change.after, Text());
        wchar_t value[8] = {};
        EXPECT_EQ(1U, GetPrivateProfileStringW(L"S", L"K", L"default", value, 8, Ini().wc_str()));
        EXPECT_EQ(wxString("v"), value);
    }
    wchar_t cut[4] = {};
    WriteIni("[s]\n k = \tv w \n");
    EXPECT_EQ(3U, GetPrivateProfileStringW(L"s", L"k", L"", cut, 4, Ini().wc_str()));
    EXPECT_EQ(wxString("v w"), cut);
    SetFileAttributesW(Ini().wc_str(), FILE_ATTRIBUTE_READONLY);
    EXPECT_EQ(0, WritePrivateProfileStringW(L"s", L"k", L"other", Ini().wc_str()));
    EXPECT_EQ(3U, GetPrivateProfileStringW(L"none", L"k", L"default", cut, 4, Ini().wc_str()));
    EXPECT_EQ(wxString("def"), cut);
}

} // namespace
