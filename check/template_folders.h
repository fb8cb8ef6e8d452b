// The two template folders as the registry has them, and what is wrong with them.
#pragma once

#include "check/report.h"

#include <wx/string.h>

class TemplateFolders
{
  public:
    explicit TemplateFolders(bool isUpgrade);

    bool IsUpgrade() const;
    /// The folder of the version being left, and that of the version being installed; empty for one
    /// that the registry does not name.
    const wxString& From() const;
    const wxString& To() const;
    bool AreKnown() const;

    /// What is wrong with the previous version's folder, whoever asks for it.
    void ReportPath(Report& report) const;
    /// For a hot folder with a template, or a preset: reports once a folder that is not known. One
    /// that is asked for only when a template is about to move need not be needed.
    void ReportFrom(Report& report) const;
    void ReportTo(Report& report) const;
    /// Both, and what matters in the text of presets only.
    void ReportForPresets(Report& report) const;

  private:
    struct Folder
    {
        bool isKnown = false;
        wxString path;
        wxString value; // the registry value, for people
    };

    static void ReportUnknown(const Folder& folder, Report& report);

    bool m_isUpgrade;
    Folder m_default;
    Folder m_previous;
};
