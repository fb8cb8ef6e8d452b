// The Windows program under Wine, with Wine's registry, profile, attribute and shell functions.
// There are two prefixes, root's and another user's, because root is refused nothing.
#pragma once

#include "tests/process.h"

#include <filesystem>
#include <string>
#include <vector>

/// The Windows program to test, from the environment; empty to test the native one.
std::filesystem::path WindowsProgram();

/// One user's Wine prefix, whose drive H: is the workstation's root.
class Wine
{
  public:
    Wine(bool asOtherUser, const std::filesystem::path& driveH);

    std::filesystem::path UserDataDir() const;    // on this machine
    std::filesystem::path MachineDataDir() const; // on this machine
    std::string UserDataPath() const;             // as a Windows program sees it

    /// Replaces all keys with those of the two hives, which are in the registry editor's text form.
    void ImportHives(const std::string& machineHive, const std::string& userHive) const;

    /// Starts a program and presses the button of every message box. While a box is open, appends
    /// the text of the watched file to boxes whenever it has changed.
    ProcessResult Start(const std::vector<std::string>& commandLine,
                        const std::filesystem::path& output, const std::filesystem::path& watched,
                        std::vector<std::string>& boxes) const;

  private:
    std::string UserName() const;

    bool m_asOtherUser;
    std::filesystem::path m_prefix;
    std::filesystem::path m_driveH;
};
