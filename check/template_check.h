// Whether jobs will find the templates that are stored.
#pragma once

#include "check/report.h"
#include "migrate/template_folders.h"

/// The two template folders and the report, for all parts of a check.
struct TemplateCheck
{
    /// Reports what is wrong with the previous version's folder, whether or not a template moves.
    void CheckPreviousFolder();
    /// Reports once that a folder that is needed is unknown.
    void CheckIsKnown(const TemplateFolder& folder);
    /// Reports once that either folder is unknown, and what matters only in the text of presets.
    void CheckForPresets();

    /// Judges a path as a run leaves it: whether it still leads into the folder being left, and
    /// whether anything is there. No server is asked, and no link followed.
    void Judge(const wxString& path, const wxString& whyItStays, Findings& findings);
    /// Reports how many templates the missing folder has to hold.
    void ReportAwaited();

    TemplateFolders& folders;
    Report& report;
    size_t awaited = 0; // templates in the folder being installed, which is not there
};
