#include "migrate/template_folders.h"

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

} // namespace

TemplateFolders::TemplateFolders(bool isUpgrade) : m_isUpgrade(isUpgrade)
{
}

bool TemplateFolders::IsUpgrade() const
{
    return m_isUpgrade;
}

const TemplateFolder& TemplateFolders::From()
{
    return m_isUpgrade ? Previous() : Default();
}

const TemplateFolder& TemplateFolders::To()
{
    return m_isUpgrade ? Default() : Previous();
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
