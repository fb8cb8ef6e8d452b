// The report of a check: what a run would change, what would prevent a change, and what is worth
// knowing.
#pragma once

#include "platform/regular_file.h"

#include <wx/arrstr.h>
#include <wx/string.h>

#include <array>
#include <set>

/// What a report says in all. The highest that applies is the exit status of the check.
namespace ReportStatus
{
constexpr int NothingToDo = 0;
constexpr int HasChanges = 1;
constexpr int HasProblems = 2; // or could not be written
} // namespace ReportStatus

/// As much of a text as is readable in one line.
wxString Shown(const wxString& text);

class Report
{
  public:
    /// Writes to the file, or to the standard output if the name is empty. A link or a pipe in
    /// place of the file is not written to.
    explicit Report(const wxString& fileName);
    Report(const PinnedDirectory& directory, const wxString& name);

    /// Writes a line of the head, which comes before all blocks.
    void Head(const wxString& text);

    /// Begins a block about this subject. A block without lines is left out; in others, the
    /// problems are written first and the notes last.
    void Begin(const wxString& title);

    void Problem(const wxString& text);
    /// A problem that a run hides: it loses or resets what a later check can no longer see.
    void Loss(const wxString& text);
    void Change(const wxString& text);
    void Note(const wxString& text);
    /// A block with the losses in the report of a check before the run that this one no longer
    /// sees.
    void RepeatLosses(const Report& before);
    /// A problem that concerns many blocks: written only with the first of them.
    void ProblemOnce(const wxString& text);

    /// Writes the totals, then the last line unless it is empty. Returns false if anything could
    /// not be written.
    bool End(const wxString& lastLine = wxString());

    int GetStatus() const;

  private:
    enum Kind
    {
        Problems,
        Changes,
        Notes,
        KindCount
    };

    void Add(Kind kind, const wxString& text);
    void EndBlock();
    void Write(const wxString& text);

    RegularFile m_file;
    const bool m_toFile;
    bool m_isWritten = true;
    wxString m_title;
    std::array<wxArrayString, KindCount> m_block;
    std::array<size_t, KindCount> m_counts = {};
    std::set<wxString> m_once;
    std::set<wxString> m_losses; // each after the title of its block
};
