#include "fwCompositionWriter.h"

#include "fwCompositionFormat.h"
#include "piNode.h"
#include "xml/xmlWriter.h"

#include <sstream>
#include <string>

namespace Kv
{

namespace Format = FwCompositionFormat;

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
    XmlWriter writer(stream, indent);
    writer.openTag(Format::composition);
    writer.writeAttrib(Format::version, std::to_string(Format::currentVersion));
    for (RCShdPtr<const PiNode> const& node : graph.getNodes())
        writeNode(writer, *node);
    writer.closeTag();
    return stream.str();
}

} // namespace Kv
