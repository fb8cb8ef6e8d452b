// Times the parts of a run with Google Benchmark; the samples' hot folder and presets serve as
// typical ones.
#include "run/folder_upgrade_app.h"
#include "run/run_log.h"
#include "appearance/folder_icon.h"
#include "migrate/install_locations.h"
#include "migrate/preset_text.h"
#include "store/folder_cfg_reader.h"
#include "store/folder_cfg_writer.h"

#include <benchmark/benchmark.h>
#include <wx/init.h>
#include <wx/xml/xml.h>

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <string>

namespace
{

namespace fs = std::filesystem;

constexpr int ManyEntries = 10000;
constexpr size_t PresetBytes = size_t{4} * 1024 * 1024;
const char* const OldTemplates = "/srv/old/Templates";
const char* const NewTemplates = "/srv/imposition/new/template";

// A temporary folder with a hot folder and the folder of the run log; gone with the process.
class Workstation
{
  public:
    Workstation()
    {
        std::string pattern = (fs::temp_directory_path() / "bench XXXXXX").string();
        m_root = mkdtemp(pattern.data());
        fs::create_directories(m_root / "user/ORX_Installers");
        fs::create_directories(CfgPath("typical").parent_path());
        fs::create_directories(CfgPath("large").parent_path());
        setenv("XDG_CONFIG_HOME", (m_root / "user").c_str(), 1);
        fs::copy(fs::path(SAMPLE_HOT_FOLDER) / "[_ORX_HotFolder_]/Folder.cfg", CfgPath("typical"));
        std::ofstream(CfgPath("typical").parent_path() / "hf_folder.ico") << "stale";
    }

    Workstation(const Workstation&) = delete;
    Workstation& operator=(const Workstation&) = delete;

    ~Workstation()
    {
        fs::remove_all(m_root);
    }

    fs::path HotFolder(const std::string& name) const
    {
        return m_root / name;
    }

    fs::path CfgPath(const std::string& name) const
    {
        return HotFolder(name) / "[_ORX_HotFolder_]/Folder.cfg";
    }

    fs::path LogPath() const
    {
        return m_root / "user/ORX_Installers/UpgradeDowngrade.log";
    }

  private:
    fs::path m_root;
};

const Workstation& TheWorkstation()
{
    static const Workstation workstation;
    return workstation;
}

struct Settings
{
    HotFolderSettings settings;
    JobSettingTable jobSettings;
    HotFolderPaths paths;
    wxXmlNode filterSetting;
    ImposeSettingTable imposeSettings;
    PreflightSettingList preflightSettings;

    explicit Settings(const wxString& path)
    {
        wxXmlDocument document;
        LoadFolderCfg(path, document);
        LoadHotFolderSettings(path, settings);
        ReadFilterSetting(path, filterSetting);
        ReadJobSettings(document.GetRoot(), jobSettings);
        ReadPaths(document.GetRoot(), paths);
        ReadImposeSettings(document.GetRoot(), imposeSettings);
        ReadPreflightSettings(document.GetRoot(), preflightSettings);
    }

