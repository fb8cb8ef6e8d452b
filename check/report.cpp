#include "check/report.h"

#include "platform/standard_output.h"
#include "platform/unicode_text.h"

#include <wx/textbuf.h>

namespace
{

wxString Count(int number, const wxString& what)
{
    return wxString::Format("%d %s%s", number, what, number == 1 ? "" : "s");
}

} // namespace

Report::Report(const wxString& fileName) : m_toFile(!fileName.empty())
{
    if (m_toFile)
        m_isWritten = m_file.Open(fileName, "wb");
}

void Report::Head(const wxString& text)
{
    Write(text);
}

void Report::Begin(const wxString& title)
{
    m_title = title;
}

void Report::Change(const wxString& text)
{
    ++m_changes;
    Line("  change   " + text);
}

void Report::Problem(const wxString& text)
{
    ++m_problems;
    Line("  problem  " + text);
}

void Report::Note(const wxString& text)
{
    ++m_notes;
    Line("  note     " + text);
}

void Report::ProblemOnce(const wxString& text)
{
    if (m_once.insert(text).second)
        Problem(text);
}

bool Report::End()
{
    Write("");
    Write(Count(m_changes, "change") + ", " + Count(m_problems, "problem") + ", " +
          Count(m_notes, "note"));
    return (!m_toFile || !m_file.IsOpened() || m_file.Close()) && m_isWritten;
}

int Report::GetChanges() const
{
    return m_changes;
}

int Report::GetProblems() const
{
    return m_problems;
}

void Report::Line(const wxString& text)
{
    if (!m_title.empty())
    {
        Write("");
        Write(m_title);
        m_title.clear();
    }
    Write(text);
}

void Report::Write(const wxString& text)
{
    const wxString line = ToOneLine(text) + wxTextBuffer::GetEOL();
    if (!m_toFile)
        m_isWritten = WriteStandardOutput(line) && m_isWritten;
    else if (m_isWritten)
        m_isWritten = m_file.Write(line, wxConvUTF8);
}
