// What has to be set up before a program does anything else: which folder libraries come from, and
// which links an elevated process follows.
#include "platform/process_rights.h"
#include "platform/system.h"

namespace
{

struct StartUp
{
    StartUp()
    {
        // Libraries that are loaded by name or on first use come from the system's directory: not
        // from the current one, nor from that of the executable, which may be a download folder
        // where anybody could have put anything. First, in case the next call loads one.
        SetDefaultDllDirectories(LOAD_LIBRARY_SEARCH_SYSTEM32);
        if (!IsElevated())
            return;
        // From now on the process refuses to follow junctions and symbolic links that a process
        // without administrator's rights has made; it does not inherit that from an installer.
        // Before Windows 11 and Windows 10 22H2 the call fails and nothing changes.
        PROCESS_MITIGATION_REDIRECTION_TRUST_POLICY policy = {};
        policy.EnforceRedirectionTrust = 1;
        SetProcessMitigationPolicy(ProcessRedirectionTrustPolicy, &policy, sizeof policy);
    }
};

} // namespace

// Constructed before every other static object, including those of the libraries, whatever the link
// order; 0 to 100 are reserved for the compiler. See platform/CMakeLists.txt.
extern "C"
{
    extern const StartUp StartUpOfProgram;
    [[gnu::init_priority(101)]] const StartUp StartUpOfProgram;
}
