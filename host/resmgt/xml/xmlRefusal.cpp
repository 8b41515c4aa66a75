#include "xml/xmlRefusal.h"

#include "text/liString.h"
#include "xml/xmlError.h"
#include "xml/xmlSyntax.h"

#include <algorithm>
#include <array>
#include <new>
#include <strings.h>

namespace Kv
{

namespace
{

constexpr std::string_view byteOrderMark = "\xef\xbb\xbf";
constexpr char const* nameEnds = " \t\r\n<>/=?\"'";
constexpr char const* misplacedDeclaration = "an XML declaration that is not the first thing in the text";
constexpr char const* documentType = "a document type definition (DOCTYPE) is not supported";

// In bytes of UTF-8.
constexpr std::size_t longestCharacter = 4;

bool startsWith(std::string_view text, std::string_view start)
{
    return text.substr(0, start.size()) == start;
}

bool startsBeyondAscii(std::string_view text)
{
    return !text.empty() && static_cast<unsigned char>(text.front()) >= 0x80;
}

/// The name that the byte at `place` belongs to, in quotes.
std::string getName(std::string_view text, std::size_t place)
{
    std::size_t const begin = text.find_last_of(nameEnds, place) + 1;
    return LiStringUtil::getPrintable(text.substr(begin, text.find_first_of(nameEnds, place) - begin));
}

int countLines(std::string_view text)
{
    int count = 0;
    for (std::size_t i = 0; i < text.size(); ++i)
        if (text[i] == '\n' || (text[i] == '\r' && text.substr(i, 2) != "\r\n"))
            ++count;
    return count;
}

/// The first reference from `place` on that stands for no character. Of one in an attribute, the parser tells the place
/// of the tag.
std::size_t findReference(std::string_view text, std::size_t place)
{
    constexpr std::array<std::string_view, 6> good = {"#", "amp;", "lt;", "gt;", "quot;", "apos;"};
    auto const isGood = [&](std::string_view name) { return startsWith(text.substr(place + 1), name); };
    while (place < text.size() && (text[place] != '&' || std::any_of(good.begin(), good.end(), isGood)))
        ++place;
    return place;
}

/// Words for what has no better ones.
std::string getPlainWords(XmlRefusal const& refusal, std::string const& what)
{
    return "no well-formed XML: " + what + ", near " + LiStringUtil::getPrintable(refusal.text, refusal.place);
}

/// Words for a tag, a comment, a text or whatever the `token` is that goes wrong in the middle.
std::string getTokenWords(XmlRefusal const& refusal, std::string_view token)
{
    std::string_view const before = refusal.text.substr(refusal.begin, refusal.place - refusal.begin);
    std::string_view const rest = refusal.text.substr(refusal.place);
    std::size_t const reference = before.rfind('&');
    if (reference != before.npos && before.find_first_of("; \t\r\n<>'\"", reference) == before.npos)
        return "'&' without a reference behind it; by itself it is written &amp;";
    if (startsWith(token, "<!--"))
        return "'--' inside a comment, or a comment that ends with '--->'";
    if (strcasecmp(std::string(token.substr(0, 5)).c_str(), "<?xml") == 0)
        return misplacedDeclaration;
    if (startsWith(rest, ">") && before.size() > 1 && before.substr(before.size() - 2) == "]]")
        return "']]>' inside a text; its '>' is written &gt;";
    if (startsWith(rest, "<") && !startsWith(token, "<?"))
        return "'<' inside an attribute's value or a tag; as text it is written &lt;";
    if (startsBeyondAscii(rest))
        return "no XML name: " + getName(refusal.text, refusal.place);
    return getPlainWords(refusal, "a tag that cannot be read");
}

/// Words for what the parser does not name. `fault` is moved to the place that they speak of.
std::string getTextWords(XmlRefusal const& refusal, std::size_t& fault)
{
    auto const& [error, line, text, begin, place, openElement, encoding] = refusal;
    std::string_view const rest = text.substr(place);
    if (startsBeyondAscii(rest) && !encoding.empty() && strcasecmp(encoding.c_str(), "UTF-8") != 0)
        return getPlainWords(refusal, "a character that cannot stand there in the encoding " +
                                          LiStringUtil::getPrintable(encoding));
    if (auto const offence = XmlSyntax::findOffence(rest.substr(0, longestCharacter)); offence && offence->offset == 0)
        return std::string(offence->words) + ": " + LiStringUtil::getPrintable(text, place);
    bool const hasMark = begin == 0 && startsWith(text, byteOrderMark);
    std::string_view const token = text.substr(hasMark ? byteOrderMark.size() : begin);
    if (openElement.empty() && startsWith(token, byteOrderMark))
        return "a byte order mark that is not the first thing in the text";
    if (openElement.empty() && (!startsWith(token, "<") || startsWith(token, "<![CDATA[")))
    {
        fault = begin;
        return "text outside of the root element: " + LiStringUtil::getPrintable(token);
    }
    if (startsWith(token, "<!DOCTYPE"))
        return documentType;
    if (error == XML_ERROR_JUNK_AFTER_DOC_ELEMENT && token.find_first_of("!?/") != 1)
        return "a second root element: " + getName(text, begin + 1);
    if (error == XML_ERROR_UNCLOSED_TOKEN)
        return getPlainWords(refusal, "what begins here is not closed");
    return error == XML_ERROR_INVALID_TOKEN ? getTokenWords(refusal, token)
                                            : getPlainWords(refusal, XML_ErrorString(error));
}

/// Words for the refusal. `fault` is moved to the place that they speak of, where that is another.
std::string getWords(XmlRefusal const& refusal, std::size_t& fault)
{
    auto const& [error, line, text, begin, place, openElement, encoding] = refusal;
    switch (error)
    {
    case XML_ERROR_DUPLICATE_ATTRIBUTE:
        return "attribute " + getName(text, place) + " stands twice in element " + getName(text, begin + 1);
    case XML_ERROR_UNDEFINED_ENTITY:
        fault = findReference(text, place);
        [[fallthrough]];
    case XML_ERROR_BAD_CHAR_REF:
        return "no reference to a character of XML: " +
               LiStringUtil::getPrintable(text.substr(fault, text.find(';', fault) + 1 - fault));
    case XML_ERROR_UNKNOWN_ENCODING:
        return "the encoding is not UTF-8 but " + LiStringUtil::getPrintable(encoding);
    case XML_ERROR_INCORRECT_ENCODING:
        return "the text is not in the encoding that it declares: " + LiStringUtil::getPrintable(encoding);
    case XML_ERROR_XML_DECL:
        return "no XML declaration of version 1: " + LiStringUtil::getPrintable(text);
    case XML_ERROR_MISPLACED_XML_PI:
        return misplacedDeclaration;
    case XML_ERROR_ABORTED:
        return documentType;
    case XML_ERROR_TAG_MISMATCH:
    case XML_ERROR_NO_ELEMENTS:
        return getPlainWords(refusal, openElement + " is not closed");
    default:
        return getTextWords(refusal, fault);
    }
}

} // namespace

void XmlRefusal::raise() const
{
    if (error == XML_ERROR_NO_MEMORY)
        throw std::bad_alloc();
    std::size_t fault = place;
    std::string const words = getWords(*this, fault);
    int const faultLine = fault < place ? line - countLines(text.substr(fault, place - fault))
                                        : line + countLines(text.substr(place, fault - place));
    throw XmlError(__FILE__, __LINE__, faultLine, words);
}

} // namespace Kv
