// The report of a check: what a run would change, what stands in its way, and what is worth
// knowing.
#pragma once

#include <wx/ffile.h>
#include <wx/string.h>

#include <set>

class Report
{
  public:
    /// Writes to the file, or for an empty name to the standard output, as it comes.
    explicit Report(const wxString& fileName);

    /// A line of the head, before any block.
    void Head(const wxString& text);

    /// The lines that follow are about this. The title is written with the first of them.
    void Begin(const wxString& title);

    void Change(const wxString& text);
    void Problem(const wxString& text);
    void Note(const wxString& text);
    /// One that concerns many blocks: written with the first of them.
    void ProblemOnce(const wxString& text);

    /// Writes the sums. False when anything could not be written.
    bool End();

    int GetChanges() const;
    int GetProblems() const;

  private:
    void Line(const wxString& text);
    void Write(const wxString& text);

    wxFFile m_file;
    const bool m_toFile;
    bool m_isWritten = true;
    wxString m_title;
    std::set<wxString> m_once;
    int m_changes = 0;
    int m_problems = 0;
    int m_notes = 0;
};
