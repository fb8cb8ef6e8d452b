// FolderUpgradeCheck: writes the report of a check.
#include "check/check.h"
#include "platform/standard_output.h"

#include <wx/app.h>
#include <wx/debug.h>

namespace
{

constexpr int WrongCall = 3;

int Check(bool isUpgrade, const wxString& fileName)
{
    Report report(fileName);
    CheckRun(isUpgrade, report);
    if (!report.End())
        WriteStandardError("FolderUpgradeCheck: the report cannot be written to " +
                           (fileName.empty() ? wxString("the standard output") : fileName) + "\n");
    return report.GetStatus();
}

} // namespace

class FolderUpgradeCheckApp : public wxAppConsole
{
  public:
    // The base class would parse the command line itself.
    bool OnInit() override
    {
        return true;
    }

    int OnRun() override
    {
        wxDisableAsserts();
        const bool isUpgrade = argc > 1 && argv[1].CmpNoCase("I") == 0;
        const bool isDowngrade = argc > 1 && argv[1].CmpNoCase("U") == 0;
        if ((isUpgrade || isDowngrade) && argc <= 3)
            return Check(isUpgrade, argc == 3 ? argv[2] : wxString());
        WriteStandardError(
            "Usage: FolderUpgradeCheck I|U [FILE]\n"
            "Reports what FolderUpgrade would change with the same switch, and what "
            "would prevent a change, to the standard output or to FILE.\n"
            "Exit status: 0 nothing to do, 1 changes, 2 problems, 3 wrong arguments.\n");
        return WrongCall;
    }
};

wxIMPLEMENT_APP_CONSOLE(FolderUpgradeCheckApp);
