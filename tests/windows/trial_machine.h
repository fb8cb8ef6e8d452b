// The machine on which the scenarios run, where nothing can be lost.
#pragma once

#include <filesystem>
#include <string>

/// The folder for everything but the application data. It is there only during a trial, or after
/// one that was interrupted.
std::filesystem::path TrialDir();
/// A value of each of the registry's keys that the tool uses and a trial has made.
inline const std::string Mark = "FolderUpgrade trial";
/// Removes these keys, and throws if others are there.
void RemoveKeys();
/// Undoes what Refuse does to anything in a folder that is left from an interrupted trial.
void AllowAll(const std::filesystem::path& folder);
