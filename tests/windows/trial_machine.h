// The machine on which the scenarios run: what must not be there before, and is removed afterwards.
#pragma once

#include <filesystem>
#include <string>
#include <vector>

/// The folder for everything but the application data. It is there only during a trial, or after
/// one that was interrupted.
std::filesystem::path TrialDir();

/// Keys of the registry and folders of application data that the tool uses, and that exist.
std::vector<std::string> FindInstallation();

/// Removes the keys of the registry that FindInstallation looks for.
void RemoveKeys();
/// Removes all that FindInstallation looks for, and the folder of the trial.
void RemoveTrial();
