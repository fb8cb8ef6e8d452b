#include "store/root_attributes.h"

#include <algorithm>
#include <limits>

namespace
{

// The base-10 number at the beginning of the text; 0 if there is none, or if it exceeds 32 bits, so
// that the result does not depend on the size of long.
std::int32_t ReadNumber(const wxString& text)
{
    using Limits = std::numeric_limits<std::int32_t>;
    long number = 0;
    text.ToLong(&number);
    return number < Limits::min() || number > Limits::max() ? 0 : static_cast<std::int32_t>(number);
}

bool ReadFlag(const wxString& text, AttributeForm form)
{
    return form == AttributeForm::TextFlag ? wxString(text).Trim() == L"1" : ReadNumber(text) != 0;
}

std::vector<const RootAttribute*> InChainOrder()
{
    std::vector<const RootAttribute*> chain;
    for (const RootAttribute& attribute : RootAttributes())
        chain.push_back(&attribute);
    std::sort(chain.begin(), chain.end(),
              [](const RootAttribute* left, const RootAttribute* right)
              { return left->chainPlace < right->chainPlace; });
    return chain;
}

} // namespace

const std::vector<RootAttribute>& RootAttributes()
{
    using S = HotFolderSettings;
    using F = AttributeForm;
    static const std::vector<RootAttribute> attributes = {
        {L"name", F::Text, &S::name, 1},
        {L"description", F::Text, &S::description, 2},
        {L"server_ip", F::Text, &S::server_ip, 3},
        {L"server_name", F::Text, &S::server_name, LastRequiredPlace},
        {L"server_version", F::Number, &S::server_version, 16},
        {L"server_textversion", F::Text, &S::server_textversion, 17},
        {L"server_type", F::Text, &S::server_type, 18},
        {L"BaseVirtualPrinter", F::Text, &S::BaseVirtualPrinter, 6},
        {L"BaseVirtualPrinterName", F::Text, &S::BaseVirtualPrinterName, 7},
        {L"BaseVirtualPrinterDisplayName", F::Text, &S::BaseVirtualPrinterDisplayName, 8},
        {L"HFPresetName", F::Text, &S::HFPresetName, 9},
        {L"PPDVersion", F::Text, &S::PPDVersion, 14},
        {L"ServerTypeAndJPDefaultKeyInfo", F::Text, &S::ServerTypeAndJPDefaultKeyInfo, 15},
        {L"Quickset_Supported", F::NumericFlag, &S::Quickset_Supported, 20},
        {L"Quickset_Enabled", F::NumericFlag, &S::Quickset_Enabled, 21},
        {L"Quickset", F::Text, &S::Quickset, 19},
        {L"IsWidthBased", F::NumericFlag, &S::IsWidthBased, 22},
        {L"Enable", F::TextFlag, &S::Enable, EnablePlace},
        {L"Centralized", F::TextFlag, &S::Centralized, 10},
        {L"Isjobpresetattached", F::TextFlag, &S::Isjobpresetattached, 11},
        {L"IsCustomInterval", F::TextFlag, &S::IsCustomInterval, 12},
        {L"TimeInterval", F::Text, &S::TimeInterval, 13},
    };
    return attributes;
}

void RootAttribute::Read(const wxString& text, HotFolderSettings& settings) const
{
    if (const auto* asText = std::get_if<wxString HotFolderSettings::*>(&field))
        settings.*(*asText) = text;
    else if (const auto* number = std::get_if<std::int32_t HotFolderSettings::*>(&field))
        settings.*(*number) = ReadNumber(text);
    else
        settings.*std::get<bool HotFolderSettings::*>(field) = ReadFlag(text, form);
}

wxString RootAttribute::Format(const HotFolderSettings& settings) const
{
    if (const auto* asText = std::get_if<wxString HotFolderSettings::*>(&field))
        return settings.*(*asText);
    if (const auto* number = std::get_if<std::int32_t HotFolderSettings::*>(&field))
        return std::to_wstring(settings.*(*number));
    return settings.*std::get<bool HotFolderSettings::*>(field) ? L"1" : L"0";
}

const RootAttribute* ReadRootAttributes(const AttributeMap& attributes, HotFolderSettings& settings)
{
    static const std::vector<const RootAttribute*> chain = InChainOrder();
    for (const RootAttribute* attribute : chain)
    {
        const auto found = attributes.find(attribute->name);
        if (found != attributes.end())
            attribute->Read(found->second, settings);
        else if (attribute->form == AttributeForm::Number)
            attribute->Read(L"-1", settings);
        else
            return attribute;
    }
    return nullptr;
}
