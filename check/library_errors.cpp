#include "check/library_errors.h"

#include <wx/log.h>

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
    // From here on owned by the library. NOLINTNEXTLINE(clang-analyzer-cplusplus.NewDeleteLeaks)
    delete wxLog::SetActiveTarget(new Keeper);
}

wxString TakeLibraryErrors()
{
    wxString taken;
    taken.swap(kept);
    return taken;
}
