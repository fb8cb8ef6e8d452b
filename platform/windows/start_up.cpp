// What has to be so before a program does anything else: which folder libraries come from, and
// which links an elevated process follows.
#include "platform/process_rights.h"
#include "platform/system.h"

namespace
{

// Libraries that are loaded by name, and those that are loaded on their first use, come from the
// system's directory: not from the executable's own, which for a downloaded installer is a folder
// that anything may have been put into, nor from the current one.
void LoadSystemLibrariesOnly()
{
    SetDefaultDllDirectories(LOAD_LIBRARY_SEARCH_SYSTEM32);
}

// From now on the process refuses to pass junctions and symbolic links that a process without
// administrator's rights has made. Windows 11 and Windows 10 22H2 know this policy; on an older
// system the call fails and nothing changes. The policy holds for this process alone: a program
// does not inherit it from the installer that starts it.
void RefuseLinksOfOthers()
{
    PROCESS_MITIGATION_REDIRECTION_TRUST_POLICY policy = {};
    policy.EnforceRedirectionTrust = 1;
    SetProcessMitigationPolicy(ProcessRedirectionTrustPolicy, &policy, sizeof policy);
}

struct StartUp
{
    StartUp()
    {
        LoadSystemLibrariesOnly(); // first, in case that what follows loads one
        if (IsElevated())
            RefuseLinksOfOthers();
    }
};

} // namespace

// Made before every other static object, those of the libraries included, in whatever order the
// files are linked.
#ifdef _MSC_VER
#pragma warning(disable : 4073) // says that this is for libraries
#pragma init_seg(lib)
#define MADE_FIRST
#else
#define MADE_FIRST [[gnu::init_priority(101)]] // 0 to 100 are the compiler's own
#endif

// Nothing refers to it. platform/CMakeLists.txt tells the linker to take it all the same; its name
// there is this one, which is why it is a C name.
extern "C"
{
    extern const StartUp StartUpOfProgram;
    MADE_FIRST const StartUp StartUpOfProgram;
}
