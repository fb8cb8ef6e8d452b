// What a run would do to one hot folder.
#pragma once

#include "check/report.h"
#include "check/template_folders.h"

#include <wx/string.h>

/// Changes nothing.
void CheckHotFolder(const wxString& hotFolder, const TemplateFolders& folders, Report& report);
