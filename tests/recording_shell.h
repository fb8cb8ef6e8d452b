// A shell that writes down what it is told, in place of the one that ignores it.
#pragma once

#include "platform/system.h"

#include <string>
#include <vector>

extern std::vector<std::string> ShellCalls;
extern DWORD ShellMajorVersion;
extern DWORD ShellMinorVersion;
extern HRESULT ShellVersionResult;
