// Whether jobs will find the templates that are stored.
#pragma once

#include "check/report.h"
#include "migrate/template_folders.h"

#include <wx/string.h>

class TemplateCheck
{
  public:
    explicit TemplateCheck(TemplateFolders& folders);

    /// Judges a path as a run leaves it: whether it still leads into the folder being left, and
    /// whether anything is there. No server is asked, and no link followed.
    void Judge(const wxString& path, const wxString& whyItStays, Findings& findings);

    /// The number of templates in the folder being installed, if it is not there as a whole.
    size_t GetAwaited() const;

  private:
    TemplateFolders& m_folders;
    size_t m_awaited = 0;
};

/// Whether the path is in the folder, at any depth, in any letter case and with any separators that
/// the system takes for the same. Only names are compared.
bool IsIn(const wxString& path, const wxString& folder);
