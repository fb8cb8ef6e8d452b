#include "tests/wine.h"

#include "tests/process.h"
#include "tests/text_files.h"

#include <chrono>
#include <cstdlib>
#include <stdexcept>
#include <sys/wait.h>
#include <thread>
#include <unistd.h>

namespace fs = std::filesystem;

namespace
{

const char* const Loader = "/usr/lib/wine/wine64";

std::string FromEnvironment(const char* name)
{
    const char* value = std::getenv(name);
    return value ? value : "";
}

// Presses the button of a message box if there is one; what xdotool found to press is the answer.
bool PressButton()
{
    return std::system("xdotool search --onlyvisible --name '^FolderUpgrade' windowfocus key Return "
                       ">/dev/null 2>&1") == 0;
}

} // namespace

fs::path WindowsProgram()
{
    return FromEnvironment("FOLDER_UPGRADE_WINDOWS_PROGRAM");
}

Wine::Wine(bool asOtherUser, const fs::path& driveH)
    : m_asOtherUser(asOtherUser),
      m_prefix(FromEnvironment(asOtherUser ? "FOLDER_UPGRADE_WINE_PREFIX_OTHER" : "FOLDER_UPGRADE_WINE_PREFIX")), m_driveH(driveH)
{
    const fs::path link = m_prefix / "dosdevices" / "h:";
    fs::remove(link);
    fs::create_symlink(driveH, link);
    for (const fs::path& left : {UserDataDir() / "ORX", UserDataDir() / "ORX_Installers", UserDataDir() / "registry",
                                 MachineDataDir() / "hotfolder", MachineDataDir() / "registry"})
        fs::remove_all(left);
}

fs::path Wine::UserDataDir() const
{
    return m_prefix / "drive_c/users" / (m_asOtherUser ? "nobody" : "root") / "AppData/Roaming";
}

fs::path Wine::MachineDataDir() const
{
    return m_prefix / "drive_c/ProgramData";
}

std::string Wine::UserDataPath() const
{
    return std::string("C:\\users\\") + (m_asOtherUser ? "nobody" : "root") + "\\AppData\\Roaming";
}

void Wine::ImportHives(const std::string& machineHive, const std::string& userHive) const
{
    std::string text = "Windows Registry Editor Version 5.00\r\n\r\n";
    for (const char* key : {"HKEY_LOCAL_MACHINE\\SOFTWARE\\Vantorix", "HKEY_LOCAL_MACHINE\\SOFTWARE\\Wow6432Node\\Vantorix",
                            "HKEY_CURRENT_USER\\SOFTWARE\\HF", "HKEY_CURRENT_USER\\SOFTWARE\\Wow6432Node\\HF"})
        text += std::string("[-") + key + "]\r\n\r\n";
    for (const std::string& hive : {machineHive, userHive})
    {
        if (hive.find("\r\n") != std::string::npos) // what is not of the form is no hive
            text += hive.substr(hive.find("\r\n")) + "\r\n";
    }
    static std::string imported[2]; // an import takes longer than a run
    if (imported[m_asOtherUser] == text)
        return;
    WriteFile(m_driveH / "hives.reg", ToUtf16(text));
    std::vector<std::string> boxes;
    if (Start({"regedit", "/S", "H:\\hives.reg"}, m_driveH / "hives.reg", boxes) != 0)
        throw std::runtime_error("the hives were not imported");
    imported[m_asOtherUser] = text;
    fs::remove(m_driveH / "hives.reg");
}

int Wine::Start(const std::vector<std::string>& commandLine, const fs::path& watched, std::vector<std::string>& boxes) const
{
    const pid_t child = fork();
    if (child == 0)
    {
        setenv("WINEPREFIX", m_prefix.c_str(), 1);
        setenv("HOME", m_prefix.c_str(), 1);
        setenv("LC_ALL", "C.UTF-8", 1);
        setenv("USER", m_asOtherUser ? "nobody" : "root", 1);
        std::vector<std::string> arguments = {Loader};
        arguments.insert(arguments.end(), commandLine.begin(), commandLine.end());
        Become(arguments, m_asOtherUser);
    }
    int status = 0;
    const auto start = std::chrono::steady_clock::now();
    const auto elapsed = [&]()
    {
        return std::chrono::steady_clock::now() - start;
    };
    while (waitpid(child, &status, WNOHANG) == 0)
    {
        std::this_thread::sleep_for(std::chrono::milliseconds(elapsed() < std::chrono::seconds(1) ? 10 : 100));
        if (elapsed() > std::chrono::seconds(1))
        {
            const std::string text = ReadFile(watched);
            // One box may have to be pressed more than once.
            if (PressButton() && (boxes.empty() || boxes.back() != text))
                boxes.push_back(text);
        }
    }
    return WIFEXITED(status) ? WEXITSTATUS(status) : -WTERMSIG(status);
}
