#include "platform/standard_output.h"

#include "platform/system.h"

bool WriteTo(StandardStream stream, const wxString& text)
{
    const HANDLE handle =
        GetStdHandle(stream == StandardStream::Output ? STD_OUTPUT_HANDLE : STD_ERROR_HANDLE);
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
