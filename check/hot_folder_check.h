// What a run would do to one hot folder.
#pragma once

#include "check/template_check.h"
#include "store/hot_folder.h"

/// Changes nothing.
void CheckHotFolder(HotFolder& folder, TemplateCheck& check);
