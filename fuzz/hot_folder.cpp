// A hot folder with arbitrary bytes as its Folder.cfg: what becomes of it can be read again, with
// nothing changed but the template's path, and is the same after a move back and a second move.
#include "store/hot_folder.h"

#include "fuzz/fuzzing.h"
#include "migrate/template_move.h"
#include "tests/text_files.h"

namespace
{

// The new content, empty if the template does not move.
std::string Move(HotFolder& folder, TemplateFolders folders)
{
    const TemplateMove move = DecideTemplateMove(folder.cfg, folders);
    if (move.outcome != TemplateMove::Outcome::Moves)
        return "";
    Check(move.newContent.size() <= FolderCfgLimits.bytes, "what is written is not too long");
    WriteFile(FolderCfgPath(folder.path).ToStdString(), move.newContent);
    Check(folder.LoadCfg() == XmlFile::State::Loaded, "what is written can be read");
    const TemplateMove next = DecideTemplateMove(folder.cfg, folders);
    Check(next.storedPath == move.newPath, "the new path is stored");
    Check(next.outcome != TemplateMove::Outcome::Moves, "a second run moves nothing");
    return move.newContent;
}

} // namespace

void Try(const std::string& input)
{
    static std::string pattern = std::filesystem::temp_directory_path() / "hot_folder_XXXXXX";
    static const wxString path = mkdtemp(pattern.data());
    WriteFile(FolderCfgPath(path).ToStdString(), input);
    HotFolder folder(path);
    folder.LoadCfg();
    const TemplateFolders folders(true, "/old", "/new/template");
    const std::string once = Move(folder, folders);
    if (!once.empty() && !Move(folder, TemplateFolders(true, "/new/template", "/old")).empty())
        Check(Move(folder, folders) == once, "a second rewrite gives the same bytes");
}
