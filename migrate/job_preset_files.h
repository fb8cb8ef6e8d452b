// The files of the current user's job presets.
#pragma once

#include "migrate/preset_text.h"
#include "platform/regular_file.h"

#include <wx/arrstr.h>

/// ORX/JPData in the per-user application data folder, with a final separator.
wxString JobPresetRoot();

struct JobPresetDirs
{
    bool isThere = false;
    std::optional<FailedCall> failure; // if it is there, but cannot be listed
    wxArrayString paths;
};

/// The full paths of the root's direct sub-directories, hidden ones too, in the listed order.
JobPresetDirs ListJobPresetDirs(const wxString& root);

/// One job preset's file. The job preset directory and those above it may be links (redirected
/// profiles); the directory Presets in it and the file itself may not.
struct JobPresetFile
{
    explicit JobPresetFile(const wxString& itsDirectory);

    /// Whether anything of that name exists, even a link or a directory. True if the directory
    /// Presets is a link: its target is not accessed.
    bool IsThere() const;

    /// NotThere for anything but a regular file.
    RegularFile::Status OpenForReading();

    /// What becomes of the file, once it is open. It has to be opened for update as well if it is
    /// to be written.
    RewrittenPreset Decide(const wxString& from, const wxString& to);

    const wxString path; // for messages
    const PinnedDirectory directory;
    const PinnedDirectory presetDir; // Presets
    const bool isLinked;             // whether that is a link
    RegularFile file;
};
