// What a run would do to the icon, Desktop.ini and the attributes of one hot folder.
#pragma once

#include "check/template_check.h"
#include "store/hot_folder.h"

/// In a rehearsal without the icons of the version being installed, the icon is left out.
void CheckFolderIcon(HotFolder& folder, TemplateCheck& check);
