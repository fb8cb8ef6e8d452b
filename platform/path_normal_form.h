// The forms of paths.
#pragma once

#include <wx/filename.h>

/// What wxFileName::Normalize does by default (wxPATH_NORM_ALL, which the library calls
/// deprecated): variables expanded, dots and a leading tilde resolved, made absolute, short names
/// made long, shortcuts followed. Letter case stays.
constexpr int NormalizeAll = wxPATH_NORM_ENV_VARS | wxPATH_NORM_DOTS | wxPATH_NORM_TILDE |
                             wxPATH_NORM_ABSOLUTE | wxPATH_NORM_LONG | wxPATH_NORM_SHORTCUT;

/// The path without the separators at its end; empty for a path of separators alone.
wxString WithoutFinalSeparators(wxString path);
