// The end-to-end scenarios: a workstation before, the command line, the workstation after.
// What a scenario does not mention has its usual value. tests/scenarios/ has one file for each
// subject, and texts.h, with the files and log lines that the scenarios use.
#pragma once

#include "tests/workstation.h"

#include <gtest/gtest.h>

#include <functional>
#include <string>
#include <vector>

/// In Before: the usual file does not exist.
inline const char* const Removed = "(not there)";

inline const char* const ListPlace = "machine/hotfolder/HotFolderList.cfg";
inline const std::string CfgPlace = "hot/A/[P]/Folder.cfg";
inline const std::string PresetPlace = "user/ORX/JPData/.P/Presets/presets.xml";

/// What should happen, and the line of the scenario in the source, which the conversion from a
/// literal records.
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

class Scenario
{
  public:
    explicit Scenario(const Name& itsName) : name(itsName)
    {
    }

    /// Files in addition to the usual ones, or in place of them. The usual ones are the log of an
    /// earlier run, a hive for each of the two template folders, an empty directory for presets,
    /// and HotFolderList.cfg, which lists every NAME of the places hot/NAME/... in order.
    Scenario& Before(const Files& files)
    {
        return Add(before, files);
    }
    /// The Folder.cfg of the hot folder A, before and after; without the second, it stays.
    Scenario& FolderCfg(const std::string& text)
    {
        return Before({{CfgPlace, text}});
    }
    Scenario& FolderCfg(const std::string& text, const std::string& becomes)
    {
        return FolderCfg(text).After({{CfgPlace, becomes}});
    }
    /// The same for presets.xml of the one directory with presets.
    Scenario& Preset(const std::string& text)
    {
        return Before({{PresetPlace, text}});
    }
    Scenario& Preset(const std::string& text, const std::string& becomes)
    {
        return Preset(text).After({{PresetPlace, becomes}});
    }
    /// For tests of refusals: root is refused nothing.
    Scenario& AsOtherUser()
    {
        return Set(asOtherUser, true);
    }

    /// The command line arguments; {"I"} if not given.
    Scenario& Run(const std::vector<std::string>& given)
    {
        return Set(arguments, given);
    }

    /// Files that change. Every other file and attribute has to stay as it is.
    Scenario& After(const Files& files)
    {
        return Add(after, files);
    }
    /// The whole log, with LF instead of CR LF; if no log is given, that of the earlier run stays.
    Scenario& WholeLog(const std::string& text)
    {
        return Set(log, text);
    }
    /// The log of a run with these lines about the hot folders and the presets.
    Scenario& Log(const std::string& folders, const std::string& presets = "");
    /// The same if A is the only hot folder, has no icon to replace, and has these lines about its
    /// template.
    Scenario& LogOfA(const std::string& impose, const std::string& presets = "",
                     const std::string& icon = "hf_folder");
    Scenario& LogOfDisabledA(const std::string& impose, const std::string& presets = "");
    /// The same if there are no hot folders and one preset, with this line.
    Scenario& LogOfPreset(const std::string& line);
    /// The library itself reports an error, on Windows in a message box.
    Scenario& LibraryReports()
    {
        return Set(libraryReports, true);
    }
    /// Limits of the run. None applies in a build with sanitizers, and no memory limit under Wine.
    /// The measured memory is never below that of the test program at the start, about 25
    /// megabytes.
    Scenario& Within(double most, long mostMegabytes)
    {
        return Set(seconds, most).Set(megabytes, mostMegabytes);
    }
    Scenario& NotUnderWine(const std::string& reason)
    {
        return Set(notUnderWine, reason);
    }

    Name name;
    Files before;
    std::vector<std::string> arguments = {"I"};
    Files after;
    std::string log; // empty for that of the earlier run
    bool libraryReports = false;
    bool asOtherUser = false;
    std::string notUnderWine;
    double seconds = 0; // 0 for no limit
    long megabytes = 0;

  private:
    template <typename Field>
    Scenario& Set(Field& field, const Field& value)
    {
        field = value;
        return *this;
    }

    Scenario& Add(Files& to, const Files& files);
};

/// Everything on the workstation before the run, the usual files included.
Files WorkstationBefore(const Scenario& scenario);
/// The whole log after the run; empty for that of the earlier run.
std::string LogAfter(const Scenario& scenario);

/// Calls the test with the scenario's workstation. A failure names the scenario, its line and the
/// command.
void TestOn(const Scenario& scenario, const std::string& program,
            const std::function<void(Workstation&)>& test);

class Workstations : public testing::TestWithParam<Scenario>
{
};

std::string NameOf(const testing::TestParamInfo<Scenario>& scenario);
/// What GoogleTest prints instead of the scenario's bytes.
void PrintTo(const Scenario& scenario, std::ostream* stream);

/// Makes tests from the scenarios that the function returns, with its name.
#define TEST_SCENARIOS(function)                                                                   \
    INSTANTIATE_TEST_SUITE_P(function, Workstations, testing::ValuesIn(function()), NameOf)
