// The report of a check: what a run would change, what would prevent it, and what is worth knowing.
#pragma once

#include "platform/regular_file.h"

#include <wx/arrstr.h>

#include <array>
#include <new>
#include <set>
#include <vector>

/// The exit statuses of a check. The highest one that applies is returned.
constexpr int NothingToDo = 0;
constexpr int HasChanges = 1;
constexpr int HasProblems = 2;
constexpr int WrongArguments = 3;

/// As much of a text as is readable in one line.
wxString Shown(const wxString& text);

/// Findings of the same kind, of which a report shows only some.
struct Findings
{
    std::vector<wxString> problems;
    std::vector<wxString> changes;
    std::vector<wxString> notes;
};

class Report
{
  public:
    /// Writes to the file, never through a link, or to the standard output if the name is empty.
    explicit Report(const wxString& fileName);
    Report(const PinnedDirectory& directory, const wxString& name);

    /// Writes a line at once. The head comes before all blocks.
    void Write(const wxString& text);

    /// Begins a block about this subject. A block without lines is left out; in others, the
    /// problems are written first and the notes last.
    void Begin(const wxString& title);

    void Problem(const wxString& text);
    void Change(const wxString& text);
    void Note(const wxString& text);
    /// The first 20 of each kind, each after the prefix, and how many more there are.
    void Add(const wxString& prefix, const Findings& findings);
    /// Problems that a run hides: it loses or resets what a later check can no longer see.
    void AddLosses(const wxString& prefix, const std::vector<wxString>& losses);
    /// A block with the losses of a check before the run that this one does not have.
    void RepeatLosses(const Report& before);
    /// What concerns many blocks: written only with the first of them.
    void ProblemOnce(const wxString& text);
    void NoteOnce(const wxString& text);

    /// Takes a step of the check; if there is no memory for it, reports that after the prefix.
    template <typename Step>
    void Attempt(const wxString& prefix, Step step)
    {
        try
        {
            step();
        }
        catch (const std::bad_alloc&)
        {
            Problem(prefix + "cannot be checked (out of memory)");
        }
    }

    /// Writes the totals, then the last line unless it is empty. Returns false if anything could
    /// not be written.
    bool End(const wxString& lastLine = wxString());

    int ExitStatus() const;

  private:
    enum Kind
    {
        ProblemKind,
        ChangeKind,
        NoteKind,
        KindCount
    };

    void Add(Kind kind, const wxString& text);
    void AddSome(Kind kind, const wxString& prefix, const std::vector<wxString>& texts);
    void EndBlock();

    RegularFile m_file;
    const bool m_toFile;
    bool m_isWritten = true;
    wxString m_title;
    std::array<wxArrayString, KindCount> m_block;
    std::array<size_t, KindCount> m_counts = {};
    std::set<wxString> m_once;
    std::set<wxString> m_losses; // each after the title of its block
};
