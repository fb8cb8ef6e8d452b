#include "store/xml_tree.h"

#include <memory>

namespace
{

// The next node in document order below root, or null; updates level to match.
template <typename Node>
Node* NextNode(Node* node, const wxXmlNode& root, int& level)
{
    if (node->GetChildren())
    {
        ++level;
        return node->GetChildren();
    }
    for (; node != &root; node = node->GetParent(), --level)
    {
        if (node->GetNext())
            return node->GetNext();
    }
    return nullptr;
}

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

void CopyNode(const wxXmlNode& source, wxXmlNode& target)
{
    target.SetType(source.GetType());
    target.SetName(source.GetName());
    target.SetContent(source.GetContent());
    target.SetNoConversion(source.GetNoConversion());
    CopyAttributes(source, target);
}

// Appends a copy of the source after the parent's last child so far.
wxXmlNode* AppendCopy(const wxXmlNode& source, wxXmlNode& parent, wxXmlNode* last)
{
    auto copy = std::make_unique<wxXmlNode>(source.GetType(), source.GetName());
    CopyNode(source, *copy);
    parent.InsertChildAfter(copy.get(), last);
    return copy.release(); // from here on owned by the parent
}

const char* const WhiteSpace = " \t\r\n";

bool IsBlankText(const wxXmlNode& node)
{
    return node.GetType() == wxXML_TEXT_NODE &&
           node.GetContent().find_first_not_of(WhiteSpace) == wxString::npos;
}

void RemoveBlankTexts(wxXmlNode& parent)
{
    wxXmlNode* last = nullptr; // the last of those that stay
    wxXmlNode* next = nullptr;
    for (wxXmlNode* child = parent.GetChildren(); child; child = next)
    {
        next = child->GetNext();
        if (!IsBlankText(*child))
        {
            last = child;
            continue;
        }
        if (last)
            last->SetNext(next);
        else
            parent.SetChildren(next);
        delete child;
    }
}

} // namespace

void CopyTree(const wxXmlNode& source, wxXmlNode& target)
{
    CopyNode(source, target);
    const wxXmlNode* from = &source;
    wxXmlNode* to = &target;
    while (true)
    {
        if (from->GetChildren())
        {
            from = from->GetChildren();
            to = AppendCopy(*from, *to, nullptr);
            continue;
        }
        for (; from != &source && !from->GetNext(); to = to->GetParent())
            from = from->GetParent();
        if (from == &source)
            return;
        from = from->GetNext();
        to = AppendCopy(*from, *to->GetParent(), to);
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

void RemoveIgnoredWhiteSpace(wxXmlNode& root)
{
    int level = 0;
    for (wxXmlNode* node = &root; node; node = NextNode(node, root, level))
    {
        RemoveBlankTexts(*node);
        if (node->GetType() != wxXML_TEXT_NODE)
            continue;
        const wxString& text = node->GetContent();
        const size_t lineFeed = text.rfind('\n', text.find_first_not_of(WhiteSpace));
        if (lineFeed != wxString::npos)
            node->SetContent(text.Mid(lineFeed + 1));
    }
}

void RemoveSavedIndentation(wxXmlNode& root, int level)
{
    for (wxXmlNode* node = &root; node; node = NextNode(node, root, level))
    {
        const wxXmlNode* next = node->GetNext();
        if (node == &root || node->GetType() != wxXML_TEXT_NODE || !next ||
            next->GetType() == wxXML_TEXT_NODE)
            continue;
        // Checked first, because making the indentation of many levels would take long.
        const size_t length = 1 + 2 * static_cast<size_t>(level);
        const wxString& text = node->GetContent();
        if (text.length() >= length && text.EndsWith("\n" + wxString(' ', length - 1)))
            node->SetContent(text.Left(text.length() - length));
    }
}
