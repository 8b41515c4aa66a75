#include "xml/xmlDocument.h"

#include "text/liString.h"
#include "xml/xmlError.h"
#include "xml/xmlRefusal.h"
#include "xml/xmlSyntax.h"
#include "xml/xmlTree.h"

#include <algorithm>
#include <exception>
#include <malloc.h>
#include <memory>
#include <new>
#include <strings.h>
#include <utility>

namespace Kv
{

namespace
{

// The parser gets a text in one piece, since in several a long comment costs the square of its length. It makes a
// buffer for it, of a power of two.
constexpr std::size_t maximumSize = std::size_t(1) << 30;

/// Reads one document into a tree.
class Reader
{
public:
    explicit Reader(std::string const& text) : _text(text), _parser(XML_ParserCreate(nullptr), &XML_ParserFree)
    {
        if (!_parser)
            throw std::bad_alloc();
        XML_SetUserData(_parser.get(), this);
        XML_SetElementHandler(_parser.get(), &call<&Reader::beginElement>, &call<&Reader::endElement>);
        XML_SetCharacterDataHandler(_parser.get(), &call<&Reader::addText>);
        XML_SetXmlDeclHandler(_parser.get(), &call<&Reader::checkDeclaration>);
        XML_SetStartDoctypeDeclHandler(_parser.get(), &call<&Reader::refuseType>);
        XML_SetDefaultHandler(_parser.get(), &call<&Reader::skip>);
    }

    /// Gives a tree without elements for a text without any.
    XmlTree read()
    {
        if (_text.size() > maximumSize)
            throw XmlError(__FILE__, __LINE__, 0, "a text of more than 1 GiB");
        XML_Status const status = XML_Parse(_parser.get(), _text.data(), static_cast<int>(_text.size()), XML_TRUE);
        if (_failure)
            std::rethrow_exception(_failure);
        bool const isEmpty = _tree.elements.empty() && XML_GetErrorCode(_parser.get()) == XML_ERROR_NO_ELEMENTS;
        if (status != XML_STATUS_OK && !isEmpty)
            refuse();
        return std::move(_tree);
    }

private:
    /// Exceptions do not cross the parser: it is stopped, and they are thrown on behind it.
    template <auto handler, typename... Args> static void call(void* reader, Args... args) noexcept
    {
        auto& self = *static_cast<Reader*>(reader);
        if (self._failure)
            return;
        try
        {
            (self.*handler)(args...);
            self._end = static_cast<std::size_t>(XML_GetCurrentByteIndex(self._parser.get())) +
                        static_cast<std::size_t>(XML_GetCurrentByteCount(self._parser.get()));
        }
        catch (...)
        {
            self._failure = std::current_exception();
            XML_StopParser(self._parser.get(), XML_FALSE);
        }
    }

    void beginElement(char const* name, char const** attributes)
    {
        if (_open.size() >= XmlSyntax::maximumDepth)
            fail("elements nested deeper than " + std::to_string(XmlSyntax::maximumDepth));
        _open.push_back(static_cast<std::uint32_t>(_tree.elements.size()));
        if (_texts.size() < _open.size())
            _texts.emplace_back();
        XmlTree::Element element{};
        element.name = _tree.append(name);
        element.line = getLine();
        element.firstAttribute = static_cast<std::uint32_t>(_tree.attributes.size());
        for (; *attributes; attributes += 2)
            _tree.attributes.push_back({_tree.append(attributes[0]), _tree.append(attributes[1])});
        element.attributesEnd = static_cast<std::uint32_t>(_tree.attributes.size());
        _tree.elements.push_back(element);
    }

    void endElement(char const* /*name*/)
    {
        std::string& text = _texts[_open.size() - 1];
        XmlTree::Element& element = _tree.elements[_open.back()];
        element.text = _tree.append(text);
        element.end = static_cast<std::uint32_t>(_tree.elements.size());
        text.clear();
        _open.pop_back();
    }

    void addText(char const* text, int size) { _texts[_open.size() - 1].append(text, static_cast<std::size_t>(size)); }

    void checkDeclaration(char const* version, char const* encoding, int /*standalone*/)
    {
        std::string_view const number = version;
        if (number.size() < 3 || number.substr(0, 2) != "1." ||
            number.find_first_not_of("0123456789", 2) != std::string_view::npos)
            fail("no XML declaration of version 1: " + LiStringUtil::getPrintable(_text));
        _encoding = encoding ? encoding : "";
        // A text from Python is UTF-8 here, whatever was said in the file that it comes from.
        auto const isAscii = [](char character) { return static_cast<unsigned char>(character) < 0x80; };
        if (strcasecmp(_encoding.c_str(), "ISO-8859-1") == 0 && LiStringUtil::isUtf8(_text) &&
            !std::all_of(_text.begin(), _text.end(), isAscii))
            fail("the text declares the encoding " + LiStringUtil::getPrintable(_encoding) + ", but is UTF-8");
    }

    void refuseType(char const* /*name*/, char const* /*system*/, char const* /*identifier*/, int /*hasSubset*/)
    {
        XML_StopParser(_parser.get(), XML_FALSE);
    }

    void skip(char const* /*markup*/, int /*size*/) {}

    int getLine() const { return static_cast<int>(XML_GetCurrentLineNumber(_parser.get())); }

    [[noreturn]] void fail(std::string const& words) const { throw XmlError(__FILE__, __LINE__, getLine(), words); }

    [[noreturn]] void refuse() const
    {
        auto const place = std::min(static_cast<std::size_t>(XML_GetCurrentByteIndex(_parser.get())), _text.size());
        std::string openElement;
        if (!_open.empty())
        {
            XmlTree::Element const& element = _tree.elements[_open.back()];
            openElement =
                "element '" + std::string(_tree.get(element.name)) + "' of line " + std::to_string(element.line);
        }
        XmlRefusal{
            XML_GetErrorCode(_parser.get()), getLine(), _text, std::min(_end, place), place, openElement, _encoding}
            .raise();
    }

    std::string const& _text;
    std::unique_ptr<XML_ParserStruct, decltype(&XML_ParserFree)> _parser;
    XmlTree _tree;
    /// The indices of the elements that are open, and by the depth the texts in them.
    std::vector<std::uint32_t> _open;
    std::vector<std::string> _texts;
    std::string _encoding;
    /// The place behind the last tag, text or whatever it was that has been read.
    std::size_t _end = 0;
    std::exception_ptr _failure;
};

} // namespace

XmlDocument::XmlDocument(std::string const& text) : _size(text.size())
{
    auto const tree = std::make_shared<XmlTree const>(Reader(text).read());
    if (!tree->elements.empty())
        _root = makeShd<XmlElement>(tree, 0);
}

XmlDocument::~XmlDocument()
{
    // The memory of a large document lies below that of what was made from it, and would stay with the process.
    constexpr std::size_t large = std::size_t(1) << 22;
    _root.reset();
    if (_size > large)
        malloc_trim(0);
}

RCShdPtr<XmlElement> XmlDocument::getRoot() const
{
    return _root;
}

} // namespace Kv
