// The files of the current user's job presets.
#pragma once

#include "platform/regular_file.h"

#include <wx/arrstr.h>
#include <wx/string.h>

/// The directory of the job preset directories: ORX/JPData in the per-user application data folder,
/// with a final separator.
wxString JobPresetRoot();

/// Appends the full paths of the root's direct sub-directories, hidden ones too, in the order of
/// the listing. Returns false if the root is not a directory. The library reports an error if it
/// cannot be listed.
bool ListJobPresetDirs(const wxString& root, wxArrayString& directories);

/// One job preset's file. The job preset directory and those above it may be links (redirected
/// profiles); the directory Presets in it and the file itself may not.
class JobPresetFile
{
  public:
    explicit JobPresetFile(const wxString& directory);

    /// For messages.
    const wxString& GetPath() const;

    /// Whether anything of that name exists, even a link or a directory. True if the directory
    /// Presets is a link: its target is not accessed.
    bool IsThere() const;

    /// NotThere for anything but a regular file. The library reports an error if a regular file
    /// does not open.
    RegularFile::Status OpenForReading();

    /// The file, once it is open.
    RegularFile& GetFile();

  private:
    const wxString m_path;
    const PinnedDirectory m_directory;
    const PinnedDirectory m_presets;
    const bool m_isLinked;
    RegularFile m_file;
};
