#include "store/xml_tree.h"

namespace
{

const char* const WhiteSpace = " \t\r\n";

bool IsText(const wxXmlNode& node)
{
    return node.GetType() == wxXML_TEXT_NODE;
}

bool IsBlankText(const wxXmlNode& node)
{
    return IsText(node) && node.GetContent().find_first_not_of(WhiteSpace) == wxString::npos;
}

wxString WithoutEmptyLines(const wxString& text)
{
    return text.Mid(text.rfind('\n', text.find_first_not_of(WhiteSpace)) + 1);
}

void RemoveIndentation(wxXmlNode& text, int level)
{
    // Checked first, because making the indentation of many levels would take long.
    const size_t length = 1 + 2 * static_cast<size_t>(level);
    const wxString& content = text.GetContent();
    if (content.length() >= length && content.EndsWith("\n" + wxString(' ', length - 1)))
        text.SetContent(content.Left(content.length() - length));
}

// The library would look for the last attribute each time it adds one.
void CopyAttributes(const wxXmlNode& source, wxXmlNode& target)
{
    wxXmlAttribute* last = nullptr;
    for (const wxXmlAttribute* attribute = source.GetAttributes(); attribute;
         attribute = attribute->GetNext())
    {
        // The node owns its first attribute, and each attribute the next.
        auto* copy = new wxXmlAttribute(attribute->GetName(), attribute->GetValue());
        if (last)
            last->SetNext(copy);
        else
            target.SetAttributes(copy);
        last = copy;
    }
}

} // namespace

void CopyTree(const wxXmlNode& source, wxXmlNode& target, int level)
{
    target.SetType(source.GetType());
    target.SetName(source.GetName());
    target.SetContent(IsText(source) ? WithoutEmptyLines(source.GetContent())
                                     : source.GetContent());
    target.SetNoConversion(source.GetNoConversion());
    CopyAttributes(source, target);
    wxXmlNode* last = nullptr;
    for (const wxXmlNode* child = source.GetChildren(); child; child = child->GetNext())
    {
        if (IsBlankText(*child))
            continue;
        if (last && IsText(*last) && !IsText(*child))
            RemoveIndentation(*last, level + 1);
        auto* copy = new wxXmlNode();
        target.InsertChildAfter(copy, last); // from here on owned by the target
        CopyTree(*child, *copy, level + 1);
        last = copy;
    }
}

void MoveTree(wxXmlNode& source, wxXmlNode& target)
{
    target.SetContent(source.GetContent());
    target.SetAttributes(source.GetAttributes());
    target.SetChildren(source.GetChildren());
    source.SetAttributes(nullptr);
    source.SetChildren(nullptr);
    for (wxXmlNode* child = target.GetChildren(); child; child = child->GetNext())
        child->SetParent(&target);
}
