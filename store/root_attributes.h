// The attributes of Folder.cfg's root element: one table for all who read or write them.
#pragma once

#include "store/hot_folder_settings.h"
#include "store/xml_lookup.h"

#include <variant>

/// How an attribute's text becomes its field's value.
enum class AttributeForm
{
    Text,        // as it is
    Number,      // base 10, up to the first character that is not a digit; 0 without digits
    NumericFlag, // whether such a number is not 0
    TextFlag     // whether the text, without trailing white space, is exactly "1"
};

struct RootAttribute
{
    using Field = std::variant<wxString HotFolderSettings::*, std::int32_t HotFolderSettings::*,
                               bool HotFolderSettings::*>;

    const wchar_t* name;
    AttributeForm form;
    Field field;
    int writtenPlace;
    bool isOptional = false; // missing, it becomes -1 and does not end the chain

    void Read(const wxString& text, HotFolderSettings& settings) const;
    wxString Format(const HotFolderSettings& settings) const;
};

/// All of them, in the order in which they are read.
const std::vector<RootAttribute>& RootAttributes();

/// The same, in the order in which they are written.
std::vector<const RootAttribute*> WrittenRootAttributes();

/// Reads the attributes as a chain, up to the first that is missing and not optional: from there
/// on all fields stay as they were. Returns how many attributes of the table come before it.
size_t ReadRootAttributes(const AttributeMap& attributes, HotFolderSettings& settings);

/// Up to "server_name": without them, a Folder.cfg counts as not read.
constexpr size_t RequiredAttributes = 4;
