// The program under test as a process.
#pragma once

#include <filesystem>
#include <functional>
#include <map>
#include <string>
#include <vector>

/// The user for the tests of refusals, because root is refused nothing.
constexpr unsigned OtherUser = 65534;

struct Process
{
    std::vector<std::string> commandLine; // the program's path first
    std::map<std::string, std::string> environment;
    bool asOtherUser;             // has an effect only if the test runs as root
    std::filesystem::path output; // where its standard output goes
    std::filesystem::path errors; // where its standard error goes; if empty, to this program's own
};

struct ProcessResult
{
    int exitStatus; // as a shell reports it; the number of a signal is negative
    double seconds;
    long megabytes; // the peak, which is never below the test program's own memory at the start
};

/// Runs the process until it ends, for at most 120 seconds, and calls meanwhile(seconds since the
/// start) while it runs.
ProcessResult RunToTheEnd(const Process& process,
                          const std::function<void(double)>& meanwhile = nullptr);
