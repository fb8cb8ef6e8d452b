// What a run of FolderUpgrade would change, and what would prevent a change. Only reads.
#pragma once

#include "check/report.h"
#include "migrate/template_folders.h"

/// Writes the whole report but its totals.
void CheckRun(TemplateFolders& folders, Report& report);
