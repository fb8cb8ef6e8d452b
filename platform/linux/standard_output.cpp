#include "platform/standard_output.h"

#include <cstdio>
#include <string>

namespace
{

bool Write(std::FILE* stream, const wxString& text)
{
    const std::string bytes = text.utf8_string();
    return std::fwrite(bytes.data(), 1, bytes.size(), stream) == bytes.size() &&
           std::fflush(stream) == 0;
}

} // namespace

bool WriteStandardOutput(const wxString& text)
{
    return Write(stdout, text);
}

void WriteStandardError(const wxString& text)
{
    Write(stderr, text);
}
