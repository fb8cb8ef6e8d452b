// What a run would do to the job presets.
#pragma once

#include "check/template_check.h"

void CheckPresets(TemplateCheck& check);
