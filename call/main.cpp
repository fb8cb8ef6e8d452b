// FolderUpgradeRun, the one call that an installer makes: a check, a run of FolderUpgrade, a check.
// It never waits for a person, and ends when its time is over.
#include "check/check.h"
#include "platform/path_normal_form.h"
#include "platform/standard_output.h"
#include "platform/started_process.h"
#include "run/run_log.h"

#include <wx/app.h>
#include <wx/debug.h>
#include <wx/filefn.h>
#include <wx/log.h>
#include <wx/stdpaths.h>
#include <wx/textbuf.h>

#include <algorithm>
#include <cstdlib>
#include <future>
#include <thread>

namespace
{

using Clock = std::chrono::steady_clock;

// The exit status in addition to those of a check. The highest one that applies is returned.
constexpr int NoRun = 4;

constexpr unsigned long LongestLimit = 7UL * 24 * 60 * 60; // seconds; longer than any installation
constexpr const char* LastLine = "Exit status of FolderUpgradeRun: %d";

class Call
{
  public:
    Call(bool isUpgrade, unsigned long limit, const wxString& folder)
        : m_isUpgrade(isUpgrade), m_deadline(Clock::now() + std::chrono::seconds(limit)),
          m_folder(folder, Links::Refuse)
    {
    }

    int Make()
    {
        Check(m_before, NoRun);
        m_isWritten = m_before.End() && m_isWritten;
        wxFileName program(wxStandardPaths::Get().GetExecutablePath());
        program.SetName("FolderUpgrade");
        const auto run = RunProgram(program.GetFullPath(), m_isUpgrade ? "I" : "U", m_deadline);
        const bool isFinished = !run.whyNotStarted && run.exitStatus == -1; // as always
        m_after.Begin("FolderUpgrade");
        if (run.whyNotStarted)
            m_after.Problem("could not be started" + run.whyNotStarted->Reason());
        else if (!isFinished)
            m_after.Problem("crashed, or was ended before it had finished");
        RegularFile log;
        if (!run.whyNotStarted && // otherwise the log is an earlier run's
            log.OpenForReading(PinnedDirectory(RunLogDirPath(), Links::Refuse), RunLogFileName) ==
                RegularFile::Status::Open)
            m_isWritten = m_isWritten && m_log.TakeContent(log);
        if (Clock::now() >= m_deadline)
            m_after.Problem("the time is over, so the check after the run is left out");
        else
        {
            Check(m_after, isFinished ? HasProblems : NoRun);
            m_after.RepeatLosses(m_before);
        }
        const int status =
            std::max({m_after.ExitStatus(), isFinished ? 0 : NoRun, m_isWritten ? 0 : HasProblems});
        const bool isSaid = m_after.End(wxString::Format(LastLine, status));
        return std::max(status, isSaid ? 0 : HasProblems);
    }

  private:
    // A check that hangs in a call of the system cannot be ended without the process.
    void Check(Report& report, int statusAtDeadline)
    {
        std::promise<void> end;
        std::thread watchdog(
            [&]()
            {
                if (end.get_future().wait_until(m_deadline) == std::future_status::timeout)
                    GiveUp(statusAtDeadline);
            });
        try
        {
            TemplateFolders folders(m_isUpgrade);
            CheckRun(folders, report);
        }
        catch (const std::exception& exception)
        {
            report.Problem(wxString("this check was not finished: ") + exception.what());
        }
        end.set_value();
        watchdog.join();
    }

    // Opens the file again, because the other thread may be writing to the report.
    void GiveUp(int status) const
    {
        RegularFile report;
        if (report.OpenForUpdate(m_folder, m_name + "-after.txt") == RegularFile::Status::Open)
            report.Append(wxTextBuffer::Translate("The time is over. A check was not finished.\n" +
                                                  wxString::Format(LastLine, status) + "\n")
                              .utf8_string());
        std::_Exit(status);
    }

    const bool m_isUpgrade;
    const wxString m_name = m_isUpgrade ? "FolderUpgrade-upgrade" : "FolderUpgrade-downgrade";
    const Clock::time_point m_deadline;
    const PinnedDirectory m_folder;
    // All files are empty at first, so that none is an earlier call's.
    Report m_before{m_folder, m_name + "-before.txt"};
    Report m_after{m_folder, m_name + "-after.txt"};
    RegularFile m_log;
    bool m_isWritten = m_log.OpenEmpty(m_folder, m_name + ".log"); // the log, and the first report
};

} // namespace

class FolderUpgradeRunApp : public wxAppConsole
{
  public:
    // The base class would parse the command line itself.
    bool OnInit() override
    {
        return true;
    }

    int OnRun() override
    {
        const wxLogNull noMessages;
        wxDisableAsserts();
        const bool isUpgrade = argc > 1 && argv[1].CmpNoCase("I") == 0;
        const bool isDowngrade = argc > 1 && argv[1].CmpNoCase("U") == 0;
        unsigned long limit = 60UL * 60; // seconds
        const bool hasLimit = argc > 3 && argv[2] == "--limit" && argv[3].ToULong(&limit);
        const int next = hasLimit ? 4 : 2; // the position of FOLDER
        if ((!isUpgrade && !isDowngrade) || limit < 1 || limit > LongestLimit || argc > next + 1 ||
            (argc > next && argv[next].StartsWith("-")))
        {
            WriteTo(StandardStream::Error,
                    "Usage: FolderUpgradeRun I|U [--limit SECONDS] [FOLDER]\n"
                    "Runs FolderUpgrade with the same switch, between two checks.\n"
                    "Exit status: 0 everything is as it should be, 1 changes are left, "
                    "2 problems, 3 wrong arguments, 4 FolderUpgrade did not start, crashed or "
                    "was ended.\n");
            return WrongArguments;
        }
        const wxString logFolder = RunLogDirPath();
        wxMkdir(WithoutFinalSeparators(logFolder)); // leaves a link as it is
        return Call(isUpgrade, limit, argc > next ? argv[next] : logFolder).Make();
    }

    // The base class would show a message box.
    void OnUnhandledException() override
    {
    }
};

wxIMPLEMENT_APP_CONSOLE(FolderUpgradeRunApp);
