// Arbitrary bytes. As a Folder.cfg: what becomes of it can be read again, and is the same after a
// move back and a second move. As a job preset: only the template paths in the folder change.
#include "migrate/preset_text.h"
#include "migrate/template_move.h"
#include "store/folder_cfg_format.h"
#include "store/hot_folder.h"
#include "tests/text_files.h"

#include <wx/init.h>
#include <wx/log.h>

#include <cstdint>
#include <cstdlib>
#include <iostream>

namespace
{

const char* const From = "/old";
const char* const To = "/old/new"; // below it

void Check(bool holds, const char* promise)
{
    if (holds)
        return;
    std::cerr << "Broken promise: " << promise << '\n';
    std::abort();
}

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

void TryFolderCfg(const std::string& input)
{
    static std::string pattern = std::filesystem::temp_directory_path() / "hot_folder_XXXXXX";
    static const wxString path = mkdtemp(pattern.data());
    WriteFile(FolderCfgPath(path).ToStdString(), input);
    HotFolder folder(path);
    folder.LoadCfg();
    const TemplateFolders folders(true, From, To);
    const std::string once = Move(folder, folders);
    if (!once.empty() && !Move(folder, TemplateFolders(true, To, From)).empty())
        Check(Move(folder, folders) == once, "a second rewrite gives the same bytes");
}

void TryPreset(const std::string& input)
{
    wxString text = wxString::FromUTF8(input.data(), input.size());
    wxString expected = text;
    const wxString path = wxString(FolderCfg::ImposeTemplateKey) + "\">\"";
    for (const wxString end : {"/", "\""})
        expected.Replace(path + From + end, path + To + end);
    MovePresetPaths(text, From, To);
    Check(text == expected, "only the paths in the folder move");
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    static const wxInitializer library;
    wxLog::EnableLogging(false);
    const std::string input(reinterpret_cast<const char*>(data), size);
    TryFolderCfg(input);
    TryPreset(input);
    return 0;
}
