// What FolderUpgradeCheck said.
#pragma once

#include "tests/workstation.h"

#include <set>
#include <string>

struct CheckReport
{
    CheckReport(const Workstation& workstation, const RunResult& run);

    std::set<std::string> changes; // places; attributes as the place with '#', those of an icon as the icon
    int problems = 0;
    std::string text;
};

/// The places that differ, as a report names them. In a Desktop.ini sections, keys and values count.
std::set<std::string> ChangedPlaces(const Files& before, const Files& after);

/// The sections, keys and values of a profile file, which Wine rewrites whole; it also adds a key of
/// its own to Desktop.ini.
std::string ProfileMeaning(const std::string& profile);
