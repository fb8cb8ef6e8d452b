// What the fuzz targets share. Each defines Try.
#pragma once

#include <wx/filename.h>
#include <wx/init.h>
#include <wx/log.h>

#include <cstdint>
#include <cstdlib>
#include <fstream>
#include <iostream>
#include <iterator>
#include <string>

void Try(const std::string& input);

inline void Check(bool holds, const char* promise)
{
    if (holds)
        return;
    std::cerr << "Broken promise: " << promise << '\n';
    std::abort();
}

/// A new file of this process in $TMPDIR.
inline std::string NewFile()
{
    return wxFileName::CreateTempFileName("fuzz").utf8_string();
}

inline void WriteBytes(const std::string& path, const std::string& bytes)
{
    std::ofstream(path, std::ios::binary) << bytes;
}

inline std::string ReadBytes(const std::string& path)
{
    std::ifstream file(path, std::ios::binary);
    return {std::istreambuf_iterator<char>(file), {}};
}

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    static const wxInitializer library;
    wxLog::EnableLogging(false);
    Try(std::string(reinterpret_cast<const char*>(data), size));
    return 0;
}
