// The run log, line by line. A single test, because the log of a process has only one first line.
#include "run/run_log.h"
#include "tests/text_files.h"

#include <gtest/gtest.h>
#include <wx/log.h>

#include <csignal>
#include <cstdlib>
#include <filesystem>
#include <sstream>
#include <sys/resource.h>

TEST(RunLogFile, EveryEntryIsOneLineAtTheEndOfTheFile)
{
    namespace fs = std::filesystem;
    std::string folder = (fs::temp_directory_path() / "log XXXXXX").string();
    ASSERT_NE(nullptr, mkdtemp(folder.data()));
    ASSERT_EQ(0, setenv("XDG_CONFIG_HOME", folder.c_str(), 1));
    const fs::path log = fs::path(folder) / "ORX_Installers" / "UpgradeDowngrade.log";
    WriteFile(log, "\xEF\xBB\xBFthe log of an earlier run\r\n");

    RunLog("100 %s");
    EXPECT_EQ("100 %s\r\n", ReadFile(log));
    RunLog("%d", 0);
    RunLog("ä", -2);
    RunLog(L"a\r\nb");
    EXPECT_EQ("100 %s\r\n%d count:  0\r\nä count:  -2\r\na\uFFFD\uFFFDb\r\n", ReadFile(log));

    fs::remove(log);
    RunLog("deleted");
    EXPECT_FALSE(fs::exists(log));
    WriteFile(log, "another's\r\n");
    RunLog("added", 1);
    EXPECT_EQ("another's\r\nadded count:  1\r\n", ReadFile(log));

    std::signal(SIGXFSZ, SIG_IGN);
    rlimit unlimited = {};
    getrlimit(RLIMIT_FSIZE, &unlimited);
    const rlimit full = {40, unlimited.rlim_max};
    std::ostringstream errors;
    wxLogStream stream(&errors);
    wxLog* const target = wxLog::SetActiveTarget(&stream);
    setrlimit(RLIMIT_FSIZE, &full);
    RunLog("not added, because the file is as long as it may be");
    RunLog("not added either, and not reported again");
    setrlimit(RLIMIT_FSIZE, &unlimited);
    EXPECT_EQ("another's\r\nadded count:  1\r\n", ReadFile(log));
    wxLog::SetActiveTarget(target);
    std::signal(SIGXFSZ, SIG_DFL);
    EXPECT_EQ(1, wxString(errors.str()).Freq('\n')) << errors.str();
    fs::remove_all(folder);
}
