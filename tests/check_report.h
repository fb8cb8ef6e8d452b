// The report of FolderUpgradeCheck, parsed.
#pragma once

#include "tests/workstation.h"

#include <set>
#include <string>

struct CheckReport
{
    CheckReport(const Workstation& workstation, const RunResult& run);

    std::set<std::string> changes; // places; attributes are the place with '#', except that those
                                   // of an icon count as the icon
    int problems = 0;
    std::string text;
};

/// The places that differ, as a report names them. In a Desktop.ini only sections, keys and values
/// are compared.
std::set<std::string> ChangedPlaces(const Files& before, const Files& after);

/// The sections, keys and values of a profile file. Wine rewrites the whole file, and adds its own
/// key to Desktop.ini.
std::string ProfileMeaning(const std::string& profile);
