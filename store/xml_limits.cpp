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

// Without a document type, no document up to this length can do harm: 16,384 bytes can hold no more
// than 5,500 levels or elements, 4,100 attributes or 16,384 pieces of a text. With one, 12 KB are
// enough for entities and defaults that expand to gigabytes.
constexpr size_t HarmlessBytes = size_t{16} * 1024;

// Levels of elements. The library destroys a document by recursion: 500,000 levels fit on our stack
// of 64 MiB, 1,000,000 do not.
constexpr int MaxDepth = 250000;

// Bytes of memory, counted for the document itself and for each node, attribute and character as
// the library keeps them on a 64-bit system with wide characters of four bytes. 100,000 job
// settings take about 120 million.
constexpr std::uint64_t MaxMemory = 208 * std::uint64_t{1000} * 1000;
constexpr std::uint64_t NodeMemory = 208;
constexpr std::uint64_t AttributeMemory = 176;
constexpr std::uint64_t CharacterMemory = 4;

// Characters that the library copies because it appends every piece of a text to a copy of all
// earlier ones. A piece ends at each line end, at each escaped character and at each border of the
// buffer below.
constexpr std::uint64_t MaxCopiedCharacters = 1000 * std::uint64_t{1000} * 1000;

// Attributes that the library steps past to find the last one each time it adds another; and, at
// each element, the attributes that the document type declares.
constexpr std::uint64_t MaxAttributeSteps = 100 * std::uint64_t{1000} * 1000;

// Bytes that the parser reads again: it is given the document in pieces of this size, and with each
// piece it starts an incomplete tag, comment or instruction over.
constexpr std::uint64_t LibraryBuffer = 1024;
constexpr std::uint64_t MaxBytesReadAgain = 1000 * std::uint64_t{1000} * 1000;

// Bytes of a document type. The parser compares each default with all others of the same element.
constexpr std::uint64_t MaxDocumentType = 16 * std::uint64_t{1024};

class Look
{
  public:
    Look(XML_Parser parser, size_t length) : m_parser(parser), m_memory(length)
    {
    }

    bool IsWithinLimits() const
    {
        return m_isWithinLimits;
    }

    void BeginElement(const char* name, const char** attributes)
    {
        EndText();
        TakeToken();
        std::uint64_t count = 0;
        for (const char** each = attributes; *each; each += 2)
        {
            ++count;
            m_memory +=
                AttributeMemory + CharacterMemory * (std::strlen(each[0]) + std::strlen(each[1]));
        }
        m_memory += NodeMemory + CharacterMemory * std::strlen(name);
        m_attributeSteps += count * count / 2 + m_declaredAttributes;
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
        m_copiedCharacters += pieces * m_textLength;
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
        m_bytesReadAgain += length * length / (2 * LibraryBuffer);
        m_lastEnd = std::max(end, m_lastEnd);
    }

    void Judge()
    {
        m_isWithinLimits = m_isWithinLimits && m_depth <= MaxDepth && m_memory <= MaxMemory &&
                           m_copiedCharacters <= MaxCopiedCharacters &&
                           m_attributeSteps <= MaxAttributeSteps &&
                           m_bytesReadAgain <= MaxBytesReadAgain;
        if (!m_isWithinLimits)
            XML_StopParser(m_parser, XML_FALSE);
    }

    const XML_Parser m_parser;
    bool m_isWithinLimits = true;
    bool m_isInDocumentType = false;
    int m_depth = 0;
    std::uint64_t m_memory;
    std::uint64_t m_textLength = 0;
    std::uint64_t m_copiedCharacters = 0;
    std::uint64_t m_attributeSteps = 0;
    std::uint64_t m_declaredAttributes = 0;
    std::uint64_t m_bytesReadAgain = 0;
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

XmlLook LookAtXml(const std::string& bytes, Harmless harmless)
{
    // UTF-16, in which a document type would look different, has NULs.
    if (harmless == Harmless::Skip && bytes.size() <= HarmlessBytes &&
        bytes.find("<!DOCTYPE") == std::string::npos && bytes.find('\0') == std::string::npos)
        return {};
    if (static_cast<std::int64_t>(bytes.size()) > LongestXml)
        return {false, {}};
    const std::unique_ptr<XML_ParserStruct, void (*)(XML_Parser)> parser(XML_ParserCreate(nullptr),
                                                                         XML_ParserFree);
    Look look(parser.get(), bytes.size());
    SetHandlers(parser.get(), look);
    // In one piece, so that nothing is read twice here.
    if (XML_Parse(parser.get(), bytes.data(), static_cast<int>(bytes.size()), XML_TRUE) ==
        XML_STATUS_OK)
        return {look.IsWithinLimits(), {}};
    look.Fail(bytes.size());
    return {look.IsWithinLimits(),
            {wxString::FromUTF8(XML_ErrorString(XML_GetErrorCode(parser.get()))),
             static_cast<unsigned long>(XML_GetCurrentLineNumber(parser.get()))}};
}
