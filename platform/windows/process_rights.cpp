#include "platform/process_rights.h"

#include "platform/system.h"

namespace
{

struct UserToken
{
    TOKEN_USER user;
    BYTE identifier[SECURITY_MAX_SID_SIZE]; // user points to it
};

bool ReadToken(TOKEN_INFORMATION_CLASS what, void* information, DWORD size)
{
    HANDLE token = nullptr;
    if (!OpenProcessToken(GetCurrentProcess(), TOKEN_QUERY, &token))
        return false;
    const bool isRead = GetTokenInformation(token, what, information, size, &size) != 0;
    CloseHandle(token);
    return isRead;
}

} // namespace

bool IsElevated()
{
    TOKEN_ELEVATION elevation = {};
    return ReadToken(TokenElevation, &elevation, sizeof elevation) && elevation.TokenIsElevated;
}

bool IsSystemAccount()
{
    UserToken token = {};
    return ReadToken(TokenUser, &token, sizeof token) &&
           IsWellKnownSid(token.user.User.Sid, WinLocalSystemSid) != 0;
}

wxString AccountName()
{
    UserToken token = {};
    if (!ReadToken(TokenUser, &token, sizeof token))
        return {};

    wchar_t name[256 + 1] = {}; // the system's longest names: UNLEN, and 255 for a domain
    wchar_t domain[255 + 1] = {};
    DWORD nameSize = WXSIZEOF(name);
    DWORD domainSize = WXSIZEOF(domain);
    SID_NAME_USE kind = {};
    if (!LookupAccountSidW(nullptr, token.user.User.Sid, name, &nameSize, domain, &domainSize,
                           &kind))
        return {};
    return wxString(domain) + '\\' + name;
}

bool RefusesLinksOfOthers()
{
    PROCESS_MITIGATION_REDIRECTION_TRUST_POLICY policy = {};
    return GetProcessMitigationPolicy(GetCurrentProcess(), ProcessRedirectionTrustPolicy, &policy,
                                      sizeof policy) != 0 &&
           policy.EnforceRedirectionTrust != 0;
}
