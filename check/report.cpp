#include "check/report.h"

#include "platform/standard_output.h"
#include "platform/unicode_text.h"

#include <wx/filename.h>
#include <wx/textbuf.h>

namespace
{

constexpr size_t MostOfAKind = 20;

wxString Count(size_t number, const wxString& what)
{
    return wxString::Format("%zu %s%s", number, what, number == 1 ? "" : "s");
}

} // namespace

wxString Shown(const wxString& text)
{
    constexpr size_t Longest = 300;
    return text.length() <= Longest ? text : text.Left(Longest) + "...";
}

Report::Report(const wxString& fileName) : m_toFile(!fileName.empty())
{
    if (!m_toFile)
        return;
    wxFileName path(fileName);
    path.MakeAbsolute();
    const PinnedDirectory directory(path.GetPath(wxPATH_GET_VOLUME | wxPATH_GET_SEPARATOR),
                                    Links::Follow);
    m_isWritten = m_file.OpenEmpty(directory, path.GetFullName());
}

Report::Report(const PinnedDirectory& directory, const wxString& name)
    : m_toFile(true), m_isWritten(m_file.OpenEmpty(directory, name))
{
}

void Report::Begin(const wxString& title)
{
    EndBlock();
    m_title = Shown(title);
}

void Report::Problem(const wxString& text)
{
    Add(ProblemKind, text);
}

void Report::Change(const wxString& text)
{
    Add(ChangeKind, text);
}

void Report::Note(const wxString& text)
{
    Add(NoteKind, text);
}

void Report::Add(const wxString& prefix, const Findings& findings)
{
    AddSome(ProblemKind, prefix, findings.problems);
    AddSome(ChangeKind, prefix, findings.changes);
    AddSome(NoteKind, prefix, findings.notes);
}

void Report::AddLosses(const wxString& prefix, const std::vector<wxString>& losses)
{
    AddSome(ProblemKind, prefix, losses);
    for (size_t i = 0; i < losses.size() && i < MostOfAKind; ++i)
        m_losses.insert(m_title + ": " + prefix + losses[i]);
}

void Report::RepeatLosses(const Report& before)
{
    Begin("Lost or reset by the run");
    for (const wxString& loss : before.m_losses)
    {
        if (m_losses.count(loss) == 0)
            Problem(loss);
    }
}

void Report::ProblemOnce(const wxString& text)
{
    if (m_once.insert(text).second)
        Problem(text);
}

void Report::NoteOnce(const wxString& text)
{
    if (m_once.insert(text).second)
        Note(text);
}

bool Report::End(const wxString& lastLine)
{
    EndBlock();
    Write("");
    Write(Count(m_counts[ChangeKind], "change") + ", " + Count(m_counts[ProblemKind], "problem") +
          ", " + Count(m_counts[NoteKind], "note"));
    if (!lastLine.empty())
        Write(lastLine);
    return m_isWritten;
}

int Report::ExitStatus() const
{
    if (m_counts[ProblemKind] > 0)
        return HasProblems;
    return m_counts[ChangeKind] > 0 ? HasChanges : NothingToDo;
}

void Report::Add(Kind kind, const wxString& text)
{
    static const std::array<const char*, KindCount> beginnings = {"  problem  ", "  change   ",
                                                                  "  note     "};
    m_block[kind].Add(beginnings[kind] + text);
    ++m_counts[kind];
}

void Report::AddSome(Kind kind, const wxString& prefix, const std::vector<wxString>& texts)
{
    for (size_t i = 0; i < texts.size() && i < MostOfAKind; ++i)
        Add(kind, prefix + texts[i]);
    if (texts.size() > MostOfAKind)
        Add(kind, prefix + wxString::Format("and %zu more", texts.size() - MostOfAKind));
}

void Report::EndBlock()
{
    bool isTitled = false;
    for (wxArrayString& lines : m_block)
    {
        if (!lines.empty() && !isTitled)
        {
            Write("");
            Write(m_title);
            isTitled = true;
        }
        for (const wxString& line : lines)
            Write(line);
        lines.clear();
    }
}

void Report::Write(const wxString& text)
{
    const wxString line = ToOneLine(text) + wxTextBuffer::GetEOL();
    if (!m_toFile)
        m_isWritten = WriteTo(StandardStream::Output, line) && m_isWritten;
    else if (m_isWritten)
        m_isWritten = m_file.Append(line.utf8_string());
}
