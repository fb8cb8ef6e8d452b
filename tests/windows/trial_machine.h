// The machine on which the scenarios run, where nothing can be lost.
#pragma once

#include <filesystem>

/// The folder for everything but the application data. It is there only during a trial, or after
/// one that was interrupted.
std::filesystem::path TrialDir();
/// Removes all keys of the registry that the tool uses.
void RemoveKeys();
