// FolderUpgradeCheck: writes the report of a check.
#include "check/check.h"
#include "platform/standard_output.h"

#include <wx/app.h>
#include <wx/debug.h>

namespace
{

const char* const Usage =
    "Usage: FolderUpgradeCheck I|U [--from FOLDER] [--to FOLDER] [FILE]\n"
    "Reports what FolderUpgrade would change with the same switch, and what would prevent a change "
    "or leave a job without its template, to the standard output or to FILE.\n"
    "--from and --to name template folders in place of those that the registry names, to rehearse "
    "an installation.\n"
    "Exit status: 0 nothing to do, and every template is there; 1 changes; 2 problems; 3 wrong "
    "arguments.\n";

struct Options
{
    bool isUpgrade = false;
    wxString from;
    wxString to;
    wxString file;
};

// Returns false for wrong arguments.
bool ReadOptions(const wxArrayString& arguments, Options& options)
{
    options.isUpgrade = !arguments.empty() && arguments[0].CmpNoCase("I") == 0;
    if (!options.isUpgrade && (arguments.empty() || arguments[0].CmpNoCase("U") != 0))
        return false;
    for (size_t i = 1; i < arguments.size(); ++i)
    {
        const bool isFrom = arguments[i] == "--from";
        const bool isFolder = isFrom || arguments[i] == "--to";
        wxString& value = isFrom ? options.from : isFolder ? options.to : options.file;
        if (!value.empty() || (isFolder && ++i == arguments.size()) || arguments[i].empty() ||
            arguments[i].StartsWith("-"))
            return false;
        value = arguments[i];
    }
    return true;
}

int Check(const Options& options)
{
    Report report(options.file);
    TemplateFolders folders(options.isUpgrade, options.from, options.to);
    CheckRun(folders, report);
    if (report.End())
        return report.ExitStatus();
    WriteTo(StandardStream::Error,
            "FolderUpgradeCheck: the report cannot be written to " +
                (options.file.empty() ? wxString("the standard output") : options.file) + "\n");
    return HasProblems;
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
        wxArrayString arguments = argv.GetArguments();
        arguments.RemoveAt(0);
        const wxString first = arguments.empty() ? wxString() : arguments[0];
        Options options;
        if (first == "--help" || first == "-h" || first == "/?")
            return WriteTo(StandardStream::Output, Usage) ? NothingToDo : HasProblems;
        if (first == "--version")
            return WriteTo(StandardStream::Output, "FolderUpgradeCheck " PROGRAM_VERSION "\n")
                       ? NothingToDo
                       : HasProblems;
        if (ReadOptions(arguments, options))
            return Check(options);
        WriteTo(StandardStream::Error, Usage);
        return WrongArguments;
    }
};

wxIMPLEMENT_APP_CONSOLE(FolderUpgradeCheckApp);
