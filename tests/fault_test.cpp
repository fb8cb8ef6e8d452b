// Runs the tool many times on a small workstation; each time, something happens at a different call
// (failing_calls.cpp). A run ends as always, no file is torn, and what the call does not concern is
// as after a run without a fault.
#include "tests/scenarios/texts.h"

#include <cerrno>
#include <regex>
#include <set>

namespace
{

// What happens at each call in turn: see failing_calls.cpp.
struct Fault
{
    Text name = {};
    Text events = {};
    int error = 0;
    Text calls = {}; // all of them if empty
    Text victim = "elsewhere";
    Text target = "elsewhere";
};

// Between two of these calls, nothing changes on the disk.
const Text Changing =
    "open64 pwrite64 fallocate64 ftruncate64 unlink chmod fchmod setxattr removexattr ";

// Two hot folders and two presets that are rewritten, and the same files elsewhere.
Files FilesBefore()
{
    const Text lost = "<HotFolder lost=\"" + Text(2000, 'x') + "\"";
    Files files = {{CfgPlace, Written(MovedFrom)},
                   {"hot/A/[P]/hf_folder.ico", "old"},
                   {"hot/B/[P]/hf_error_inactive.ico", "old"},
                   {"hot/B/[P]/Error.er", ""},
                   {"hot/B/[P]/Folder.cfg", Replaced(Minimal(MovedFrom), "<HotFolder", lost)},
                   {"hot/B/Desktop.ini", "[.ShellClassInfo]\nIconFile=mine.ico\n[ViewState]\n"},
                   {"hot/B/Desktop.ini#", "RS"},
                   {"user/ORX/JPData/P/Presets/presets.xml", "ORXImposeTemplate\">\"{previous}\""},
                   {"user/ORX/JPData/Q/Presets/presets.xml",
                    "\xEF\xBB\xBF" + Stored(MovedFrom) + Text(4000, 'x')},
                   {LogPlace, "an earlier run's\r\n"}};
    for (const auto& [place, text] : Files(files))
        files[place] = files["elsewhere/" + place] = Replaced(text, "{previous}", "/p");
    files[UserHive] = Hive(UserKey, "\"Path\"=\"/p\""); // so that a preset grows by more than half
    files["elsewhere/hot/B/Desktop.ini#"] = "";
    files["elsewhere/empty/other"] = "a hot folder without a private directory";
    return WorkstationBefore(Scenario("").Before(files));
}

// The hot folder, job preset directory or log folder to which the place belongs; else the place.
Text Part(const Text& place)
{
    static const std::regex form("^((hot|" + JobPresets + ")/[^/#]+|" + LogFolder + ").*");
    return std::regex_replace(place, form, "$1");
}

class Faults : public testing::TestWithParam<Fault>
{
  protected:
    Text Path(const Text& place) const
    {
        return m_workstation.HostPath(place).string();
    }

    // Runs the tool; returns the place that the call concerned, empty if there was no such call.
    Text Run(int number, const Fault& fault)
    {
        m_workstation.LayOut(m_files);
        const Text root = m_workstation.HostPath("hot").parent_path().string();
        const Text link = root + "/link";
        std::filesystem::remove_all(link); // or what it was exchanged with
        MakeLink(Path(fault.target), link);
        RunResult run = m_workstation.Start(
            "FolderUpgrade", {"I"},
            {{"LD_PRELOAD", FAILING_CALLS},
             {"ASAN_OPTIONS", "verify_asan_link_order=0:detect_leaks=0"},
             {"FAULT_ROOT", fault.events == "x" ? Path(Part(fault.victim)) : root},
             {"FAULT_NUMBER", std::to_string(number)},
             {"FAULT_EVENTS", fault.events},
             {"FAULT_ERROR", std::to_string(fault.error)},
             {"FAULT_CALLS", fault.calls},
             {"FAULT_VICTIM", Path(fault.victim)},
             {"FAULT_LINK", link}});
        m_status = run.status;
        for (const Text top : {"hot", "user", "machine", "tool"})
            run.output = Replaced(run.output, Path(top), top);
        return run.output;
    }

