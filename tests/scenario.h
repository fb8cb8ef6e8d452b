// The end-to-end scenarios: a workstation before, the command line, the workstation after.
//
//     Scenario("ADowngradeMovesTheTemplateBack").FolderCfg(Written(MovedTo), Written(MovedFrom)).Run({"U"}).LogOfA(Found(MovedTo))
//
// What a scenario does not mention has its usual value. In tests/scenarios/ there is one file for each
// subject, and texts.h with the files and log lines that they are made of.
#pragma once

#include "tests/workstation.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

/// In Before: the usual file is not there.
extern const char* const Removed;

/// What should happen, and where the scenario is in the source, which comes along with the literal.
struct Name
{
    template <typename Text>
    Name(const Text& text, const char* textFile = __builtin_FILE(), int textLine = __builtin_LINE())
        : what(text), file(textFile), line(textLine)
    {
    }

    std::string what;
    const char* file;
    int line;
};

struct Scenario
{
    explicit Scenario(const Name& itsName) : name(itsName)
    {
    }

    /// Files beside the usual ones, or in their place. The usual ones are the log of an earlier run, a
    /// hive for each of the two template folders, a directory for presets without any, and
    /// HotFolderList.cfg, which lists every NAME of the places hot/NAME/... in their order.
    Scenario& Before(const Files& files);
    /// The Folder.cfg of the hot folder A, and what it becomes; the same, if that is not given.
    Scenario& FolderCfg(const std::string& text);
    Scenario& FolderCfg(const std::string& text, const std::string& after);
    /// The same for presets.xml of the one directory with presets.
    Scenario& Preset(const std::string& text);
    Scenario& Preset(const std::string& text, const std::string& after);
    /// For refusals, which would not stop root.
    Scenario& AsOtherUser();

    /// The arguments of the command line; {"I"}, if not given.
    Scenario& Run(const std::vector<std::string>& arguments);

    /// Files that change. Every other file and attribute has to stay as it is.
    Scenario& After(const Files& files);
    /// The whole log, with LF for CR LF; if no log is given, that of the earlier run stays.
    Scenario& WholeLog(const std::string& text);
    /// The log of a run with these lines about the hot folders and the presets.
    Scenario& Log(const std::string& folders, const std::string& presets = "");
    /// The same, where A is the only hot folder, has no icon to replace, and these lines about its template.
    Scenario& LogOfA(const std::string& impose, const std::string& presets = "");
    Scenario& LogOfDisabledA(const std::string& impose, const std::string& presets = "");
    /// The same, where there are no hot folders and one preset, with this line.
    Scenario& LogOfPreset(const std::string& line);
    /// The library itself reports an error, on Windows in a message box.
    Scenario& LibraryReports();
    /// Limits of the run; that on memory is for this machine only, and neither is for a build with sanitizers.
    Scenario& Within(double seconds, long megabytes);
    /// Why it cannot hold there.
    Scenario& NotUnderWine(const char* reason);

    Name name;
    Files before;
    std::vector<std::string> arguments = {"I"};
    Files after;
    std::string log; // empty for that of the earlier run
    bool libraryReports = false;
    bool asOtherUser = false;
    const char* notUnderWine = nullptr;
    double seconds = 0; // 0 for no limit
    long megabytes = 0;
};

/// Everything on the workstation before the run, the usual files included.
Files WorkstationBefore(const Scenario& scenario);
/// The whole log after the run; empty for that of the earlier run.
std::string LogAfter(const Scenario& scenario);

class Workstations : public testing::TestWithParam<Scenario>
{
};

std::string NameOf(const testing::TestParamInfo<Scenario>& scenario);
/// What GoogleTest prints in place of the scenario's bytes.
void PrintTo(const Scenario& scenario, std::ostream* stream);

/// Makes the scenarios of the function tests of the same name.
#define TEST_SCENARIOS(function) INSTANTIATE_TEST_SUITE_P(function, Workstations, testing::ValuesIn(function()), NameOf)
