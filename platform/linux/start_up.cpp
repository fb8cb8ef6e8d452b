#include "platform/linux/start_up.h"

#include <wx/strconv.h>

#include <clocale>
#include <csignal>

StartUp::StartUp()
{
    // If the system lacks this locale, the handling of names that are not ASCII does not change.
    static_cast<void>(std::setlocale(LC_CTYPE, "C.UTF-8"));
    wxConvLocal = wxCSConv(wxFONTENCODING_UTF8); // which the library uses to read the command line
    static_cast<void>(std::signal(SIGXFSZ, SIG_IGN));
    static_cast<void>(std::signal(SIGPIPE, SIG_IGN));
}