    // What the call does not concern is as after a run without a fault.
    void ExpectRest(const Text& hit, const Files& now) const
    {
        std::set<Text> parts; // that are not
        for (const auto& [place, texts] : Differences(m_after, now))
            parts.insert(Part(place));
        parts.erase(LogFolder);
        const bool isForSeveral = parts.erase(Part(hit)) == 0 && Part(hit + "/") == hit + "/";
        // One hot folder or all presets, without the list everything, may then be skipped.
        EXPECT_TRUE(parts.empty() ||
                    (isForSeveral && (parts.size() == 1 || StartsWith(hit, "machine/hotfolder") ||
                                      StartsWith(*parts.begin(), JobPresets))))
            << testing::PrintToString(parts);
    }

    // Each stored file is the old or the new one, and the log has whole lines. At the end of a
    // process, line feeds may fill a file up to the old length.
    void ExpectWhole(const Files& now) const
    {
        for (const auto& [place, text] : m_before)
        {
            if (!std::regex_search(place, std::regex("(Folder.cfg|presets.xml)$")))
                continue;
            Text filled = m_after.at(place);
            filled.resize(std::max(filled.size(), text.size()), '\n');
            const Text& found = now.at(place);
            EXPECT_TRUE(found == text || found == m_after.at(place) ||
                        (m_status != 255 && found == filled))
                << place << " is torn: " << found;
        }
        const Text& log = now.at(LogPlace);
        EXPECT_TRUE(log.empty() || log.substr(log.size() - 2) == "\r\n") << log;
    }

    Workstation m_workstation;
    const Files m_files = FilesBefore();
    Files m_before;
    Files m_after;
    int m_status = 0;
};

std::vector<Fault> AllFaults()
{
    std::vector<Fault> faults = {
        {"EIO", "f", EIO},
        {"ENOSPC", "f", ENOSPC, "pwrite64 fallocate64 setxattr "},
        {"EINTR", "f", EINTR, "pread64 pwrite64 "},
        {"SHORT", "s", 0, "pwrite64 "},
        {"SHORT_ENOSPC", "sf", ENOSPC, "pwrite64 "},
        {"FULL_DISK", Text(10000, 'f'), ENOSPC, "pwrite64 fallocate64 setxattr "},
        {"END", "e", 0, Changing}};
    for (const Text victim :
         {"hot/A", "hot/A/[P]", "hot/A/[P]/Folder.cfg", "hot/A/[P]/hf_folder.ico", "hot/B/[P]",
          "hot/B/Desktop.ini", "user/ORX/JPData/P/Presets", "user/ORX/JPData/P/Presets/presets.xml",
          "user/ORX_Installers", "user/ORX_Installers/UpgradeDowngrade.log"})
    {
        const Text calls = "opendir access stat64 lstat64 getxattr " + Changing;
        for (const Text& target : {victim == "hot/A" ? "elsewhere/empty" : "elsewhere/" + victim,
                                   Text("elsewhere/empty/missing")})
            faults.push_back(
                {"LINK" + std::to_string(faults.size()), "x", 0, calls, victim, target});
    }
    return faults;
}

TEST_P(Faults, AreSurvived)
{
    const Fault& fault = GetParam();
    Run(0, {});
    m_after = m_workstation.Snapshot();
    m_workstation.LayOut(m_files);
    m_before = m_workstation.Snapshot();
    int number = 0;
    for (Text hit = "first"; !hit.empty() && !HasFailure();)
    {
        hit = Run(++number, fault);
        SCOPED_TRACE(fault.victim + " call number " + std::to_string(number) + ", " + hit);
        EXPECT_EQ(fault.events == "e" && !hit.empty() ? 137 : 255, m_status);
        const Files now = m_workstation.Snapshot();
        if (fault.events == "x")
        {
            for (const auto& [place, texts] : Differences(m_before, now))
                EXPECT_FALSE(StartsWith(place, "elsewhere/")) << place << texts.second;
            continue;
        }
        ExpectWhole(now);
        if (fault.events != "e" && fault.events.size() <= 2) // a single call
            ExpectRest(hit, now);
    }
    EXPECT_LT(1, number);
}

INSTANTIATE_TEST_SUITE_P(AtEachCall, Faults, testing::ValuesIn(AllFaults()),
                         [](const auto& fault) { return fault.param.name; });

} // namespace
