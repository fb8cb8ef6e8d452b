// The run log: UpgradeDowngrade.log in the folder ORX_Installers of the per-user application data
// folder. UTF-8 without byte-order mark, CR LF line ends.
#pragma once

#include <wx/string.h>

constexpr const wchar_t* RunLogFileName = L"UpgradeDowngrade.log";

/// The log's folder, with a final separator. It may be missing; RunLog does not create it.
wxString RunLogDirPath();

/// Whether the run writes its log; true at process start, cleared by the command line.
extern bool RunLogEnabled;

/// The count to pass for a line without one.
constexpr int NoCount = -1;

/// Appends one line: the message, then the count unless it is NoCount; on one line, as ToOneLine
/// (platform/unicode_text.h) makes it. The first
/// line of a run empties the file, and creates it if its folder exists. The file is closed between
/// lines; if it is removed meanwhile, it is not created again. If the folder or the file is a link,
/// or the file is not a regular file, there is no log. A line that cannot be written completely is
/// left out; the library reports the first. Does nothing while RunLogEnabled is false.
void RunLog(const wxString& message, int count = NoCount);
