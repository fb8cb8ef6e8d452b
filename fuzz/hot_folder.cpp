// A hot folder with arbitrary bytes as its Folder.cfg: the template step leaves a file that can be
// read again, with nothing changed but the template's path, or does not write at all.
#include "fuzz/fuzzing.h"
#include "migrate/template_move.h"
#include "store/folder_cfg_writer.h"

#include <filesystem>
#include <fstream>
#include <iterator>

namespace
{

namespace fs = std::filesystem;

fs::path MakeHotFolder()
{
    std::string pattern = (fs::temp_directory_path() / "hot_folder_XXXXXX").string();
    const fs::path folder = mkdtemp(pattern.data());
    fs::create_directory(folder / fs::path(PrivateDirName));
    return folder;
}

std::string Read(const fs::path& file)
{
    std::ifstream stream(file, std::ios::binary);
    return {std::istreambuf_iterator<char>(stream), {}};
}

} // namespace

void Try(const std::string& input)
{
    static const fs::path path = MakeHotFolder();
    const fs::path cfg = path / fs::path(PrivateDirName) / fs::path(FolderCfgName);
    std::ofstream(cfg, std::ios::binary) << input;
    TemplateFolders folders(true, "/old", "/new/template");
    HotFolder folder(path.string());
    folder.LoadCfg();
    const TemplateMove move = DecideTemplateMove(folder.cfg, folders);
    if (move.outcome != TemplateMove::Outcome::Moves)
        return;
    Check(SaveHotFolderSettings(folder, move.newContent) == XmlFile::Saved::Done, "it is written");
    Check(Read(cfg) == move.newContent, "the new content is in the file");
    Check(folder.LoadCfg() == XmlFile::State::Loaded, "what is written can be read");
    const TemplateMove next = DecideTemplateMove(folder.cfg, folders);
    Check(next.storedPath == move.newPath, "the new path is stored");
    Check(next.outcome != TemplateMove::Outcome::Moves, "a second run moves nothing");
}
