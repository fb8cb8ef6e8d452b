// What a workstation needs of the system on which the scenarios run; one source for each system, in
// tests/linux and tests/windows.
#pragma once

#include "tests/text_files.h"

#include <memory>
#include <vector>

#ifdef _WIN32
inline constexpr bool IsWindows = true;
inline constexpr const char* Separator = "\\";
inline constexpr const char* ProgramSuffix = ".exe";
#else
inline constexpr bool IsWindows = false;
inline constexpr const char* Separator = "/";
inline constexpr const char* ProgramSuffix = "";
#endif

struct RunResult
{
    int status;      // as a shell reports it
    Text output;     // its standard output
    Text libraryLog; // what the library reported, on Windows in message boxes
};

struct Command
{
    std::filesystem::path program;
    std::vector<Text> arguments;
    Files environment; // in addition to the test's own; not on Windows
    bool asOtherUser;  // has an effect only for root, and not on Windows
    int killAfter = 0; // milliseconds, 0 for never; only on Windows
};

/// Whether this is Windows, but not the real one.
bool IsWine();
/// The folder of the programs to test. Windows: the test's own; elsewhere $FOLDER_UPGRADE_PROGRAMS,
/// or the folder of the build.
std::filesystem::path ProgramDir();
/// A new folder for everything on a workstation but the application data.
std::filesystem::path NewRoot();
/// The application data folders. Windows: the account's and the machine's own.
std::filesystem::path UserDataDir(const std::filesystem::path& root);
std::filesystem::path MachineDataDir(const std::filesystem::path& root);

/// Windows: replaces all keys that the scenarios use with those of the hives, which are in the
/// registry editor's text form. Elsewhere the hives are files.
void SetRegistry(const std::vector<Text>& hives);

/// The program's folder has to be readable for another user.
RunResult RunToEnd(const Command& command, const std::filesystem::path& root,
                   const std::filesystem::path& log);

bool IsSymbolicLink(const std::filesystem::path& path);
/// A link to a directory if there is one at the target.
void MakeLink(const std::filesystem::path& target, const std::filesystem::path& link);
void MakeFifo(const std::filesystem::path& path);
/// Removes links, not their targets.
void RemoveTree(const std::filesystem::path& path);
/// Makes everything in the folders another user's. Not on Windows.
void GiveAway(const std::vector<std::filesystem::path>& folders);
/// X: it cannot be written to; 0: a directory, not on Windows also a file, cannot be accessed; L: a
/// directory cannot be listed. Under Wine, X and 0 are what the owner's permissions refuse.
void Refuse(const std::filesystem::path& path, char letter);
/// As of a program that has a file open and lets nobody else open it, until the result is
/// destroyed; only on Windows.
std::shared_ptr<void> UseAlone(const std::filesystem::path& path);
