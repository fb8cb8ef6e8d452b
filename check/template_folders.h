// The two template folders as the registry has them, and what is wrong with them.
#pragma once

#include "check/report.h"

#include <wx/string.h>

class TemplateFolders
{
  public:
    explicit TemplateFolders(bool isUpgrade);

    bool IsUpgrade() const;
    /// The folder of the version being left, and that of the version being installed; empty if the
    /// registry does not name it.
    const wxString& From() const;
    const wxString& To() const;
    bool AreKnown() const;

    /// Reports what is wrong with the previous version's folder, whether or not a template moves.
    void ReportPath(Report& report) const;
    /// For a hot folder with a template, or for a preset: reports an unknown folder once. The
    /// folder moved to is needed only when a template moves.
    void ReportFrom(Report& report) const;
    void ReportTo(Report& report) const;
    /// Reports both if they are unknown, and what matters only in the text of presets.
    void ReportForPresets(Report& report) const;

  private:
    struct Folder
    {
        bool isKnown = false;
        wxString path;
        wxString value; // the registry value, for messages
    };

    static void ReportUnknown(const Folder& folder, Report& report);

    bool m_isUpgrade;
    Folder m_default;
    Folder m_previous;
};
