// The Windows program under Wine, with Wine's registry, profile, attribute and shell functions.
// There are two prefixes, root's and another user's, because root is refused nothing.
#pragma once

#include "tests/text_files.h"

/// The folder of the programs to test: $FOLDER_UPGRADE_PROGRAMS, else the one of this build.
std::filesystem::path ProgramDir();
bool IsWindowsProgram();
/// The text as one word for a shell.
Text Quoted(const Text& text);

/// One user's Wine prefix, whose drive H: is the workstation's root.
class Wine
{
  public:
    Wine(bool asOtherUser, const std::filesystem::path& driveH);

    std::filesystem::path UserDataDir() const;    // on this machine
    std::filesystem::path MachineDataDir() const; // on this machine
    Text UserDataPath() const;                    // as a Windows program sees it

    /// Replaces all keys with those of the two hives, which are in the registry editor's text form.
    void ImportHives(const Text& machineHive, const Text& userHive) const;

    /// What a shell command that starts a program begins with.
    Text Command() const;
    /// Runs a shell command, which gives its status, and presses the button of every message box.
    /// While a box is open, appends the text of the log to boxes whenever it has changed.
    int Run(const Text& command, const std::filesystem::path& log, Text& boxes) const;

  private:
    bool m_asOtherUser;
    Text m_userName;
    std::filesystem::path m_prefix;
    std::filesystem::path m_driveH;
};
