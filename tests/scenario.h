// The table of end-to-end scenarios: a workstation before, the arguments, the workstation after.
#pragma once

#include "tests/workstation.h"

#include <string>
#include <vector>

struct Scenario
{
    std::string name; // what should happen
    Files before;
    std::vector<std::string> arguments;
    Files after;                        // what changes; every other file and attribute stays
    std::string log;                    // the whole run log, with LF for CR LF; OldLog for one left alone
    bool libraryLogs = false;           // the library itself reports an error, on Windows in a message box
    bool asOtherUser = false;           // what is tested would not stop root
    const char* notUnderWine = nullptr; // why the row cannot hold there
};

/// Stands for the log of an earlier run, which every workstation has.
extern const std::string OldLog;

std::vector<Scenario> Scenarios();
