// What no run can show: the results and defaults of readers, lookups, rarer forms of the output,
// files, and what counts as text.
#include "platform/regular_file.h"
#include "platform/system.h"
#include "platform/unicode_text.h"
#include "store/folder_cfg_reader.h"
#include "store/folder_cfg_writer.h"
#include "store/root_attributes.h"
#include "store/xml_lookup.h"
#include "store/xml_text.h"
#include "store/xml_tree.h"
#include "tests/text_files.h"

#include <gtest/gtest.h>
#include <wx/ffile.h>
#include <wx/filename.h>
#include <wx/log.h>

#include <set>

namespace
{

class Store : public testing::Test
{
  protected:
    Store() : m_path(wxFileName::CreateTempFileName("store"))
    {
    }

    ~Store() override
    {
        wxRemoveFile(m_path);
    }

    const wxString& File(const wxString& text)
    {
        wxFFile(m_path, "wb").Write(text);
        return m_path;
    }

    wxString Text() const
    {
        return wxString::FromUTF8(ReadFile(m_path.utf8_string()));
    }

    int Load(const wxString& text, HotFolderSettings& settings)
    {
        const wxLogNull quiet;
        return LoadHotFolderSettings(File(text), settings);
    }

    const wxXmlNode* Root(const wxString& text)
    {
        m_document.Load(File(text));
        return m_document.GetRoot();
    }

