#include "tests/wine.h"

#include <chrono>
#include <cstdlib>
#include <future>
#include <stdexcept>

namespace fs = std::filesystem;

namespace
{

Text FromEnvironment(const char* name)
{
    const char* value = std::getenv(name);
    return value ? value : "";
}

// Presses the button of a message box if there is one; returns whether there was one.
bool PressButton()
{
    return std::system("xdotool search --onlyvisible --name '^FolderUpgrade' windowfocus key "
                       "Return >/dev/null 2>&1") == 0;
}

} // namespace

fs::path WindowsProgram()
{
    return FromEnvironment("FOLDER_UPGRADE_WINDOWS_PROGRAM");
}

bool IsWindowsProgram()
{
    return !WindowsProgram().empty();
}

Text Quoted(const Text& text)
{
    return "'" + text + "' ";
}

Wine::Wine(bool asOtherUser, const fs::path& driveH)
    : m_asOtherUser(asOtherUser), m_userName(asOtherUser ? "nobody" : "root"),
      m_prefix(FromEnvironment(asOtherUser ? "FOLDER_UPGRADE_WINE_PREFIX_OTHER"
                                           : "FOLDER_UPGRADE_WINE_PREFIX")),
      m_driveH(driveH)
{
    const fs::path link = m_prefix / "dosdevices" / "h:";
    fs::remove(link);
    fs::create_symlink(driveH, link);
}

fs::path Wine::UserDataDir() const
{
    return m_prefix / "drive_c/users" / m_userName / "AppData/Roaming";
}

fs::path Wine::MachineDataDir() const
{
    return m_prefix / "drive_c/ProgramData";
}

Text Wine::UserDataPath() const
{
    return "C:\\users\\" + m_userName + "\\AppData\\Roaming";
}

void Wine::ImportHives(const Text& machineHive, const Text& userHive) const
{
    Text text = "Windows Registry Editor Version 5.00\r\n\r\n";
    for (const char* key : {"LOCAL_MACHINE\\SOFTWARE\\Vantorix", "CURRENT_USER\\SOFTWARE\\HF",
                            "LOCAL_MACHINE\\SOFTWARE\\Wow6432Node\\Vantorix",
                            "CURRENT_USER\\SOFTWARE\\Wow6432Node\\HF"})
        text += Text("[-HKEY_") + key + "]\r\n\r\n";
    for (const Text& hive : {machineHive, userHive})
    {
        if (hive.find("\r\n") != Text::npos) // a text in any other form is not a hive
            text += hive.substr(hive.find("\r\n")) + "\r\n";
    }
    static Text imported[2]; // kept, because an import takes longer than a run
    if (imported[m_asOtherUser] == text)
        return;
    const fs::path file = m_driveH / "hives.reg";
    WriteFile(file, ToUtf16(text));
    Text boxes;
    const Text user = m_asOtherUser ? "setpriv --reuid=nobody --regid=nogroup --clear-groups " : "";
    if (Run(user + "env " + Command() + "regedit /S 'H:\\hives.reg'", file, boxes) != 0)
        throw std::runtime_error("the hives were not imported");
    imported[m_asOtherUser] = text;
    fs::remove(file);
}

Text Wine::Command() const
{
    return "WINEPREFIX=" + Quoted(m_prefix) + "HOME=" + Quoted(m_prefix) +
           "LC_ALL=C.UTF-8 USER=" + m_userName + " /usr/lib/wine/wine64 ";
}

int Wine::Run(const Text& command, const fs::path& log, Text& boxes) const
{
    auto run = std::async(std::launch::async,
                          [&] { return std::system(("exec timeout 120 " + command).c_str()); });
    // FolderUpgradeRun has to do without a person.
    const bool isPressing = command.find("FolderUpgradeRun") == Text::npos;
    Text last;
    for (int wait = 1000;
         run.wait_for(std::chrono::milliseconds(wait)) != std::future_status::ready; wait = 100)
    {
        const Text text = ReadFile(log);
        if (isPressing && PressButton() && last != text) // one box may need more than one press
            boxes += "A message box, with the run log\n" + (last = text);
    }
    return run.get();
}
