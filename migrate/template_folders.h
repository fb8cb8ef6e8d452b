// The template folder of the version being left and that of the version being installed.
#pragma once

#include "migrate/install_locations.h"

#include <wx/string.h>

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
    explicit TemplateFolders(bool isUpgrade);
    /// With these folders in place of what the registry leads to, unless they are empty.
    TemplateFolders(bool isUpgrade, const wxString& from, const wxString& to);

    bool IsUpgrade() const;
    /// Whether either folder was given.
    bool IsRehearsal() const;
    /// The folders of the version being left and of the version being installed.
    const TemplateFolder& From();
    const TemplateFolder& To();
    /// The same two: that of the previous version, and the default folder of the installed one.
    const TemplateFolder& Previous();
    const TemplateFolder& Default();

  private:
    const bool m_isUpgrade;
    bool m_isRehearsal = false;
    std::optional<TemplateFolder> m_previous;
    std::optional<TemplateFolder> m_default;
};