    const wxString m_path;
    wxXmlDocument m_document;
};

TEST_F(Store, TheChainOfAttributesEndsAtTheFirstGap)
{
    // The chain in the order in which it is read, without server_version, which does not end it.
    const wxArrayString chain = wxSplit(
        "name description server_ip server_name Enable BaseVirtualPrinter BaseVirtualPrinterName "
        "BaseVirtualPrinterDisplayName "
        "HFPresetName Centralized Isjobpresetattached IsCustomInterval TimeInterval PPDVersion "
        "ServerTypeAndJPDefaultKeyInfo "
        "server_textversion server_type Quickset Quickset_Supported Quickset_Enabled IsWidthBased",
        ' ');
    std::set<int> places;
    for (const RootAttribute& attribute : RootAttributes())
        EXPECT_TRUE(places.insert(attribute.chainPlace).second)
            << attribute.name << " shares its place";
    for (size_t gap = 0; gap <= chain.size(); ++gap)
    {
        wxString attributes;
        for (size_t i = 0; i < chain.size(); ++i)
            attributes += i == gap ? wxString() : " " + chain[i] + "='1'";
        HotFolderSettings read;
        const auto isReached = [&](const char* name)
        {
            return static_cast<int>(gap) > chain.Index(name);
        };
        EXPECT_EQ(isReached("server_name") ? 1 : -1,
                  Load("<r" + attributes + " server_version='12'/>", read))
            << gap;
        size_t count = 0; // the number of fields that were set
        for (const wxString& text :
             {read.name, read.description, read.server_ip, read.server_name,
              read.BaseVirtualPrinter, read.BaseVirtualPrinterName,
              read.BaseVirtualPrinterDisplayName, read.HFPresetName, read.TimeInterval,
              read.PPDVersion, read.ServerTypeAndJPDefaultKeyInfo, read.server_textversion,
              read.server_type, read.Quickset})
            count += text == "1" ? 1 : 0;
        for (const bool flag :
             {read.Enable, read.Centralized, read.Isjobpresetattached, read.IsCustomInterval,
              read.Quickset_Supported, read.Quickset_Enabled, read.IsWidthBased})
            count += flag ? 1 : 0;
        EXPECT_EQ(gap, count) << "without " << (gap < chain.size() ? chain[gap] : wxString("none"));
        EXPECT_EQ(isReached("ServerTypeAndJPDefaultKeyInfo") ? 12 : -1, read.server_version) << gap;
    }
}

TEST_F(Store, FlagsAndNumbersAreRead)
{
    const std::set<std::string> numericFlags = {"2147483647", "-2147483648", "1",  "1 \t",
                                                " 1",         "01",          "-1", "12x"};
    const std::set<std::string> textFlags = {"1", "1 \t"};
    using Number = std::pair<std::string, int>;
    for (const auto& [value, number] :
         {Number{"1", 1}, Number{"1 \t", 1}, Number{" 1", 1}, Number{"01", 1}, Number{"-1", -1},
          Number{"0", 0}, Number{"", 0}, Number{"true", 0}, Number{"12x", 12}, Number{"x1", 0},
          Number{"2147483647", 2147483647}, Number{"-2147483648", -2147483647 - 1},
          Number{"2147483648", 0}, Number{"99999999999999999999", 0}})
    {
        HotFolderSettings read;
        Load(wxString::Format(
                 "<r name='' description='' server_ip='' server_name='' Enable='%s' "
                 "BaseVirtualPrinter='' BaseVirtualPrinterName='' BaseVirtualPrinterDisplayName='' "
                 "HFPresetName='' Centralized='' Isjobpresetattached='' IsCustomInterval='' "
                 "TimeInterval='' PPDVersion='' ServerTypeAndJPDefaultKeyInfo='' "
                 "server_version='%s' "
                 "server_textversion='' server_type='' Quickset='' Quickset_Supported='%s'/>",
                 value, value, value),
             read);
        EXPECT_EQ(textFlags.count(value) == 1, read.Enable) << value;
        EXPECT_EQ(numericFlags.count(value) == 1, read.Quickset_Supported) << value;
        EXPECT_EQ(number, read.server_version) << value;
    }
}

TEST_F(Store, AFailedLoadLeavesTheValues)
{
    const wxLogNull quiet;
    HotFolderSettings settings;
    settings.InputFormatsSummary.resize(1);
    wxXmlNode filter(wxXML_ELEMENT_NODE, "kept");
    EXPECT_EQ(-1, LoadHotFolderSettings(File("<r name='x'>"), settings));
    EXPECT_EQ(0, ReadFilterSetting(m_path, filter));
    EXPECT_EQ(0, LoadHotFolderSettings(m_path + "missing", settings));
    EXPECT_EQ("", settings.name);
    EXPECT_EQ(1U, settings.InputFormatsSummary.size());
    EXPECT_EQ("kept", filter.GetName());
    EXPECT_EQ(-1, LoadHotFolderSettings(File("<r/>"), settings));
    EXPECT_TRUE(settings.InputFormatsSummary.empty());
}

TEST_F(Store, MissingSectionsLeaveTheirValues)
{
    HotFolderPaths paths;
    paths.Workfolder = "kept";
    JobSettingTable jobs = {{"kept", {}}};
    PreflightSettingList preflight(1);
    const wxXmlNode* root = Root("<r><jobsetting/><Paths><Workfolder/></Paths></r>");
    ReadJobSettings(root, jobs);
    ReadPreflightSettings(nullptr, preflight);
    EXPECT_EQ(1, ReadPaths(nullptr, paths));
    EXPECT_EQ(0, ReadPaths(root, paths));
    EXPECT_EQ("kept", paths.Workfolder);
    EXPECT_EQ(1U, jobs.size());
    EXPECT_EQ(1U, preflight.size());
    ReadJobSettings(Root("<r><x><JobSetting/></x></r>"), jobs);
    EXPECT_TRUE(jobs.empty());
}

TEST_F(Store, WithoutARootNothingIsReadOrWritten)
{
    JobSettingTable jobs = {{"kept", {}}};
    ImposeSettingTable impose = {{"kept", {}}};
    std::vector<InputFormat> formats(1);
    wxXmlNode filter(wxXML_ELEMENT_NODE, "kept");
    HotFolderSettings settings;
    ReadJobSettings(nullptr, jobs);
    ReadImposeSettings(nullptr, impose);
    ReadInputFormats(nullptr, formats);
    ReadFilterSetting(nullptr, filter);
    ReadHotFolderSettings(nullptr, settings);
    EXPECT_EQ(1U, jobs.size() * impose.size() * formats.size());
    EXPECT_EQ("kept", filter.GetName());
    EXPECT_EQ(-1, settings.server_version);
    WriteJobSettings(nullptr, jobs);
    WriteImposeSettings(nullptr, impose);
    WriteInputFormats(nullptr, formats);
    WritePaths(nullptr, {});
    WritePreflightSettings(nullptr, PreflightSettingList(1));
}

TEST_F(Store, AnEntryWithoutAShortNameHasNoNames)
{
    std::vector<InputFormat> formats;
    ReadInputFormats(
        Root("<r><InputFormatsSummary><x/>text<x DisplayName='d'/></InputFormatsSummary></r>"),
        formats);
    ASSERT_EQ(1U, formats.size());
    EXPECT_EQ("", formats[0].DisplayName);
}

TEST_F(Store, DirectChildrenComeBeforeSubtrees)
{
    const wxXmlNode* root =
        Root("<r><a><b><x n='3'/></b><x n='2'/></a><!--c--><c><x n='4'/></c><d/></r>");
    wxString value;
    EXPECT_TRUE(FindElement(root, "x", true)->GetAttribute("n", &value));
    EXPECT_EQ("2", value);
    EXPECT_EQ(nullptr, FindElement(root, "x", false));
    EXPECT_EQ(nullptr, FindElement(root, "X", true));
    EXPECT_EQ(nullptr, FindElement(root, "r", true));
    EXPECT_NE(nullptr, FindElement(root, "d", false));
}

TEST_F(Store, DefaultsAreWrittenAndAFilterOfAnotherNameIsNot)
{
    SaveHotFolderSettings(m_path, {}, {}, {}, wxXmlNode(wxXML_ELEMENT_NODE, "filtersetting"), {},
                          {});
    EXPECT_TRUE(Text().EndsWith(
        "Enable=\"0\" Centralized=\"0\" Isjobpresetattached=\"0\" "
        "IsCustomInterval=\"0\" TimeInterval=\"\">\n  <InputFormatsSummary/>\n"
        "  <Paths>\n    <Failfolder path=\"\"/>\n    <Workfolder path=\"\"/>\n"
        "    <Movefolder path=\"\"/>\n    <Hotfolder path=\"\"/>\n  </Paths>\n"
        "  <JobSetting/>\n  <ImposeSetting/>\n  <PreflightSettings/>\n</HotFolder>\n"));
    EXPECT_TRUE(Text().Contains("server_version=\"-1\""));
}

TEST_F(Store, AFileIsRewrittenInPlace)
{
    using Status = RegularFile::Status;
    RegularFile file;
    EXPECT_EQ(Status::NotThere, file.OpenForReading(m_path + "missing", Links::Refuse));
    EXPECT_EQ(Status::NotThere, file.OpenForReading(wxFileName::GetTempDir(), Links::Refuse));
    EXPECT_EQ(Status::Refused, file.CreateNew(File("12345")));
    ASSERT_EQ(Status::Open, file.OpenForUpdate(m_path, Links::Refuse));
    EXPECT_TRUE(file.Append("6") && file.Rewrite("123456", "12") && file.Rewrite("12", "1234567"));
    std::string bytes;
    EXPECT_FALSE(file.Read(bytes, 6));
    EXPECT_TRUE(file.Read(bytes, 7));
    EXPECT_EQ("1234567", bytes);
    RegularFile copy;
    ASSERT_EQ(Status::Open, copy.CreateNew(m_path + "copy"));
    for (const DWORD attributes : {FILE_ATTRIBUTE_READONLY, FILE_ATTRIBUTE_HIDDEN})
    {
        EXPECT_NE(0, SetFileAttributesW(m_path.wc_str(), attributes));
        EXPECT_FALSE(copy.HasAttributesOf(file)) << attributes;
        copy.TakeAttributes(file);
        EXPECT_TRUE(copy.HasAttributesOf(file)) << attributes;
    }
    copy.Close();
    EXPECT_TRUE(wxRemoveFile(m_path + "copy"));
}

TEST(UnicodeText, ALoneSurrogateIsNotText)
{
    using Units = std::vector<unsigned>;
    const auto text = [](const Units& units)
    {
        std::vector<unsigned char> bytes;
        for (const unsigned unit : units)
            bytes.insert(bytes.end(),
                         {static_cast<unsigned char>(unit), static_cast<unsigned char>(unit >> 8)});
        bytes.push_back('x'); // half a unit
        return FromUtf16Bytes(bytes.data(), bytes.size());
    };
    EXPECT_EQ(wxString::FromUTF8("a\U0001D11Eb\U0010FFFF\U00010000"),
              text({'a', 0xD834, 0xDD1E, 'b', 0xDBFF, 0xDFFF, 0xD800, 0xDC00, 0, 'c'}));
    for (const Units& units : {Units{0xD834, 0xDD1E},
                               {0xDBFF, 0xDFFF},
                               {0xD800, 0xDC00},
                               {0xD7FF, 0xE000, 0xFFFD},
                               {0x20, '\t', '\r', '\n'}})
        EXPECT_TRUE(IsXmlText(text(units))) << std::hex << units[0];
    for (const Units& units : {Units{0xD834},
                               {0xD834, 'a'},
                               {0xDD1E},
                               {0xDC00, 0xD800},
                               {0xD800, 0xD800},
                               {0xDFFF, 'a'},
                               {0xD834, 0xE000}})
        EXPECT_FALSE(IsUnicodeText(text(units)) || IsXmlText(text(units))) << std::hex << units[0];
    for (const unsigned unit : {0x1FU, 1U, 8U, 0xBU, 0xFFFEU, 0xFFFFU})
        EXPECT_TRUE(IsUnicodeText(text({unit})) && !IsXmlText(text({unit}))) << std::hex << unit;
    EXPECT_EQ(wxString::FromUTF8("\t \uFFFD~\uFFFD\uFFFD\u00A0\u2027\uFFFD\uFFFD\u202A\uFFFD"),
              ToOneLine(text({'\t', ' ', 0x1F, '~', 0x7F, 0x9F, 0xA0, 0x2027, 0x2028, 0x2029,
                              0x202A, 0xD834})));
}

} // namespace
