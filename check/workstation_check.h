// What concerns the whole run: the list of hot folders, and the run log.
#pragma once

#include "check/report.h"
#include "store/hot_folder_list.h"

void CheckAccount(Report& report);
void CheckHotFolderList(const HotFolderList& list, Report& report);
void CheckRunLog(Report& report);

/// "damaged", with the place and the reason.
wxString Damage(const XmlSyntaxError& error);
