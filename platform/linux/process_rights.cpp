#include "platform/process_rights.h"

#include <array>
#include <climits>
#include <pwd.h>
#include <unistd.h>

bool IsElevated()
{
    return geteuid() == 0;
}

wxString AccountName()
{
    std::array<char, HOST_NAME_MAX + 1> host = {};
    if (gethostname(host.data(), host.size()) != 0)
        return {};
    const passwd* user = getpwuid(geteuid());
    const wxString name =
        user ? wxString::FromUTF8(user->pw_name) : wxString::Format("%u", geteuid());
    return wxString::FromUTF8(host.data()) + '\\' + name;
}

bool RefusesLinksOfOthers()
{
    return false;
}

bool IsSystemAccount()
{
    return false;
}
