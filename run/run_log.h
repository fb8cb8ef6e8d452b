// The run log, the tool's only report: UpgradeDowngrade.log in the folder ORX_Installers of the
// per-user application data folder. UTF-8 without byte-order mark, CR LF line ends.
#pragma once

#include <wx/string.h>

/// Whether the run writes its log; true at process start, cleared by the command line.
extern bool RunLogEnabled;

/// The count of a line that has none.
constexpr int NoCount = -1;

/// Appends one line: the message, then the count unless it is NoCount. A character that would end
/// the line, or that is not Unicode, is logged as U+FFFD. The first line of a run empties the file,
/// and creates it where its folder exists; the file is closed between any two lines, and one that
/// is removed meanwhile is not made again. Neither the folder nor the file may be a link, nor the
/// file anything but a regular one: then there is no log. A line that cannot be written is dropped
/// whole. Nothing is reported to the caller; the library reports the first such failure. Does
/// nothing at all while RunLogEnabled is false.
void RunLog(const wxString& message, int count = NoCount);
