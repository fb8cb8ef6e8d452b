// What a workstation needs of the system on which the scenarios run; one source for each system, in
// tests/linux and tests/windows.
#pragma once

#include "tests/text_files.h"

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
/// registry editor's text form, but without escapes. Elsewhere the hives are files.
void SetRegistry(const std::vector<Text>& hives);

/// A link to a directory if there is one at the target.
void MakeLink(const std::filesystem::path& target, const std::filesystem::path& link);
/// Removes links, not their targets.
void RemoveTree(const std::filesystem::path& path);
/// Makes everything in the folder another user's. Not on Windows.
void GiveAway(const std::filesystem::path& folder);
/// X: it cannot be written to; 0: it cannot be accessed, a file on Windows because a program has it
/// open alone; L: a directory cannot be listed. Under Wine, X and L are what the owner's
/// permissions refuse. Until the next RemoveTree.
void Refuse(const std::filesystem::path& path, char letter);
