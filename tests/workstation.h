// A throw-away workstation on which a scenario starts the real executable.
//
// A scenario speaks of places on the workstation, not of paths:
//   hot/NAME/...    the hot folder of that name, [P] standing for its private directory
//   user/...        the per-user application data folder; machine/... the machine-wide one
//   tool/...        the folder of the executable
// and its texts hold what differs between systems as {hot}, {user}, {tool}, {app}, {previous},
// {default} (each as the tool sees it) and {/}, the path separator; in capitals, {HOT} or {/2}, as
// the registry editor's text has them. A text that begins with {utf16} is one in that encoding.
// A place that ends in a slash is a directory; one that ends in '#' stands for the attributes of
// the file or directory before it: R read-only, H hidden, S system, X another user's, 0 no permission at all.
#pragma once

#include <filesystem>
#include <map>
#include <memory>
#include <string>
#include <vector>

using Files = std::map<std::string, std::string>; // place -> text

struct RunResult
{
    int exitStatus = 0;     // as a shell sees it
    std::string libraryLog; // what the library reported by itself, on Windows in message boxes
};

class Wine;

extern const char* const LogPlace;
extern const char* const MachineHive;
extern const char* const UserHive;

class Workstation
{
  public:
    /// With refusals in view, everything belongs to a user who is not root, and so does the run.
    explicit Workstation(bool asOtherUser);
    ~Workstation();
    Workstation(const Workstation&) = delete;
    Workstation& operator=(const Workstation&) = delete;

    void LayOut(const Files& files);
    RunResult Start(const std::vector<std::string>& arguments);
    /// Every file with its text, every directory and every attribute that is set.
    Files Snapshot() const;
    /// The text with everything in braces replaced; {icon:NAME} by the bytes of a shipped icon.
    std::string Expand(std::string text) const;

  private:
    std::filesystem::path HostPath(const std::string& place) const;
    void SetAttributes(const std::string& place, const std::string& letters) const;

    template <typename Visit>
    void ForEachEntry(Visit visit) const;

    bool m_asOtherUser;
    std::unique_ptr<Wine> m_wine;
    std::filesystem::path m_root;
    std::map<std::string, std::filesystem::path> m_hostDirs; // first part of a place -> directory
    Files m_tokens;
};

/// Whether the executable under test is the Windows program.
bool IsWindowsProgram();
