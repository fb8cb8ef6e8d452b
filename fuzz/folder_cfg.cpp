// Arbitrary bytes as a Folder.cfg: what is written from the values that are read is read as the
// same values.
#include "fuzz/fuzzing.h"
#include "store/folder_cfg_reader.h"
#include "store/folder_cfg_writer.h"
#include "store/xml_document.h"

namespace
{

bool Load(const std::string& bytes, wxXmlDocument& document)
{
    return LoadXml(bytes, FolderCfgLimits, document).isFaithful && document.GetRoot();
}

std::string Rewritten(const wxXmlDocument& document)
{
    HotFolderSettings settings;
    HotFolderPaths paths;
    JobSettingTable jobSettings;
    ImposeSettingTable imposeSettings;
    PreflightSettingList preflightSettings;
    wxXmlNode filterSetting;
    ReadHotFolderSettings(document.GetRoot(), settings);
    ReadPaths(document.GetRoot(), paths);
    ReadJobSettings(document.GetRoot(), jobSettings);
    ReadImposeSettings(document.GetRoot(), imposeSettings);
    ReadPreflightSettings(document.GetRoot(), preflightSettings);
    ReadFilterSetting(document.GetRoot(), filterSetting);
    return FolderCfgBytes(settings, jobSettings, paths, filterSetting, imposeSettings,
                          preflightSettings);
}

} // namespace

void Try(const std::string& input)
{
    wxXmlDocument document;
    const std::string once = Load(input, document) ? Rewritten(document) : "";
    if (once.empty())
        return;
    wxXmlDocument again;
    Check(once.size() <= FolderCfgLimits.bytes, "what is written is not too long");
    Check(Load(once, again), "what is written can be read");
    Check(Rewritten(again) == once, "a second rewrite gives the same bytes");
}
