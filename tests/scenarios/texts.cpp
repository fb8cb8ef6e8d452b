#include "tests/scenarios/texts.h"

#include "tests/text_files.h"

namespace
{

Text Hive(const Text& key, const Text& value)
{
    return "Windows Registry Editor Version 5.00\r\n\r\n[" + key + "]\r\n\"Other\"=dword:00000001\r\n" + value + "\r\n";
}

// A file of tests/data, with what is in doubled braces replaced.
Text Data(const Text& file, const Files& values)
{
    Text text = ReadFile(Text(DATA_DIR) + "/" + file);
    for (const auto& [name, value] : values)
        ReplaceAll(text, "{{" + name + "}}", value);
    return text;
}

} // namespace

Text MachineValue(const Text& value)
{
    return Hive("HKEY_LOCAL_MACHINE\\SOFTWARE\\Vantorix\\QZA", value);
}

Text UserValue(const Text& value)
{
    return Hive("HKEY_CURRENT_USER\\SOFTWARE\\HF", value);
}

Text Written(const Text& path, const Text& filter)
{
    return Data("written.cfg", {{"path", path}, {"filter", filter}});
}

Text Foreign(const Text& path)
{
    return Data("foreign.cfg", {{"path", path}});
}

Text Minimal(const Text& path, const Text& declaration, const Text& name)
{
    return declaration + "<HotFolder name=\"" + name + "\"><ImposeSetting><K k=\"ORXImposeTemplate\" v=\"" + path +
           "\"/></ImposeSetting></HotFolder>";
}

Text MinimalWritten(const Text& path, const Text& name)
{
    return Data("minimal_written.cfg", {{"path", path}, {"name", name}});
}

Text Stored(const Text& path)
{
    return "<K n=\"ORXImposeTemplate\">\"" + path + "\"</K>\r\n";
}

Text FolderLines(const Text& name, int position, const Text& icon, const Text& impose)
{
    const Text end = name + " count:  " + std::to_string(position) + "\n";
    return icon + "Updated icon for hf{hot}{/}" + end + impose + "updated Impose path for hf{hot}{/}" + end;
}

Text NoIcon(const Text& name)
{
    return "Icon path  not exist: {tool}{/}{icons}" + name + ".ico\n";
}

Text Copied(const Text& icon)
{
    return "Icon  copied from : {tool}{/}{icons}" + icon + ".ico To {hot}{/}A{/}[_ORX_HotFolder_]{/}" + icon + ".ico \n";
}

Text NoCfg(const Text& name)
{
    return "HF cfg file unable to read/exist: {hot}{/}" + name + "{/}[_ORX_HotFolder_]{/}Folder.cfg\n";
}

Text Found(const Text& path)
{
    return "Imposepath:{hot}{/}Ais: " + path + "\n";
}

Text Untouched(const Text& reason)
{
    return "HF cfg file left as it is (" + reason + "): {hot}{/}A{/}[_ORX_HotFolder_]{/}Folder.cfg\n";
}

Text PresetLine(const Text& line)
{
    return line + "{user}{/}ORX{/}JPData{/}.P{/}Presets{/}presets.xml\n";
}
