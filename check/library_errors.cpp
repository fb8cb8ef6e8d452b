#include "check/library_errors.h"

#include <wx/log.h>

#include <memory>

namespace
{

wxString kept;

class Keeper : public wxLog
{
  protected:
    // The library's own text, without the word "Error" and the time.
    void DoLogRecord(wxLogLevel level, const wxString& text,
                     const wxLogRecordInfo& /*info*/) override
    {
        if (level > wxLOG_Warning)
            return;
        kept += (kept.empty() ? "" : "; ") + text;
    }
};

} // namespace

void KeepLibraryErrors()
{
    delete wxLog::SetActiveTarget(
        std::make_unique<Keeper>().release()); // from here on owned by the library
}

wxString TakeLibraryErrors()
{
    wxString taken;
    taken.swap(kept);
    return taken;
}
