// The attributes of Folder.cfg's root element: one table for all who read or write them.
#pragma once

#include "store/hot_folder_settings.h"
#include "store/xml_lookup.h"

#include <wx/string.h>

#include <variant>
#include <vector>

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
    int chainPlace; // its place in the chain in which the attributes are read, from 1

    void Read(const wxString& text, HotFolderSettings& settings) const;
    wxString Format(const HotFolderSettings& settings) const;
};

/// All of them, in the order in which they are written.
const std::vector<RootAttribute>& RootAttributes();

/// Reads the attributes as a chain, in the order of their places, up to the first that is missing:
/// from there on all fields stay as they were. A missing server_version becomes -1 and does not end
/// the chain. Returns the attribute at which the chain ended, or null.
const RootAttribute* ReadRootAttributes(const AttributeMap& attributes,
                                        HotFolderSettings& settings);

/// The place of "server_name", the last required attribute: without it, a Folder.cfg counts as not
/// read.
constexpr int LastRequiredPlace = 4;

/// The place of "Enable".
constexpr int EnablePlace = 5;
