// Contents of an exported hive that no scenario has.
#include "platform/linux/registry_export.h"
#include "tests/text_files.h"

#include <gtest/gtest.h>

#include <iomanip>
#include <sstream>

TEST(Registry, AnExportIsReadAsTheRegistryGivesIt)
{
    using Bytes = std::string;
    const Bytes heading = "Windows Registry Editor Version 5.00\r\n\r\n";
    const Bytes key = heading + "[HKEY_CURRENT_USER\\A\\K]\r\n";
    const char* const none = nullptr;
    struct Export
    {
        Bytes bytes;
        const char* value; // in hexadecimal, after its type; null if there is no such value
    };
    for (const auto& [bytes, expected] :
         {Export{key + "\"v\"=\"a\\\\b \\\"c\\\"\"", "1:61005c00620020002200630022000000"},
          Export{key + "\"v\"=\"\U0001F600\"", "1:3dd800de0000"},
          Export{"\xEF\xBB\xBF" + key + "\"V\"=\"x\"", "1:78000000"},
          Export{ToUtf16(key + "\"v\"=\"x\""), "1:78000000"},
          Export{key + "@=\"x\"\r\n\"vv\"=\"x\"\r\n\"v\"=\"y\"", "1:79000000"},
          Export{key + "\"v\"=hex(2):78,00,\\\r\n  79,00,00,00\r\n\"w\"=\"x\"", "2:780079000000"},
          Export{key + "\"v\"=hex(2):78,00", "2:78000000"},
          Export{key + "\"v\"=hex(1):78,00,79", "1:780079"},
          Export{key + "\"v\"=hex(1):", "1:0000"}, Export{key + "\"v\"=hex(7):78,00", "7:7800"},
          Export{key + "\"v\"=hex:78,00", "3:7800"},
          Export{key + "\"v\"=hex:\r\n\"w\"=\"x\"", "3:"},
          Export{key + "\"v\"=dword:01020378", "4:78030201"}, Export{key + "\"v\"=-", none},
          Export{key + "\r\n[HKEY_CURRENT_USER\\A\\K\\L]\r\n\"v\"=\"x\"", none},
          Export{heading + "[HKEY_CURRENT_USER\\A\\K\\L]\r\n\"v\"=\"x\"", none},
          Export{heading +
                     "[HKEY_CURRENT_USER\\A\\KL]\r\n\r\n[hkey_current_user\\a\\k]\r\n\"v\"=\"x\"",
                 "1:78000000"}})
    {
        const std::string hive = DecodeRegistryExport(bytes);
        const char* const lines = FindRegistryKey(hive, "HKEY_CURRENT_USER\\a\\K");
        ASSERT_NE(nullptr, lines) << bytes;
        const auto value = FindRegistryValue(lines, "v");
        ASSERT_EQ(expected != none, value.has_value()) << bytes;
        std::ostringstream found;
        for (const int byte : value ? value->data : std::vector<BYTE>())
            found << std::hex << std::setfill('0') << std::setw(2) << byte;
        EXPECT_EQ(expected ? expected : ":",
                  (value ? std::to_string(value->type) : "") + ":" + found.str())
            << bytes;
    }
    for (const Bytes& bytes : {heading + "[HKEY_CURRENT_USER\\A\\KL]\r\n",
                               "REGEDIT4\r\n" + key.substr(heading.size()), Bytes()})
        EXPECT_EQ(nullptr, FindRegistryKey(DecodeRegistryExport(bytes), "HKEY_CURRENT_USER\\A\\K"))
            << bytes;
}
