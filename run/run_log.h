// The run log, the tool's only report: UpgradeDowngrade.log in the folder ORX_Installers of the
// per-user application data folder. UTF-8 without byte-order mark, CR LF line ends.
#pragma once

#include <wx/string.h>

/// Whether the run writes its log; true at process start, cleared by the command line.
extern bool RunLogEnabled;

/// The count of a line that has none.
constexpr int NoCount = -1;

/// Appends a line: the message, followed by the count unless it is NoCount. The first line of a run
/// empties the file, and creates it where its folder exists. The file is read and written whole for
/// each line, and closed between any two. A line that cannot be written is dropped; nothing is
/// reported. Does nothing at all while RunLogEnabled is false.
void RunLog(const wxString& message, int count);
