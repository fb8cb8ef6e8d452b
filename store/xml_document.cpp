#include "store/xml_document.h"

#include "platform/memory.h"
#include "platform/unicode_text.h"
#include "store/xml_encoding.h"

#include <wx/intl.h>
#include <wx/log.h>
#include <wx/mstream.h>

#include <algorithm>
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

// Every document of so many bytes is within all limits, unless it has a document type. A level
// needs 7 bytes, or 3 if the document is malformed: 4,779 levels; there can also be no more than
// 3,600 attributes, or 14,336 pieces of a text.
constexpr size_t HarmlessBytes = size_t{7} * MaxDepth;
constexpr std::uint64_t HarmlessMemory = 2'000'000; // bytes

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
    // Handles everything in the same way as the library, so that both see the same document.
    explicit Look(const XmlLimits& limits)
        : m_parser(XML_ParserCreate(nullptr), XML_ParserFree), m_limits(limits)
    {
        const XML_Parser parser = m_parser.get();
        XML_SetUserData(parser, this);
        XML_SetElementHandler(
            parser,
            [](void* look, const char* name, const char** attributes)
            { Of(look).BeginElement(name, attributes); },
            [](void* look, const char*) { Of(look).EndElement(); });
        XML_SetCharacterDataHandler(parser, [](void* look, const char*, int length)
                                    { Of(look).Text(static_cast<std::uint64_t>(length)); });
        XML_SetDefaultHandler(parser, [](void* look, const char*, int) { Of(look).Other(); });
        XML_SetDoctypeDeclHandler(
            parser,
            [](void* look, const char*, const char*, const char*, int)
            { Of(look).m_documentTypeEnd = Of(look).Position() + MaxDocumentType; },
            [](void* look) { Of(look).m_documentTypeEnd = UINT64_MAX; });
        XML_SetAttlistDeclHandler(
            parser,
            [](void* look, const char*, const char*, const char*, const char*, int)
            {
                ++Of(look).m_declaredAttributes;
                Of(look).Other();
            });
        XML_SetUnknownEncodingHandler(
            parser,
            [](void* look, const char* name, XML_Encoding* encoding)
            {
                Of(look).m_misread = FillEncodingMap(wxString::FromUTF8(name), encoding->map);
                return static_cast<int>(XML_STATUS_OK);
            },
            this);
    }

    XmlLook At(const std::string& bytes)
    {
        m_look.memory = bytes.size();
        // In one piece, so that nothing is read twice here.
        if (XML_Parse(m_parser.get(), bytes.data(), static_cast<int>(bytes.size()), XML_TRUE) !=
            XML_STATUS_OK)
            Fail(bytes.size());
        m_look.isFaithful =
            std::none_of(bytes.begin(), bytes.end(),
                         [&](char each) { return m_misread[static_cast<unsigned char>(each)]; });
        return m_look;
    }

  private:
    static Look& Of(void* look)
    {
        return *static_cast<Look*>(look);
    }

    void BeginElement(const char* name, const char** attributes)
    {
        std::uint64_t count = 0;
        size_t longest = 0;
        size_t characters = std::strlen(name);
        for (; *attributes; attributes += 2)
        {
            ++count;
            const size_t length = std::strlen(attributes[1]);
            longest = std::max(longest, length);
            characters += std::strlen(attributes[0]) + length;
        }
        m_look.memory += NodeMemory + AttributeMemory * count + CharacterMemory * characters;
        m_steps += count * count + m_declaredAttributes;
        ++m_depth;
        TakeToken(End());
        Judge(longest);
    }

    void EndElement()
    {
        TakeToken(End());
        --m_depth;
    }

    void Text(std::uint64_t length)
    {
        const std::uint64_t pieces = 1 + End() / LibraryBuffer - Position() / LibraryBuffer;
        m_lastEnd = End();
        m_look.memory += CharacterMemory * length + (m_textLength == 0 ? NodeMemory : 0);
        m_textLength += length;
        m_steps += pieces * m_textLength;
        Judge(m_textLength);
    }

    // Anything else: declarations, comments, instructions, a document type.
    void Other()
    {
        TakeToken(End());
        m_look.memory += NodeMemory + CharacterMemory * (End() - Position());
        m_look.isWithinLimits = m_look.isWithinLimits && Position() <= m_documentTypeEnd;
        Judge(0);
    }

    // The document is not well-formed. It may end inside a tag, or the last event may be followed
    // by one long token that is not allowed there.
    void Fail(size_t length)
    {
        const XML_Error error = XML_GetErrorCode(m_parser.get());
        const bool isUnfinished =
            error == XML_ERROR_UNCLOSED_TOKEN || error == XML_ERROR_PARTIAL_CHAR ||
            error == XML_ERROR_UNCLOSED_CDATA_SECTION || error == XML_ERROR_SYNTAX;
        TakeToken(isUnfinished ? length : End());
        Judge(0);
        m_look.error = {wxString::FromUTF8(XML_ErrorString(error)),
                        static_cast<unsigned long>(XML_GetCurrentLineNumber(m_parser.get()))};
    }

    std::uint64_t Position() const
    {
        return static_cast<std::uint64_t>(
            std::max<XML_Index>(XML_GetCurrentByteIndex(m_parser.get()), 0));
    }

    std::uint64_t End() const
    {
        return Position() + static_cast<std::uint64_t>(XML_GetCurrentByteCount(m_parser.get()));
    }

    void TakeToken(std::uint64_t end)
    {
        const std::uint64_t length = end > m_lastEnd ? end - m_lastEnd : 0;
        m_steps += length * length / (2 * LibraryBuffer);
        m_lastEnd = std::max(end, m_lastEnd);
        m_textLength = 0;
    }

    void Judge(std::uint64_t longestValue)
    {
        m_look.isWithinLimits = m_look.isWithinLimits && longestValue <= LongestValue &&
                                m_depth <= MaxDepth && m_look.memory <= m_limits.memory &&
                                m_steps <= m_limits.steps;
        if (!m_look.isWithinLimits)
            XML_StopParser(m_parser.get(), XML_FALSE);
    }

    const std::unique_ptr<XML_ParserStruct, void (*)(XML_Parser)> m_parser;
    const XmlLimits& m_limits;
    XmlLook m_look;
    std::bitset<256> m_misread;
    int m_depth = 0;
    std::uint64_t m_textLength = 0;
    std::uint64_t m_steps = 0;
    std::uint64_t m_declaredAttributes = 0;
    std::uint64_t m_documentTypeEnd = UINT64_MAX; // where one that began must have ended
    std::uint64_t m_lastEnd = 0;
};

