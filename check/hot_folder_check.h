// What a run would do to one hot folder.
#pragma once

#include "check/report.h"
#include "migrate/template_folders.h"
#include "store/hot_folder.h"

/// Changes nothing.
void CheckHotFolder(HotFolder& folder, TemplateFolders& folders, Report& report);
