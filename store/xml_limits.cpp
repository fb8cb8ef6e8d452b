#include "store/xml_limits.h"

#include "store/xml_encoding.h"

#include <wx/intl.h>

#include <algorithm>
#include <cstdint>
#include <cstring>
#include <expat.h>
#include <memory>

namespace
{

// Levels of elements. The library saves and destroys a document by recursion: 5,000 levels fit on
// the stack of 1 MiB that Windows gives a program.
constexpr int MaxDepth = 2048;

// Characters of a text or value, with its entities expanded; 30 times the longest path.
constexpr size_t LongestValue = 1'000'000;

// Bytes of a document type. The parser compares each default with all others of the same element.
constexpr std::uint64_t MaxDocumentType = 16 * std::uint64_t{1024};

// A level needs 7 bytes. Without a document type, so many bytes can also hold no more than 3,600
// attributes, or 14,336 pieces of a text.
constexpr size_t HarmlessBytes = size_t{7} * MaxDepth;

// Bytes of memory for each node, attribute and character, as the library keeps them on a 64-bit
// system with wide characters of four bytes.
constexpr std::uint64_t NodeMemory = 208;
constexpr std::uint64_t AttributeMemory = 176;
constexpr std::uint64_t CharacterMemory = 4;

// The parser is given the document in pieces of this many bytes. With each piece it starts an
// incomplete tag, comment or instruction over.
constexpr std::uint64_t LibraryBuffer = 1024;

// Counts what the library will do. A step is
// - a character that it copies: it appends every piece of a text to a copy of all earlier ones, and
//   a piece ends at each line end, at each escaped character and at each border of its buffer
// - half an attribute that it passes to find the last one, each time it adds another; or, at each
//   element, an attribute that the document type declares
// - a byte that the parser reads again.
class Look
{
  public:
    Look(XML_Parser parser, size_t length, const XmlLimits& limits)
        : m_parser(parser), m_limits(limits), m_memory(length)
    {
    }

    bool IsWithinLimits() const
    {
        return m_isWithinLimits;
    }

    std::uint64_t Memory() const
    {
        return m_memory;
    }

    void BeginElement(const char* name, const char** attributes)
    {
        EndText();
        TakeToken();
        std::uint64_t count = 0;
        for (const char** each = attributes; *each; each += 2)
        {
            ++count;
            const size_t length = std::strlen(each[1]);
            m_isWithinLimits = m_isWithinLimits && length <= LongestValue;
            m_memory += AttributeMemory + CharacterMemory * (std::strlen(each[0]) + length);
        }
        m_memory += NodeMemory + CharacterMemory * std::strlen(name);
        m_steps += count * count + m_declaredAttributes;
        ++m_depth;
        Judge();
    }

    void EndElement()
    {
        EndText();
        TakeToken();
        --m_depth;
    }

    void Text(int length)
    {
        const std::uint64_t begin = Position();
        const std::uint64_t end = End();
        const std::uint64_t pieces = 1 + end / LibraryBuffer - begin / LibraryBuffer;
        m_lastEnd = end;
        m_memory += CharacterMemory * static_cast<std::uint64_t>(length) +
                    (m_textLength == 0 ? NodeMemory : 0);
        m_textLength += static_cast<std::uint64_t>(length);
        m_isWithinLimits = m_isWithinLimits && m_textLength <= LongestValue;
        m_steps += pieces * m_textLength;
        Judge();
    }

    // Anything else: declarations, comments, instructions, a document type.
    void Other()
    {
        EndText();
        TakeToken();
        m_memory += NodeMemory +
                    CharacterMemory * static_cast<std::uint64_t>(XML_GetCurrentByteCount(m_parser));
        if (m_isInDocumentType && Position() - m_documentType > MaxDocumentType)
            m_isWithinLimits = false;
        Judge();
    }

    void DeclareAttribute()
    {
        ++m_declaredAttributes;
        Other();
    }

    void BeginDocumentType()
    {
        m_documentType = Position();
        m_isInDocumentType = true;
    }

    void EndDocumentType()
    {
        m_isInDocumentType = false;
    }

    // The document is not well-formed. It may end inside a tag, or the last event may be followed
    // by one long token that is not allowed there.
    void Fail(size_t length)
    {
        const XML_Error error = XML_GetErrorCode(m_parser);
        const bool isUnfinished =
            error == XML_ERROR_UNCLOSED_TOKEN || error == XML_ERROR_PARTIAL_CHAR ||
            error == XML_ERROR_UNCLOSED_CDATA_SECTION || error == XML_ERROR_SYNTAX;
        TakeToken(isUnfinished ? length : End());
        Judge();
    }

