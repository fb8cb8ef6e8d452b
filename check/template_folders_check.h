// What is wrong with the two template folders.
#pragma once

#include "check/report.h"
#include "migrate/template_folders.h"

/// Reports what is wrong with the previous version's folder, whether or not a template moves.
void CheckPreviousFolder(TemplateFolders& folders, Report& report);

/// Reports once that something that is needed is unknown.
void CheckIsKnown(const TemplateFolder& folder, Report& report);

/// Reports both if they are unknown, and what matters only in the text of presets.
void CheckFoldersForPresets(TemplateFolders& folders, Report& report);
