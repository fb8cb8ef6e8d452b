// A hot folder with arbitrary bytes as its Folder.cfg: the template step leaves a file that can be
// read again, with nothing changed but the template's path, or does not write at all.
#include "fuzz/fuzzing.h"
#include "migrate/template_move.h"
#include "store/folder_cfg_writer.h"
#include "tests/text_files.h"

void Try(const std::string& input)
{
    static std::string pattern = std::filesystem::temp_directory_path() / "hot_folder_XXXXXX";
    static const std::filesystem::path path = mkdtemp(pattern.data());
    const std::filesystem::path cfg = path / PrivateDirName / FolderCfgName;
    WriteFile(cfg, input);
    TemplateFolders folders(true, "/old", "/new/template");
    HotFolder folder(path.string());
    folder.LoadCfg();
    const TemplateMove move = DecideTemplateMove(folder.cfg, folders);
    if (move.outcome != TemplateMove::Outcome::Moves)
        return;
    Check(SaveHotFolderSettings(folder, move.newContent) == XmlFile::Saved::Done, "it is written");
    Check(ReadFile(cfg) == move.newContent, "the new content is in the file");
    Check(folder.LoadCfg() == XmlFile::State::Loaded, "what is written can be read");
    const TemplateMove next = DecideTemplateMove(folder.cfg, folders);
    Check(next.storedPath == move.newPath, "the new path is stored");
    Check(next.outcome != TemplateMove::Outcome::Moves, "a second run moves nothing");
}
