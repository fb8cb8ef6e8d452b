// The program under test as a process.
#pragma once

#include <filesystem>
#include <functional>
#include <map>
#include <string>
#include <vector>

/// The user as whom refusals are tested, since root is refused nothing.
constexpr unsigned OtherUser = 65534;

struct Process
{
    std::vector<std::string> commandLine; // the program's path first
    std::map<std::string, std::string> environment;
    bool asOtherUser;             // has an effect where this is root
    std::filesystem::path output; // where its standard output goes
    std::filesystem::path errors; // where its standard error goes; empty: to this program's own
};

struct ProcessResult
{
    int exitStatus; // as a shell reports it; the number of a signal is negative
    double seconds;
    long megabytes; // the peak, which is never below what this program held at the start
};

/// Runs the process to its end, 120 seconds at most, and calls meanwhile(seconds since the start) while it runs.
ProcessResult RunToTheEnd(const Process& process, const std::function<void(double)>& meanwhile = nullptr);
