// A program that is started and waited for; one source for each system.
#pragma once

#include "platform/regular_file.h"

#include <chrono>
#include <optional>

struct ProgramRun
{
    std::optional<FailedCall> whyNotStarted;
    int exitStatus = 0; // from -128 to 127 on every system; not negative if the program was ended
};

/// Starts the program, without a shell and with the one argument, a word of letters; on Windows
/// also with several, as they are in a command line. It gets no handle of this process, and no
/// standard streams. Waits until it ends; at the deadline ends it, and waits for that for at most
/// five seconds. On Windows nobody has to press a button meanwhile: each visible top-level window
/// of the program is asked to close (WM_CLOSE), and the system shows no box of its own if the
/// program crashes.
ProgramRun RunProgram(const wxString& path, const wxString& argument,
                      std::chrono::steady_clock::time_point deadline);
