// A throw-away workstation on which a scenario starts the real executable.
//
// A scenario uses places on the workstation, not paths:
//   hot/NAME/...    the hot folder of that name, [P] is its private directory
//   user/...        the per-user application data folder; machine/... the machine-wide one
//   tool/...        the folder of the executable
//   default/...     the template folder of this version; previous/... that of the previous one
//   elsewhere/...   files that the tool has no reason to touch, for example targets of links
// A place that ends in a slash is a directory. One that ends in '#' has the attributes of the file
// or directory before it, as letters: R read-only, H hidden, S system, N not indexed; and, for
// another user than root, X not writable, 0 in use or not accessible at all, L a directory that
// cannot be listed
// ("hot/A/Desktop.ini#" -> "RS").
//
// In texts, {hot}, {user}, {machine}, {tool}, {app}, {previous} and {default} are replaced with
// paths and {/} with the path separator. A whole text can also be
//   {utf16}TEXT     the text in UTF-16 with a byte-order mark
//   {icon:NAME}     the bytes of a shipped icon
//   {link:PLACE}    a symbolic link to another place; to a directory if its own place ends in a
//                   slash
//   {fifo}          a FIFO; not on Windows
#pragma once

#include "tests/text_files.h"

#include <vector>

inline constexpr bool IsWindows = fs::path::preferred_separator == '\\';
inline constexpr const char* Separator = IsWindows ? "\\" : "/";
inline constexpr const char* ProgramSuffix = IsWindows ? ".exe" : "";

struct RunResult
{
    int status;      // as a shell reports it
    Text output;     // its standard output
    Text libraryLog; // what the library reported, on Windows in message boxes
};

inline const Text LogPlace = "user/ORX_Installers/UpgradeDowngrade.log";
inline const Text MachineHive = "machine/registry/HKEY_LOCAL_MACHINE.reg";
inline const Text UserHive = "user/registry/HKEY_CURRENT_USER.reg";

class Workstation
{
  public:
    /// For tests of refusals, everything belongs to a user who is not root, and runs as that user.
    /// On Windows, the test itself has to be run by such a user.
    explicit Workstation(bool asOtherUser = false);
    ~Workstation();
    Workstation(const Workstation&) = delete;

    /// Makes the files, and removes those of an earlier call.
    void LayOut(const Files& files);
    /// Runs a program in the tool's folder until it ends, with limits of time and memory. The
    /// variables are set only on Linux; only on Windows it is killed after so many ms, unless 0.
    RunResult Start(const Text& program, const std::vector<Text>& arguments,
                    const Files& variables = {}, int killAfter = 0) const;
    /// Every file but the programs with its text, every link, every directory and every attribute
    /// that is set. Links are not followed.
    Files Snapshot() const;
    /// The text with everything in braces replaced, except for a link or a FIFO.
    Text Expand(Text text) const;
    fs::path HostPath(const Text& place) const;

  private:
    void Put(const Text& place, const Text& text) const;
    void SetAttributes(const Text& place, const Text& letters) const;

    bool m_asOtherUser;
    fs::path m_root;
    std::map<Text, fs::path> m_dirs; // first part of a place -> directory
};

// What a workstation needs of the system; one source for each, in tests/linux and tests/windows.

bool IsWine();         // Windows, but not the real one
fs::path ProgramDir(); // Windows: the test's own; else $FOLDER_UPGRADE_PROGRAMS, or the build's
fs::path NewRoot();    // a new folder for everything on a workstation but the application data
/// The application data folder "user" or "machine". Windows: the account's or the machine's own.
fs::path DataDir(const Text& name, const fs::path& root);
void GiveAway(const fs::path& folder); // makes everything another user's; not on Windows
void RemoveTree(const fs::path& path); // links, but not their targets
/// A link to a directory if there is one at the target.
void MakeLink(const fs::path& target, const fs::path& link);
/// X: it cannot be written to; 0: it cannot be accessed, a file on Windows because a program has it
/// open alone; L: a directory cannot be listed. Under Wine, X and L are what the owner's
/// permissions refuse. Until the next RemoveTree.
void Refuse(const fs::path& path, char letter);

// The rest on Windows only.

/// Replaces the last call's keys with those of the hives, whose text has no escapes.
void SetRegistry(const Text& hives);
fs::path TrialDir();                   // only an administrator can write there
void RemoveKeys();                     // those of the last SetRegistry, also of another process
void AllowAll(const fs::path& folder); // undoes what Refuse has done there
