// The files and log lines that the scenarios are made of.
#pragma once

#include "tests/scenario.h"

using Text = std::string;

inline const Text MovedFrom = "{previous}{/}Booklet.tpl";
inline const Text MovedTo = "{default}{/}Booklet.tpl";

// Files ------------------------------------------------------------------------------------------

/// A hive in which the key of one of the two template folders has this value.
Text MachineValue(const Text& value);
Text UserValue(const Text& value);

/// A Folder.cfg as the tool writes it.
Text Written(const Text& path, const Text& filter = "  <FilterSetting mode=\"2\" name=\"&lt;\">\n    <a/>\n  </FilterSetting>\n");
/// The same settings as another program may write them.
Text Foreign(const Text& path);
/// A Folder.cfg with an imposition entry alone, and the way it comes out.
Text Minimal(const Text& path, const Text& declaration = "", const Text& name = "n");
Text MinimalWritten(const Text& path, const Text& name = "n");

/// A template path as a preset stores it.
Text Stored(const Text& path);

// Logs -------------------------------------------------------------------------------------------

/// One folder's lines: what its icon and its template led to.
Text FolderLines(const Text& name, int position, const Text& icon, const Text& impose);
Text NoIcon(const Text& name);
Text Copied(const Text& icon);
Text NoCfg(const Text& name = "A");
Text Found(const Text& path);
Text Untouched(const Text& reason);
Text PresetLine(const Text& line);

inline const Text NoDefault = "Unable to read: Default Impose Template Path\n";
inline const Text NoPrevious = "Unable to read: Previous Version  Default Impose Template Path\n";
inline const Text NoPreviousTo = "unable to read: Previous Version  Default Impose Template Path\n";
inline const Text Updated = "Updated preset.xml  : ";
