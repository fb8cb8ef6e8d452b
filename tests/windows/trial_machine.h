// The machine on which the scenarios run, where nothing can be lost.
#pragma once

#include <filesystem>

/// The folder for everything but the application data. It is there only during a trial, or after
/// one that was interrupted.
std::filesystem::path TrialDir();
/// Removes the registry's keys that a trial has made.
void RemoveKeys();
/// Undoes what Refuse does to anything in a folder that is left from an interrupted trial.
void AllowAll(const std::filesystem::path& folder);
