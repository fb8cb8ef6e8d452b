// What has to be set up before the library starts.
#include "platform/linux/start_up.h"

#include <wx/strconv.h>

#include <algorithm>
#include <clocale>
#include <sys/resource.h>

namespace
{

// As much as the Windows program reserves, because the library destroys documents by recursion.
constexpr rlim_t StackBytes = 64UL * 1024 * 1024;

void RaiseStackLimit()
{
    rlimit limit = {};
    if (getrlimit(RLIMIT_STACK, &limit) != 0 || limit.rlim_cur >= StackBytes)
        return;
    limit.rlim_cur = std::min(StackBytes, limit.rlim_max);
    setrlimit(RLIMIT_STACK, &limit);
}

} // namespace

StartUp::StartUp()
{
    // If the system lacks this locale, the handling of names that are not ASCII does not change.
    static_cast<void>(std::setlocale(LC_CTYPE, "C.UTF-8"));
    wxConvLocal = wxCSConv(wxFONTENCODING_UTF8); // which the library uses to read the command line
    RaiseStackLimit();
}
