#include "tests/wine.h"

#include "tests/text_files.h"

#include <cstdlib>
#include <fstream>
#include <iterator>
#include <stdexcept>

namespace fs = std::filesystem;

namespace
{

const char* const Loader = "/usr/lib/wine/wine64";

std::string FromEnvironment(const char* name)
{
    const char* value = std::getenv(name);
    return value ? value : "";
}

// Presses the button of a message box if there is one; returns whether there was one.
bool PressButton()
{
    return std::system(
               "xdotool search --onlyvisible --name '^FolderUpgrade' windowfocus key Return "
               ">/dev/null 2>&1") == 0;
}

// Empty while the run is replacing the file.
std::string TextIfThere(const fs::path& path)
{
    std::ifstream file(path, std::ios::binary);
    return {std::istreambuf_iterator<char>(file), {}};
}

} // namespace

fs::path WindowsProgram()
{
    return FromEnvironment("FOLDER_UPGRADE_WINDOWS_PROGRAM");
}

Wine::Wine(bool asOtherUser, const fs::path& driveH)
    : m_asOtherUser(asOtherUser),
      m_prefix(FromEnvironment(asOtherUser ? "FOLDER_UPGRADE_WINE_PREFIX_OTHER"
                                           : "FOLDER_UPGRADE_WINE_PREFIX")),
      m_driveH(driveH)
{
    const fs::path link = m_prefix / "dosdevices" / "h:";
    fs::remove(link);
    fs::create_symlink(driveH, link);
    for (const fs::path& left :
         {UserDataDir() / "ORX", UserDataDir() / "ORX_Installers", UserDataDir() / "registry",
          MachineDataDir() / "hotfolder", MachineDataDir() / "registry"})
        fs::remove_all(left);
}

std::string Wine::UserName() const
{
    return m_asOtherUser ? "nobody" : "root";
}

fs::path Wine::UserDataDir() const
{
    return m_prefix / "drive_c/users" / UserName() / "AppData/Roaming";
}

fs::path Wine::MachineDataDir() const
{
    return m_prefix / "drive_c/ProgramData";
}

std::string Wine::UserDataPath() const
{
    return std::string("C:\\users\\") + UserName() + "\\AppData\\Roaming";
}

void Wine::ImportHives(const std::string& machineHive, const std::string& userHive) const
{
    std::string text = "Windows Registry Editor Version 5.00\r\n\r\n";
    for (const char* key :
         {"HKEY_LOCAL_MACHINE\\SOFTWARE\\Vantorix",
          "HKEY_LOCAL_MACHINE\\SOFTWARE\\Wow6432Node\\Vantorix", "HKEY_CURRENT_USER\\SOFTWARE\\HF",
          "HKEY_CURRENT_USER\\SOFTWARE\\Wow6432Node\\HF"})
        text += std::string("[-") + key + "]\r\n\r\n";
    for (const std::string& hive : {machineHive, userHive})
    {
        if (hive.find("\r\n") != std::string::npos) // a text in any other form is not a hive
            text += hive.substr(hive.find("\r\n")) + "\r\n";
    }
    static std::string imported[2]; // kept, because an import takes longer than a run
    if (imported[m_asOtherUser] == text)
        return;
    WriteFile(m_driveH / "hives.reg", ToUtf16(text));
    std::vector<std::string> boxes;
    if (Start({"regedit", "/S", "H:\\hives.reg"}, "/dev/null", m_driveH / "hives.reg", boxes)
            .exitStatus != 0)
        throw std::runtime_error("the hives were not imported");
    imported[m_asOtherUser] = text;
    fs::remove(m_driveH / "hives.reg");
}

ProcessResult Wine::Start(const std::vector<std::string>& commandLine, const fs::path& output,
                          const fs::path& watched, std::vector<std::string>& boxes) const
{
    Process process = {
        {Loader},
        {{"WINEPREFIX", m_prefix}, {"HOME", m_prefix}, {"LC_ALL", "C.UTF-8"}, {"USER", UserName()}},
        m_asOtherUser,
        output,
        {}};
    process.commandLine.insert(process.commandLine.end(), commandLine.begin(), commandLine.end());
    return RunToTheEnd(process,
                       [&](double seconds)
                       {
                           if (seconds <= 1)
                               return;
                           const std::string text = TextIfThere(watched);
                           // One box may need more than one press.
                           if (PressButton() && (boxes.empty() || boxes.back() != text))
                               boxes.push_back(text);
                       });
}
