// The Windows program under Wine, on the real registry, profile, attribute and shell functions that
// Wine provides. Two prefixes serve, root's and another user's, since Wine refuses root nothing.
#pragma once

#include "tests/process.h"

#include <filesystem>
#include <string>
#include <vector>

/// The Windows program to test, from the environment; empty when the native one is meant.
std::filesystem::path WindowsProgram();

/// One user's Wine, with drive H: on the workstation's root.
class Wine
{
  public:
    Wine(bool asOtherUser, const std::filesystem::path& driveH);

    std::filesystem::path UserDataDir() const;    // on this machine
    std::filesystem::path MachineDataDir() const; // on this machine
    std::string UserDataPath() const;             // as a Windows program sees it

    /// Makes the keys of the two hives in the registry editor's text form the only ones.
    void ImportHives(const std::string& machineHive, const std::string& userHive) const;

    /// Starts a program and presses the button of every message box. The text of the watched file
    /// while a box is there goes into boxes, once for as long as it stays the same.
    ProcessResult Start(const std::vector<std::string>& commandLine, const std::filesystem::path& output,
                        const std::filesystem::path& watched, std::vector<std::string>& boxes) const;

  private:
    std::string UserName() const;

    bool m_asOtherUser;
    std::filesystem::path m_prefix;
    std::filesystem::path m_driveH;
};
