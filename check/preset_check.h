// What a run would do to the job presets.
#pragma once

#include "check/report.h"
#include "check/template_folders.h"

void CheckPresets(const TemplateFolders& folders, Report& report);
