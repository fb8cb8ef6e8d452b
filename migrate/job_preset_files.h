// The files of the current user's job presets.
#pragma once

#include "platform/regular_file.h"

#include <wx/arrstr.h>
#include <wx/string.h>

/// The directory of the job preset directories: ORX/JPData in the per-user application data folder,
/// with a final separator.
wxString JobPresetRoot();

/// Appends the full paths of the root's direct sub-directories, hidden ones too, in the order of
/// the listing. False when the root is no directory. The library reports one that cannot be listed.
bool ListJobPresetDirs(const wxString& root, wxArrayString& directories);

/// One job preset's file. The job preset directory and those above it may be links (redirected
/// profiles); the directory Presets in it and the file itself may not.
class JobPresetFile
{
  public:
    explicit JobPresetFile(const wxString& directory);

    /// For people.
    const wxString& GetPath() const;

    /// Whether there is anything of that name, be it a link or a directory. A linked directory
    /// Presets counts as if there were: what it leads to is not asked.
    bool IsThere() const;

    /// Refused for anything but a regular file, too. The library reports a regular file that does
    /// not open.
    RegularFile::Status OpenForReading();
    /// Likewise.
    RegularFile::Status ReopenForUpdate();

    /// The file, once it is open.
    RegularFile& GetFile();

  private:
    const wxString m_path;
    const PinnedDirectory m_directory;
    const PinnedDirectory m_presets;
    const bool m_isLinked;
    RegularFile m_file;
};