  private:
    std::uint64_t Position() const
    {
        return static_cast<std::uint64_t>(
            std::max<XML_Index>(XML_GetCurrentByteIndex(m_parser), 0));
    }

    std::uint64_t End() const
    {
        return Position() + static_cast<std::uint64_t>(XML_GetCurrentByteCount(m_parser));
    }

    void EndText()
    {
        m_textLength = 0;
    }

    void TakeToken()
    {
        TakeToken(End());
    }

    void TakeToken(std::uint64_t end)
    {
        const std::uint64_t length = end > m_lastEnd ? end - m_lastEnd : 0;
        m_steps += length * length / (2 * LibraryBuffer);
        m_lastEnd = std::max(end, m_lastEnd);
    }

    void Judge()
    {
        m_isWithinLimits = m_isWithinLimits && m_depth <= MaxDepth && m_memory <= m_limits.memory &&
                           m_steps <= m_limits.steps;
        if (!m_isWithinLimits)
            XML_StopParser(m_parser, XML_FALSE);
    }

    const XML_Parser m_parser;
    const XmlLimits& m_limits;
    bool m_isWithinLimits = true;
    bool m_isInDocumentType = false;
    int m_depth = 0;
    std::uint64_t m_memory;
    std::uint64_t m_textLength = 0;
    std::uint64_t m_steps = 0;
    std::uint64_t m_declaredAttributes = 0;
    std::uint64_t m_documentType = 0;
    std::uint64_t m_lastEnd = 0;
};

Look& LookOf(void* data)
{
    return *static_cast<Look*>(data);
}

int FillEncoding(void* /*data*/, const char* name, XML_Encoding* encoding)
{
    const EncodingMap map = GetEncodingMap(wxString::FromUTF8(name));
    std::copy(map.begin(), map.end(), encoding->map);
    encoding->data = nullptr;
    encoding->convert = nullptr;
    encoding->release = nullptr;
    return XML_STATUS_OK;
}

// In the same way as the library, so that both see the same document.
void SetHandlers(XML_Parser parser, Look& look)
{
    XML_SetUserData(parser, &look);
    XML_SetElementHandler(
        parser,
        [](void* data, const char* name, const char** attributes)
        { LookOf(data).BeginElement(name, attributes); },
        [](void* data, const char*) { LookOf(data).EndElement(); });
    XML_SetCharacterDataHandler(parser, [](void* data, const char*, int length)
                                { LookOf(data).Text(length); });
    XML_SetDefaultHandler(parser, [](void* data, const char*, int) { LookOf(data).Other(); });
    XML_SetDoctypeDeclHandler(
        parser,
        [](void* data, const char*, const char*, const char*, int)
        { LookOf(data).BeginDocumentType(); },
        [](void* data) { LookOf(data).EndDocumentType(); });
    XML_SetAttlistDeclHandler(parser, [](void* data, const char*, const char*, const char*,
                                         const char*, int) { LookOf(data).DeclareAttribute(); });
    XML_SetUnknownEncodingHandler(parser, FillEncoding, nullptr);
}

} // namespace

wxString XmlSyntaxError::Describe() const
{
    return wxString::Format(_("XML parsing error: '%s' at line %d"), message,
                            static_cast<int>(line));
}

XmlLook LookAtXml(const std::string& bytes, const XmlLimits& limits)
{
    if (bytes.size() > limits.bytes)
        return {false, 0, {}};
    const std::unique_ptr<XML_ParserStruct, void (*)(XML_Parser)> parser(XML_ParserCreate(nullptr),
                                                                         XML_ParserFree);
    Look look(parser.get(), bytes.size(), limits);
    SetHandlers(parser.get(), look);
    // In one piece, so that nothing is read twice here.
    if (XML_Parse(parser.get(), bytes.data(), static_cast<int>(bytes.size()), XML_TRUE) ==
        XML_STATUS_OK)
        return {look.IsWithinLimits(), look.Memory(), {}};
    look.Fail(bytes.size());
    return {look.IsWithinLimits(),
            look.Memory(),
            {wxString::FromUTF8(XML_ErrorString(XML_GetErrorCode(parser.get()))),
             static_cast<unsigned long>(XML_GetCurrentLineNumber(parser.get()))}};
}

bool IsHarmlessXml(const std::string& bytes)
{
    // UTF-16, in which a document type would look different, has NULs.
    return bytes.size() <= HarmlessBytes && bytes.find("<!DOCTYPE") == std::string::npos &&
           bytes.find('\0') == std::string::npos;
}
