#include "fwCompositionXml.h"

#include "files/osFile.h"
#include "piGraph.h"
#include "text/liString.h"
#include "xml/xmlDocument.h"
#include "xml/xmlError.h"
#include "xml/xmlWriter.h"

#include <algorithm>
#include <charconv>
#include <cstdint>
#include <initializer_list>
#include <optional>
#include <sstream>
#include <string>
#include <system_error>

namespace Kv
{

namespace
{

/// The words of a composition's file: an element for the whole, in it the nodes, in each its values and inputs, all of
/// them with attributes and nothing else. An input refers to any node of the file by its name.
namespace Format
{

constexpr char const* composition = "composition";
constexpr char const* node = "node";
constexpr char const* value = "value";
constexpr char const* input = "input";

/// Of the whole: the version of these words. A file without one is of the first.
constexpr char const* version = "version";
constexpr int currentVersion = 1;

/// Of a node, a value or an input.
constexpr char const* name = "name";
/// Of a node.
constexpr char const* type = "type";
/// Of a value.
constexpr char const* text = "text";

} // namespace Format

[[noreturn]] void fail(int line, std::string const& words)
{
    throw XmlError(__FILE__, __LINE__, line, words);
}

[[noreturn]] void fail(XmlElement const& element, std::string const& words)
{
    fail(element.getLine(), words);
}

/// Refuses what nobody would read: it may be a misspelt word.
void requireNothingElse(XmlElement const& element, std::initializer_list<std::string_view> attributeNames)
{
    if (std::optional<std::string> const name = element.findOtherAttribute(attributeNames))
        fail(element,
             "element '" + element.getName() + "' has an unknown attribute " + LiStringUtil::getPrintable(*name));
    if (element.hasText())
        fail(element, "element '" + element.getName() + "' holds a text");
}

void requireNoChildren(XmlElement const& element)
{
    for (XmlElement const& child : element.getChildren())
        fail(child, "unknown element " + LiStringUtil::getPrintable(child.getName()));
}

std::string getFilledAttribute(XmlElement const& element, char const* name)
{
    std::string text = element.getAttribute(name);
    if (text.empty())
        fail(element, "attribute '" + std::string(name) + "' of element '" + element.getName() + "' is empty");
    return text;
}

/// A file of a later version can hold what nobody here knows, and would lose it by the next save.
void requireKnownVersion(XmlElement const& root)
{
    std::optional<std::string> const text = root.findAttribute(Format::version);
    if (!text)
        return;
    int version = 0;
    char const* const end = text->data() + text->size();
    auto const [rest, error] = std::from_chars(text->data(), end, version);
    bool const isNumber = !text->empty() && rest == end && text->front() != '-' && text->front() != '0';
    if (!isNumber)
        fail(root, "attribute 'version' of element 'composition' is no version: " + LiStringUtil::getPrintable(*text));
    if (error != std::errc() || version > Format::currentVersion)
        fail(root, "a later version of the application has written it, in version " +
                       LiStringUtil::getPrintable(*text) + " of the format; this one reads version " +
                       std::to_string(Format::currentVersion));
}

/// `names` are those that the node has used for elements of this kind.
std::string readName(XmlElement const& element, std::set<std::string>& names)
{
    std::string name = getFilledAttribute(element, Format::name);
    if (!names.insert(name).second)
        fail(element, "there are two elements '" + element.getName() + "' named " + LiStringUtil::getPrintable(name) +
                          " in one node");
    return name;
}

} // namespace

std::vector<FwNode::Description> FwCompositionReader::read(OsFilePath const& path)
{
    // Far above any composition. What is larger was hardly meant, and would take the memory that all else needs.
    constexpr std::uint64_t maxSize = std::uint64_t(256) << 20;
    std::string const text = OsFile(path).read(maxSize);
    try
    {
        return parse(text);
    }
    catch (XmlError const& error)
    {
        throw ExBase(__FILE__, __LINE__,
                     "Cannot read the composition " + LiStringUtil::getPrintablePath(path.toString()) + ": " +
                         error.getReason());
    }
}

std::vector<FwNode::Description> FwCompositionReader::parse(std::string const& text)
{
    return FwCompositionReader(text)._nodes;
}

FwCompositionReader::FwCompositionReader(std::string const& text)
{
    RCShdPtr<XmlElement> const root = XmlDocument(text).getRoot();
    if (!root)
        fail(1, "there is no element");
    if (root->getName() != Format::composition)
        fail(*root, "the root element is " + LiStringUtil::getPrintable(root->getName()) + " and not '" +
                        Format::composition + "'");
    requireKnownVersion(*root);
    requireNothingElse(*root, {Format::version});
    for (XmlElement const& child : root->getChildren())
        readNode(child);
    requireReferencedNodes();
}

void FwCompositionReader::readNode(XmlElement const& element)
{
    if (element.getName() != Format::node)
        fail(element, "unknown element " + LiStringUtil::getPrintable(element.getName()));
    requireNothingElse(element, {Format::name, Format::type});
    FwNode::Description node;
    node.name = getFilledAttribute(element, Format::name);
    node.type = getFilledAttribute(element, Format::type);
    if (!_names.insert(node.name).second)
        fail(element, "there are two nodes named " + LiStringUtil::getPrintable(node.name));
    std::set<std::string> valueNames;
    std::set<std::string> inputNames;
    for (XmlElement const& child : element.getChildren())
    {
        requireNoChildren(child);
        if (child.getName() == Format::value)
        {
            requireNothingElse(child, {Format::name, Format::text});
            node.values.emplace_back(readName(child, valueNames), child.getAttribute(Format::text));
        }
        else if (child.getName() == Format::input)
        {
            requireNothingElse(child, {Format::name, Format::node});
            node.inputs.emplace_back(readName(child, inputNames), getFilledAttribute(child, Format::node));
            _references.push_back({child.getLine(), node.inputs.back().first, node.inputs.back().second});
        }
        else
            fail(child, "unknown element " + LiStringUtil::getPrintable(child.getName()));
    }
    _nodes.push_back(std::move(node));
}

void FwCompositionReader::requireReferencedNodes() const
{
    for (Reference const& reference : _references)
        if (_names.count(reference.nodeName) == 0)
            fail(reference.line, "input " + LiStringUtil::getPrintable(reference.inputName) + " refers to node " +
                                     LiStringUtil::getPrintable(reference.nodeName) + ", which is not there");
}

namespace
{

constexpr int indent = 2;

void writeEntry(XmlWriter& writer, char const* element, std::string const& name, char const* attribute,
                std::string const& text)
{
    writer.openTag(element);
    writer.writeAttrib(Format::name, name);
    writer.writeAttrib(attribute, text);
    writer.closeTag();
}

void writeNode(XmlWriter& writer, PiNode const& node)
{
    writer.openTag(Format::node);
    writer.writeAttrib(Format::name, node.getName());
    writer.writeAttrib(Format::type, node.getType());
    for (auto const& value : node.getValues())
        writeEntry(writer, Format::value, value.first, Format::text, value.second);
    for (auto const& input : node.getInputs())
        writeEntry(writer, Format::input, input.first, Format::node, input.second);
    writer.closeTag();
}

} // namespace

std::string FwCompositionWriter::write(PiGraph const& graph)
{
    std::ostringstream stream;
    // A lack of memory is told as one.
    stream.exceptions(std::ios::badbit);
    XmlWriter writer(stream, indent);
    writer.openTag(Format::composition);
    writer.writeAttrib(Format::version, std::to_string(Format::currentVersion));
    for (RCShdPtr<const PiNode> const& node : graph.getNodes())
        writeNode(writer, *node);
    writer.closeTag();
    return stream.str();
}

} // namespace Kv