    void Save(const wxString& path) const
    {
        SaveHotFolderSettings(path, settings, jobSettings, paths, filterSetting, imposeSettings,
                              preflightSettings);
    }
};

// The path of a Folder.cfg: the typical one, or that with so many job settings.
wxString CfgPath(bool isLarge)
{
    const Workstation& workstation = TheWorkstation();
    const wxString typical = wxString::FromUTF8(workstation.CfgPath("typical").string());
    const wxString large = wxString::FromUTF8(workstation.CfgPath("large").string());
    if (!isLarge)
        return typical;
    if (!fs::exists(workstation.CfgPath("large")))
    {
        Settings settings(typical);
        for (int i = 0; i < ManyEntries; ++i)
            settings.jobSettings[wxString::Format("ORXSetting%05d", i)] = {
                "As the server says", "1", "Wie der Server sagt"};
        settings.Save(large);
    }
    return large;
}

void CountBytes(benchmark::State& state, size_t bytes)
{
    state.SetBytesProcessed(static_cast<std::int64_t>(bytes) *
                            static_cast<std::int64_t>(state.iterations()));
}

void LoadCfg(benchmark::State& state, bool isLarge)
{
    const wxString path = CfgPath(isLarge);
    for (auto _ : state)
    {
        wxXmlDocument document;
        if (!LoadFolderCfg(path, document))
            state.SkipWithError("not loaded");
    }
    CountBytes(state, fs::file_size(path.utf8_string()));
}
BENCHMARK_CAPTURE(LoadCfg, typical, false)->Unit(benchmark::kMicrosecond);
BENCHMARK_CAPTURE(LoadCfg, of_10000_entries, true)->Unit(benchmark::kMicrosecond);

void SaveCfg(benchmark::State& state, bool isLarge)
{
    const wxString path = CfgPath(isLarge);
    const Settings settings(path);
    for (auto _ : state)
        settings.Save(path);
    CountBytes(state, fs::file_size(path.utf8_string()));
}
BENCHMARK_CAPTURE(SaveCfg, typical, false)->Unit(benchmark::kMicrosecond);
BENCHMARK_CAPTURE(SaveCfg, of_10000_entries, true)->Unit(benchmark::kMicrosecond);

// A preset text with a template path every so many characters, or none.
wxString PresetText(size_t distance)
{
    const wxString path = wxString(ImposeTemplateKey) + "\">\"" + OldTemplates + "/Booklet\"\n";
    const wxString line = "    <Setting Key=\"ORXMediaType\">\"Plain\"</Setting>\n";
    wxString text;
    text.reserve(PresetBytes);
    for (size_t next = distance; text.length() < PresetBytes;)
    {
        text += line;
        if (distance != 0 && text.length() >= next)
        {
            text += path;
            next += distance;
        }
    }
    return text;
}

// Forth and back in turn, so that each replacement finds the same number of paths.
void MovePaths(benchmark::State& state, size_t distance)
{
    wxString text = PresetText(distance);
    bool isForth = true;
    size_t moved = 0;
    for (auto _ : state)
    {
        moved = isForth ? MovePresetPaths(text, OldTemplates, NewTemplates)
                        : MovePresetPaths(text, NewTemplates, OldTemplates);
        isForth = !isForth;
    }
    state.counters["hits"] = static_cast<double>(moved);
    CountBytes(state, text.length());
}
BENCHMARK_CAPTURE(MovePaths, no_hits, 0)->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(MovePaths, few_hits, PresetBytes / 8)->Unit(benchmark::kMillisecond);
BENCHMARK_CAPTURE(MovePaths, many_hits, 200)->Unit(benchmark::kMillisecond);

void LogLine(benchmark::State& state)
{
    const fs::path log = TheWorkstation().LogPath();
    RunLogEnabled = true;
    RunLog("The first line of the process, which empties the log", NoCount);
    std::ofstream lines(log, std::ios::binary);
    for (std::int64_t i = 1; i <= state.range(0); ++i)
        lines << "updated Impose path for hf" << TheWorkstation().HotFolder("typical").string()
              << " count:  " << i << "\r\n";
    lines.close();
    const auto size = fs::file_size(log);
    for (auto _ : state)
    {
        RunLog("updated Impose path for hf/srv/Hot Folders/Flyers A4", 1);
        state.PauseTiming();
        fs::resize_file(log, size);
        state.ResumeTiming();
    }
}
BENCHMARK(LogLine)->RangeMultiplier(10)->Range(10, 10000)->Unit(benchmark::kMicrosecond);

void RefreshIcon(benchmark::State& state)
{
    const wxString hotFolder = wxString::FromUTF8(TheWorkstation().HotFolder("typical").string());
    FolderUpgradeApp app;
    app.m_isUpgrade = true;
    RunLogEnabled = false;
    for (auto _ : state)
        UpdateFolderIcon(app, hotFolder);
    if (!fs::exists(TheWorkstation().HotFolder("typical") / "Desktop.ini"))
        state.SkipWithError("no icon beside this program");
}
BENCHMARK(RefreshIcon)->Unit(benchmark::kMicrosecond);

} // namespace

int main(int argc, char** argv)
{
    const wxInitializer library(argc, argv);
    benchmark::Initialize(&argc, argv);
    if (benchmark::ReportUnrecognizedArguments(argc, argv))
        return 1;
    benchmark::RunSpecifiedBenchmarks();
    return 0;
}
