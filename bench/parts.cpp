// Measures the parts of a run with Google Benchmark, on a tmpfs, where waiting for the disk costs
// nothing.
#include "appearance/folder_icon.h"
#include "migrate/preset_text.h"
#include "run/run_log.h"
#include "store/folder_cfg_format.h"
#include "store/folder_cfg_writer.h"
#include "store/xml_document.h"

#include <benchmark/benchmark.h>
#include <wx/init.h>

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <string>

namespace
{

namespace fs = std::filesystem;

constexpr size_t PresetBytes = size_t{4} * 1024 * 1024;
const char* const OldTemplates = "/srv/old/Templates";
const char* const NewTemplates = "/srv/imposition/new/template";

// A folder of this process, used as the user's application data folder and as a hot folder.
fs::path root;

void LoadCfg(benchmark::State& state)
{
    std::ifstream file(fs::path(SAMPLE_HOT_FOLDER) / "[_ORX_HotFolder_]/Folder.cfg",
                       std::ios::binary);
    const std::string bytes{std::istreambuf_iterator<char>(file), {}};
    for (auto _ : state)
    {
        wxXmlDocument document;
        if (!LoadXml(bytes, FolderCfgLimits, document).isWithinLimits)
            state.SkipWithError("not loaded");
    }
}
BENCHMARK(LoadCfg)->Unit(benchmark::kMicrosecond);

// With this many job settings; the sample has about 30.
void SaveCfg(benchmark::State& state)
{
    JobSettingTable table;
    for (std::int64_t i = 0; i < state.range(0); ++i)
        table[wxString::Format("ORXSetting%05d", static_cast<int>(i))] = {"As the server says", "1",
                                                                          "Wie der Server sagt"};
    std::string content;
    for (auto _ : state)
    {
        wxXmlNode noFilter;
        content = FolderCfgBytes({}, table, {}, noFilter, {}, {});
        std::ofstream(root / "saved.cfg", std::ios::binary) << content;
    }
    state.counters["bytes"] = static_cast<double>(content.size());
}
BENCHMARK(SaveCfg)->Arg(30)->Arg(10000)->Unit(benchmark::kMicrosecond);

// A template path every N lines, or none. Moves back and forth, so that each call finds the same
// number.
void MovePaths(benchmark::State& state)
{
    const wxString path =
        wxString(FolderCfg::ImposeTemplateKey) + "\">\"" + OldTemplates + "/Booklet\"\n";
    wxString text;
    text.reserve(PresetBytes);
    for (std::int64_t line = 1; text.length() < PresetBytes; ++line)
        text += state.range(0) != 0 && line % state.range(0) == 0
                    ? path
                    : wxString("    <Setting Key=\"ORXMediaType\">\"Plain\"</Setting>\n");
    bool isForth = true;
    size_t moved = 0;
    for (auto _ : state)
    {
        moved = MovePresetPaths(text, isForth ? OldTemplates : NewTemplates,
                                isForth ? NewTemplates : OldTemplates)
                    .value_or(0);
        isForth = !isForth;
    }
    state.counters["hits"] = static_cast<double>(moved);
}
BENCHMARK(MovePaths)->Arg(0)->Arg(4)->Unit(benchmark::kMillisecond);

// Writes to a log that grows with every call.
void LogLine(benchmark::State& state)
{
    for (auto _ : state)
        RunLog("updated Impose path for hf/srv/Hot Folders/Flyers A4", 1);
}
BENCHMARK(LogLine)->Iterations(1000)->Unit(benchmark::kMicrosecond);

void RefreshIcon(benchmark::State& state)
{
    const HotFolder folder(wxString::FromUTF8(root.string()));
    for (auto _ : state)
        ApplyFolderIcon(folder, "hf_folder.ico");
    if (!fs::exists(root / "Desktop.ini"))
        state.SkipWithError("not applied");
}
BENCHMARK(RefreshIcon)->Unit(benchmark::kMicrosecond);

} // namespace

int main(int argc, char** argv)
{
    const wxInitializer library(argc, argv);
    std::string pattern = "/dev/shm/parts XXXXXX";
    root = mkdtemp(pattern.data());
    fs::create_directory(root / "ORX_Installers");
    setenv("XDG_CONFIG_HOME", root.c_str(), 1);
    benchmark::Initialize(&argc, argv);
    benchmark::RunSpecifiedBenchmarks();
    fs::remove_all(root);
    return 0;
}
