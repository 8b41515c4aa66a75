#include "resmgt/xmlTree.h"

#include "resmgt/liStringUtil.h"
#include "resmgt/xmlChecker.h"
#include "resmgt/xmlDeclaration.h"
#include "resmgt/xmlSyntax.h"

#include <new>

namespace Kv
{

namespace
{

constexpr std::string_view byteOrderMark = "\xef\xbb\xbf";

// The parser drops the last character behind the root, and overlooks a '<' that ends the text: these come last instead.
constexpr std::string_view padding = "\n\n";

// References stay undecoded and nothing is dropped, so that all of it can be checked.
constexpr unsigned int parseOptions = pugi::parse_fragment | pugi::parse_ws_pcdata | pugi::parse_cdata |
                                      pugi::parse_comments | pugi::parse_pi | pugi::parse_declaration |
                                      pugi::parse_doctype;

bool hasMark(std::string_view text)
{
    return text.substr(0, byteOrderMark.size()) == byteOrderMark;
}

std::string_view withoutMark(std::string_view text)
{
    return hasMark(text) ? text.substr(byteOrderMark.size()) : text;
}

std::string padded(std::string_view text)
{
    std::string result;
    result.reserve(text.size() + padding.size());
    return result.append(text).append(padding);
}

} // namespace

XmlTree::XmlTree(std::string const& text) : XmlTree(withoutMark(text)) {}

XmlTree::XmlTree(std::string_view text) : _text(padded(text)), _lines(text)
{
    if (auto const offence = XmlSyntax::findOffence(text))
        _lines.fail(offence->offset,
                    std::string(offence->words) + ": " + LiStringUtil::getPrintable(text, offence->offset));
    parse(text, XmlDeclaration::check(text, _lines));
    XmlChecker checker(_text, _lines);
    _document.traverse(checker);
}

XmlTree::~XmlTree() = default;

pugi::xml_node XmlTree::getRoot() const
{
    return _document.document_element();
}

int XmlTree::getLine(char const* place) const
{
    return _lines.getLine(static_cast<std::size_t>(place - _text.data()));
}

/// `original` is the text as the parser finds it, for the words: it changes its own.
void XmlTree::parse(std::string_view original, std::size_t begin)
{
    // The parser would skip a mark here without a word.
    if (hasMark(original.substr(begin)))
        _lines.fail(begin, "a byte order mark that is not the first thing in the text");
    pugi::xml_parse_result const result =
        _document.load_buffer_inplace(_text.data() + begin, _text.size() - begin, parseOptions, pugi::encoding_utf8);
    if (result.status == pugi::status_out_of_memory)
        throw std::bad_alloc();
    if (!result)
    {
        std::size_t const offset = begin + static_cast<std::size_t>(result.offset);
        _lines.fail(offset, std::string("no well-formed XML: ") + result.description() + " near " +
                                LiStringUtil::getPrintable(original, offset));
    }
}

} // namespace Kv
