#include "store/root_attributes.h"

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

} // namespace

const std::vector<RootAttribute>& RootAttributes()
{
    using S = HotFolderSettings;
    using F = AttributeForm;
    static const std::vector<RootAttribute> attributes = {
        {L"name", F::Text, &S::name, 1},
        {L"description", F::Text, &S::description, 2},
        {L"server_ip", F::Text, &S::server_ip, 3},
        {L"server_name", F::Text, &S::server_name, 4},
        {L"Enable", F::TextFlag, &S::Enable, 18},
        {L"BaseVirtualPrinter", F::Text, &S::BaseVirtualPrinter, 8},
        {L"BaseVirtualPrinterName", F::Text, &S::BaseVirtualPrinterName, 9},
        {L"BaseVirtualPrinterDisplayName", F::Text, &S::BaseVirtualPrinterDisplayName, 10},
        {L"HFPresetName", F::Text, &S::HFPresetName, 11},
        {L"Centralized", F::TextFlag, &S::Centralized, 19},
        {L"Isjobpresetattached", F::TextFlag, &S::Isjobpresetattached, 20},
        {L"IsCustomInterval", F::TextFlag, &S::IsCustomInterval, 21},
        {L"TimeInterval", F::Text, &S::TimeInterval, 22},
        {L"PPDVersion", F::Text, &S::PPDVersion, 12},
        {L"ServerTypeAndJPDefaultKeyInfo", F::Text, &S::ServerTypeAndJPDefaultKeyInfo, 13},
        {L"server_version", F::Number, &S::server_version, 5},
        {L"server_textversion", F::Text, &S::server_textversion, 6},
        {L"server_type", F::Text, &S::server_type, 7},
        {L"Quickset", F::Text, &S::Quickset, 16},
        {L"Quickset_Supported", F::NumericFlag, &S::Quickset_Supported, 14},
        {L"Quickset_Enabled", F::NumericFlag, &S::Quickset_Enabled, 15},
        {L"IsWidthBased", F::NumericFlag, &S::IsWidthBased, 17},
    };
    return attributes;
}

std::vector<const RootAttribute*> WrittenRootAttributes()
{
    std::vector<const RootAttribute*> written(RootAttributes().size());
    for (const RootAttribute& attribute : RootAttributes())
        written[static_cast<size_t>(attribute.writtenPlace) - 1] = &attribute;
    return written;
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

size_t ReadRootAttributes(const AttributeMap& attributes, HotFolderSettings& settings)
{
    size_t read = 0;
    for (const RootAttribute& attribute : RootAttributes())
    {
        const auto found = attributes.find(attribute.name);
        const bool isMissing = found == attributes.end();
        if (isMissing && attribute.form != AttributeForm::Number)
            break;
        attribute.Read(isMissing ? wxString(L"-1") : found->second, settings);
        ++read;
    }
    return read;
}
