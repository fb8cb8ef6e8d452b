// What a run would do to the job presets.
#pragma once

#include "check/report.h"
#include "migrate/template_folders.h"

void CheckPresets(TemplateFolders& folders, Report& report);
