// A shell that records its calls, in place of the one that ignores them.
#pragma once

#include "platform/system.h"

#include <string>
#include <vector>

extern std::vector<std::string> ShellCalls;
extern DWORD ShellMajorVersion, ShellMinorVersion;
extern HRESULT ShellVersionResult;