// Whether looking at the document is not worth the time: it is within all limits and is read
// faithfully. UTF-16, in which a document type or another encoding would look different, has NULs.
bool IsHarmless(const std::string& bytes)
{
    return bytes.size() <= HarmlessBytes && bytes.find("<!DOCTYPE") == std::string::npos &&
           bytes.find('\0') == std::string::npos &&
           bytes.find("encoding") == bytes.find("encoding=\"UTF-8\"");
}

} // namespace

wxString XmlSyntaxError::Describe() const
{
    return wxString::Format(_("XML parsing error: '%s' at line %d"), message,
                            static_cast<int>(line));
}

XmlLook LoadXml(const std::string& bytes, const XmlLimits& limits, wxXmlDocument& document)
{
    const bool isHarmless = IsHarmless(bytes);
    XmlLook look = isHarmless ? XmlLook() : Look(limits).At(bytes);
    if (!look.isWithinLimits)
        return look;
    RequireMemory((isHarmless ? HarmlessMemory : look.memory) * limits.copies);
    const wxLogNull noSyntaxErrors;
    wxMemoryInputStream stream(bytes.data(), bytes.size());
    const bool isLoaded = document.Load(stream, L"UTF-8", wxXMLDOC_KEEP_WHITESPACE_NODES);
    if (isHarmless && !isLoaded)
        look = Look(limits).At(bytes);
    return look;
}

bool IsWithinLimits(const std::string& bytes, const XmlLimits& limits)
{
    return IsHarmless(bytes) || Look(limits).At(bytes).isWithinLimits;
}

bool IsXmlText(const wxString& text)
{
    return IsUnicodeText(text) &&
           std::none_of(text.begin(), text.end(),
                        [](wxUniChar character)
                        {
                            const auto code = character.GetValue();
                            return (code < 0x20 && code != '\t' && code != '\n' && code != '\r') ||
                                   code == 0xFFFE || code == 0xFFFF;
                        });
}
