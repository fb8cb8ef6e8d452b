// What a run would do to one hot folder's Folder.cfg.
#pragma once

#include "check/template_check.h"
#include "store/hot_folder.h"

void CheckFolderCfg(HotFolder& folder, TemplateCheck& check);
