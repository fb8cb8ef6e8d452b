// What the fuzz targets share. Each defines Try.
#pragma once

#include <wx/init.h>
#include <wx/log.h>

#include <cstdint>
#include <cstdlib>
#include <iostream>
#include <string>

void Try(const std::string& input);

inline void Check(bool holds, const char* promise)
{
    if (holds)
        return;
    std::cerr << "Broken promise: " << promise << '\n';
    std::abort();
}

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    static const wxInitializer library;
    wxLog::EnableLogging(false);
    Try(std::string(reinterpret_cast<const char*>(data), size));
    return 0;
}
