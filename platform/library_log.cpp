#include "platform/library_log.h"

#include "platform/unicode_text.h"

#include <wx/log.h>

void ReportError(const wxString& message)
{
    wxLogError("%s", ToOneLine(message));
}
