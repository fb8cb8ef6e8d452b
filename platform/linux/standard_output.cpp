#include "platform/standard_output.h"

#include <cstdio>

bool WriteTo(StandardStream stream, const wxString& text)
{
    std::FILE* const file = stream == StandardStream::Output ? stdout : stderr;
    const std::string bytes = text.utf8_string();
    return std::fwrite(bytes.data(), 1, bytes.size(), file) == bytes.size() &&
           std::fflush(file) == 0;
}
