// What a run of FolderUpgrade would change, and what would prevent a change. Only reads.
#pragma once

#include "check/report.h"

/// Writes the whole report but its totals.
void CheckRun(bool isUpgrade, Report& report);
