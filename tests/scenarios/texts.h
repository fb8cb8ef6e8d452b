// The files and log lines that the scenarios use.
#pragma once

#include "tests/scenario.h"

/// The text COUNT times, with the repetition's six-digit number in place of a '#'.
inline Text Times(int count, const Text& text)
{
    Text result;
    const bool isNumbered = text.find('#') != Text::npos; // every test repeats this
    for (int i = 0; i < count; ++i)
        result += isNumbered ? Replaced(text, "#", std::to_string(1000000 + i).substr(1)) : text;
    return result;
}

inline const Text Disabled = "hf_folder_disabled";
inline const Text NoLinks = "Wine shows neither links to files nor dangling ones as links";
inline const Text LogFolder = "user/ORX_Installers";
inline const Text JobPresets = "user/ORX/JPData";

inline const Text MovedFrom = "{previous}{/}Booklet.tpl";
inline const Text MovedTo = "{default}{/}Booklet.tpl";

inline const Text MachineKey = "HKEY_LOCAL_MACHINE\\SOFTWARE\\Vantorix\\QZA";
inline const Text UserKey = "HKEY_CURRENT_USER\\SOFTWARE\\HF";

/// A hive in which the key of one of the two template folders has this value.
inline Text Hive(const Text& key, const Text& value)
{
    return "Windows Registry Editor Version 5.00\r\n\r\n[" + key +
           "]\r\n\"Other\"=dword:00000001\r\n" + value + "\r\n";
}

/// A file of tests/data with this path.
inline Text Data(const Text& file, const Text& path)
{
    return Replaced(ReadFile(ProgramDir() / DATA_DIR / file), "{{path}}", path);
}

/// A Folder.cfg as the tool writes it; foreign.cfg has the same settings as another program may
/// write them.
inline Text Written(const Text& path,
                    const Text& filter = "<FilterSetting mode=\"2\" name=\"&lt;\">\n"
                                         "    <a/>\n  </FilterSetting>")
{
    return Replaced(Data("written.cfg", path), "{{filter}}", "  " + filter + "\n");
}

/// A Folder.cfg with only an imposition entry, and the same after a rewrite.
inline Text Minimal(const Text& path, const Text& declaration = "", const Text& name = "n")
{
    return declaration + "<HotFolder name=\"" + name +
           "\"><ImposeSetting><K k=\"ORXImposeTemplate\" v=\"" + path +
           "\"/></ImposeSetting></HotFolder>";
}

inline Text MinimalWritten(const Text& path, const Text& name = "n")
{
    return Replaced(Data("minimal_written.cfg", path), "{{name}}", name);
}

/// A template path as a preset stores it.
inline Text Stored(const Text& path)
{
    return "<K n=\"ORXImposeTemplate\">\"" + path + "\"</K>\r\n";
}

// Desktop.ini and the icon of A.

inline const Text Ini = "hot/A/Desktop.ini";
inline const Text Icon = "hot/A/[P]/hf_folder_disabled.ico";

inline const Text IniHeader = "[.ShellClassInfo]\r\n";
inline const Text InfoTip = "InfoTip=This folder has been configured as an ORX hot folder.\r\n";

inline Text IconFile(const Text& name)
{
    return "IconFile=.\\[_ORX_HotFolder_]\\" + name + ".ico\r\n";
}

/// A hot folder in which a run changes nothing but its template.
inline Files DoneFolder(const Text& name, const Text& cfg, const Text& icon = "hf_folder")
{
    const Text folder = "hot/" + name;
    return {{folder + "#", "S"},
            {folder + "/Desktop.ini#", "RS"},
            {folder + "/Desktop.ini", IniHeader + InfoTip + IconFile(icon)},
            {folder + "/[P]/" + icon + ".ico", "{icon:" + icon + ".ico}"},
            {folder + "/[P]/Folder.cfg", cfg}};
}

/// A scenario in which something is refused to a user who is not root, which the library reports.
inline Scenario Refused(const Text& whatHappens, const Files& files, long errors = 1)
{
    return Scenario(whatHappens, files).AsOtherUser().LibraryReports(errors);
}

// Log lines; {icons} is where the icons of the run's direction come from.

inline Text NoIcon(const Text& name)
{
    return "Icon path  not exist: {tool}{/}{icons}" + name + ".ico\n";
}
inline Text Copied(const Text& icon)
{
    return "Icon  copied from : {tool}{/}{icons}" + icon +
           ".ico To {hot}{/}A{/}[_ORX_HotFolder_]{/}" + icon + ".ico \n";
}
inline const Text NoCfg =
    "HF cfg file unable to read/exist: {hot}{/}A{/}[_ORX_HotFolder_]{/}Folder.cfg\n";
inline Text Untouched(const Text& reason)
{
    return "HF cfg file left as it is (" + reason +
           "): {hot}{/}A{/}[_ORX_HotFolder_]{/}Folder.cfg\n";
}
inline Text Found(const Text& path)
{
    return "Imposepath:{hot}{/}Ais: " + path + "\n";
}
inline Text PresetLine(const Text& line)
{
    return line + "{user}{/}ORX{/}JPData{/}.P{/}Presets{/}presets.xml\n";
}

inline const Text NoDefault = "Unable to read: Default Impose Template Path\n";
inline const Text NoPrevious = "Unable to read: Previous Version  Default Impose Template Path\n";
inline const Text NoPreviousTo = "unable to read: Previous Version  Default Impose Template Path\n";
inline const Text Updated = "Updated preset.xml  : ";

/// A done folder with this Folder.cfg, before and after; without the second, it stays. The lines
/// about its template are as if its name were A.
struct HotFolder
{
    Text cfg = {};
    Text becomes = {};
    Text impose = {};
    Text icon = Disabled;
};

inline Scenario HotFolders(const Text& whatHappens, const std::map<Text, HotFolder>& folders)
{
    Scenario scenario(whatHappens);
    std::vector<FolderLog> log;
    for (const auto& [name, folder] : folders)
    {
        scenario.Before(DoneFolder(name, folder.cfg, folder.icon));
        scenario.File(Replaced(CfgPlace, "A", name), folder.cfg, folder.becomes);
        log.push_back({name, folder.impose, folder.icon});
    }
    return scenario.Log(log);
}
