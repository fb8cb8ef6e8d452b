// What a run would do to one hot folder's Folder.cfg.
#pragma once

#include "check/report.h"
#include "migrate/template_folders.h"
#include "store/hot_folder.h"

void CheckFolderCfg(HotFolder& folder, TemplateFolders& folders, Report& report);
