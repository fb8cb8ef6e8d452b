#include "platform/standard_output.h"

#include "platform/system.h"

#include <string>

namespace
{

bool Write(DWORD which, const wxString& text)
{
    const HANDLE handle = GetStdHandle(which);
    DWORD mode = 0;
    DWORD count = 0;
    if (GetConsoleMode(handle, &mode) != 0)
    {
        const auto length = static_cast<DWORD>(text.length());
        return WriteConsoleW(handle, text.wc_str(), length, &count, nullptr) != 0 &&
               count == length;
    }
    const std::string bytes = text.utf8_string();
    const auto size = static_cast<DWORD>(bytes.size());
    return WriteFile(handle, bytes.data(), size, &count, nullptr) != 0 && count == size;
}

} // namespace

bool WriteStandardOutput(const wxString& text)
{
    return Write(STD_OUTPUT_HANDLE, text);
}

void WriteStandardError(const wxString& text)
{
    Write(STD_ERROR_HANDLE, text);
}
