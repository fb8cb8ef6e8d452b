// The report of a check: what a run would change, what stands in its way, and what is worth
// knowing.
#pragma once

#include <wx/arrstr.h>
#include <wx/ffile.h>
#include <wx/string.h>

#include <array>
#include <set>

class Report
{
  public:
    /// Writes to the file, or for an empty name to the standard output.
    explicit Report(const wxString& fileName);

    /// A line of the head, before any block.
    void Head(const wxString& text);

    /// The lines that follow are about this. A block without lines is left out; of others the
    /// problems are written first, and the notes last.
    void Begin(const wxString& title);

    void Problem(const wxString& text);
    void Change(const wxString& text);
    void Note(const wxString& text);
    /// One that concerns many blocks: written with the first of them.
    void ProblemOnce(const wxString& text);

    /// Writes the sums. False when anything could not be written.
    bool End();

    size_t GetProblems() const;
    size_t GetChanges() const;

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

    wxFFile m_file;
    const bool m_toFile;
    bool m_isWritten = true;
    wxString m_title;
    std::array<wxArrayString, KindCount> m_block;
    std::array<size_t, KindCount> m_counts = {};
    std::set<wxString> m_once;
};
