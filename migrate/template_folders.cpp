#include "migrate/template_folders.h"

#include "platform/path_normal_form.h"

namespace
{

TemplateFolder LookUp(bool (*lookUp)(wxFileName&, ValueSource&))
{
    wxFileName folder;
    TemplateFolder found;
    found.isKnown = lookUp(folder, found.source);
    found.path = folder.GetFullPath(wxPATH_NATIVE);
    return found;
}

TemplateFolder Given(const wxString& path, const wxString& option)
{
    wxFileName folder(WithoutFinalSeparators(path));
    folder.MakeAbsolute();
    return {true, folder.GetFullPath(wxPATH_NATIVE), {option, {}}};
}

} // namespace

TemplateFolders::TemplateFolders(bool itIsUpgrade, const wxString& from, const wxString& to)
    : isUpgrade(itIsUpgrade), isRehearsal(!from.empty() || !to.empty())
{
    if (!from.empty())
        (isUpgrade ? m_previous : m_default) = Given(from, "--from");
    if (!to.empty())
        (isUpgrade ? m_default : m_previous) = Given(to, "--to");
}

const TemplateFolder& TemplateFolders::From()
{
    return isUpgrade ? Previous() : Default();
}

const TemplateFolder& TemplateFolders::To()
{
    return isUpgrade ? Default() : Previous();
}

const TemplateFolder& TemplateFolders::Previous()
{
    if (!m_previous)
        m_previous = LookUp(GetPreviousImposeTemplatePath);
    return *m_previous;
}

const TemplateFolder& TemplateFolders::Default()
{
    if (!m_default)
        m_default = LookUp(GetDefaultImposeTemplatePath);
    return *m_default;
}
