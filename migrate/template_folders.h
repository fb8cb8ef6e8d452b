// The template folder of the version being left and that of the version being installed.
#pragma once

#include "migrate/install_locations.h"

#include <optional>

struct TemplateFolder
{
    bool isKnown = false;
    wxString path; // as wxFileName::GetFullPath renders it; empty if it is not known
    ValueSource source;
};

/// Both folders, each looked up in the registry when it is first asked for.
class TemplateFolders
{
  public:
    /// With these folders in place of what the registry leads to, unless they are empty.
    explicit TemplateFolders(bool itIsUpgrade, const wxString& from = {}, const wxString& to = {});

    /// The folders of the version being left and of the version being installed.
    const TemplateFolder& From();
    const TemplateFolder& To();
    /// The same two: that of the previous version, and the default folder of the installed one.
    const TemplateFolder& Previous();
    const TemplateFolder& Default();

    const bool isUpgrade;
    const bool isRehearsal; // whether either folder was given

  private:
    std::optional<TemplateFolder> m_previous;
    std::optional<TemplateFolder> m_default;
};
