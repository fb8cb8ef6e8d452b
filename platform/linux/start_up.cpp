// What has to be set up before the library starts.
#include <wx/strconv.h>

#include <clocale>
#include <csignal>

namespace
{

struct StartUp
{
    StartUp()
    {
        // File names are UTF-8 whatever the environment says. The library sets no locale for a
        // console application, and in the "C" locale it loses names that are not ASCII, including
        // those of the standard folders and the executable. A system without this locale loses
        // them.
        static_cast<void>(std::setlocale(LC_CTYPE, "C.UTF-8"));
        wxConvLocal = wxCSConv(wxFONTENCODING_UTF8); // with which the command line is read
        // The system would end the process instead of letting a write fail: at the longest file
        // that it permits, and to a pipe that nobody reads.
        static_cast<void>(std::signal(SIGXFSZ, SIG_IGN));
        static_cast<void>(std::signal(SIGPIPE, SIG_IGN));
    }
};

} // namespace

// See platform/CMakeLists.txt.
extern "C"
{
    extern const StartUp StartUpOfProgram;
    const StartUp StartUpOfProgram;
}
