// Whatever the libraries load by name comes from the system's directory: not from the executable's
// own, which with a downloaded installer is a folder that anything may have been put into, nor from
// the current one.
#include "platform/system.h"

// Nothing refers to it; the linker is told to take it all the same.
extern "C"
{
    extern const BOOL SystemDllsOnly;
    const BOOL SystemDllsOnly = SetDefaultDllDirectories(LOAD_LIBRARY_SEARCH_SYSTEM32);
}
