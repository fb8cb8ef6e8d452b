// What only Windows can answer. Under Wine the same is done and printed, but not judged.
#include "platform/system.h"
#include "tests/scenarios/texts.h"

#include <chrono>

namespace
{

void Judge(bool isRight, const Text& found)
{
    std::printf("%s: %s\n", isRight ? "as expected" : "NOT as expected", found.c_str());
    EXPECT_TRUE(isRight || IsWine()) << found;
}

TEST(OnlyOnWindows, TheShellShowsTheNewIconOfAReadOnlyFolder)
{
    Workstation workstation;
    workstation.LayOut(WorkstationBefore(Scenario("").Before(
        {{Icon, "old"}, {"hot/A#", "R"}, {Ini, "[.ShellClassInfo]\r\n"}, {Ini + "#", "RS"}})));
    workstation.Start("FolderUpgrade", {"I"});
    CoInitialize(nullptr);
    SHFILEINFOW info = {};
    const bool isAnswered = SHGetFileInfoW(workstation.HostPath("hot/A").c_str(), 0, &info,
                                           sizeof info, SHGFI_ICONLOCATION) != 0;
    const fs::path shown = info.szDisplayName;
    std::error_code ignored;
    Judge(isAnswered && fs::equivalent(shown, workstation.HostPath(Icon), ignored),
          "the icon is that in " + shown.u8string());
}

TEST(OnlyOnWindows, KillsTearNoFile)
{
    Scenario scenario("");
    const int folders = IsWine() ? 10 : 26; // Wine is slower
    for (char folder = 'A'; folder < 'A' + folders; ++folder)
        scenario.Before({{Text("hot/") + folder + "/[P]/Folder.cfg", Written(MovedFrom)}});
    Workstation workstation;
    const Text before = workstation.Expand(Written(MovedFrom));
    const Text after = workstation.Expand(Written(MovedTo));
    auto duration = std::chrono::steady_clock::duration::max(); // of the shortest of three runs
    int torn = 0;
    int inTheMiddle = 0;
    for (int kill = -2; kill <= 50; ++kill)
    {
        workstation.LayOut(WorkstationBefore(scenario));
        const auto start = std::chrono::steady_clock::now();
        const auto limit = kill > 0 ? duration * kill / 50 / std::chrono::milliseconds(1) + 1 : 0;
        workstation.Start("FolderUpgrade", {"I", "V"}, {}, static_cast<int>(limit));
        if (kill <= 0)
            duration = std::min(duration, std::chrono::steady_clock::now() - start);
        int moved = 0;
        for (const auto& [place, text] : workstation.Snapshot())
        {
            const bool isCfg = place.find("Folder.cfg") != Text::npos;
            moved += isCfg && text == after ? 1 : 0;
            torn += isCfg && text != before && text != after ? 1 : 0;
        }
        inTheMiddle += moved > 0 && moved < folders ? 1 : 0;
    }
    Judge(torn == 0 && inTheMiddle > 10, std::to_string(torn) + " files torn by 50 kills, " +
                                             std::to_string(inTheMiddle) +
                                             " of them while files were rewritten");
}

} // namespace
