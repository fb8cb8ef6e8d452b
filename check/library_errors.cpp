#include "check/library_errors.h"

#include <wx/log.h>

namespace
{

wxString kept;

class Keeper : public wxLog
{
  protected:
    void DoLogTextAtLevel(wxLogLevel level, const wxString& text) override
    {
        if (level > wxLOG_Warning)
            return;
        kept += (kept.empty() ? "" : "; ") + text;
    }
};

} // namespace

void KeepLibraryErrors()
{
    wxLog::DisableTimestamp();
    delete wxLog::SetActiveTarget(new Keeper); // the library's from here on
}

wxString TakeLibraryErrors()
{
    wxString taken;
    taken.swap(kept);
    return taken;
}
