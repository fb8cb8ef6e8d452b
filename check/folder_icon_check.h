// What a run would do to the icon, Desktop.ini and the attributes of one hot folder.
#pragma once

#include "check/report.h"
#include "store/hot_folder.h"

void CheckFolderIcon(HotFolder& folder, bool isUpgrade, Report& report);
