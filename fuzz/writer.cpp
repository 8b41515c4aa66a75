// Documents that are written and read back: every string returns as it went, or the writer refused it.

#include "fuzz.h"

#include "xml/xmlDocument.h"
#include "xml/xmlError.h"
#include "xml/xmlWriter.h"

#include <fuzzer/FuzzedDataProvider.h>

#include <sstream>
#include <string>
#include <utility>
#include <vector>

using namespace Kv;

namespace
{

struct Node
{
    std::string name;
    std::vector<std::pair<std::string, std::string>> attributes;
    std::string text;
    std::vector<Node> children;
};

void requireSame(XmlElement const& read, Node const& written)
{
    Fuzz::require(read.getName() == written.name, "a name returns");
    std::vector<std::string> const names = read.getAttributeNames();
    Fuzz::require(names.size() == written.attributes.size(), "as many attributes return");
    for (std::size_t index = 0; index < names.size(); ++index)
    {
        Fuzz::require(names[index] == written.attributes[index].first, "an attribute's name returns");
        Fuzz::require(read.getAttribute(names[index]) == written.attributes[index].second, "a value returns");
    }
    std::vector<XmlElement> const children = read.getChildren();
    Fuzz::require(children.size() == written.children.size(), "as many elements return");
    Fuzz::require(children.empty() ? read.getText() == written.text : !read.hasText(), "a text returns");
    for (std::size_t index = 0; index < children.size(); ++index)
        requireSame(children[index], written.children[index]);
}

/// Calls the writer as the bytes say, and keeps what it took.
class Author
{
public:
    Author(std::uint8_t const* data, std::size_t size) : _bytes(data, size) {}

    void write()
    {
        while (_bytes.remaining_bytes() > 0)
            writeNext();
        while (!_open.empty())
            close();
        if (_roots.empty())
            return;
        requireSame(*XmlDocument(_stream.str()).getRoot(), _roots.front());
    }

private:
    /// True where the writer took it; where it did not, nothing has changed.
    template <typename Call> bool took(Call const& call)
    {
        std::string const before = _stream.str();
        try
        {
            call();
            return true;
        }
        catch (XmlError const&)
        {
            Fuzz::require(_stream.str() == before, "a refusal writes nothing");
            return false;
        }
    }

    Node& addNode(std::string const& name)
    {
        std::vector<Node>& siblings = _open.empty() ? _roots : _open.back()->children;
        return siblings.emplace_back(Node{name, {}, {}, {}});
    }

    void close()
    {
        _writer.closeTag();
        _open.pop_back();
    }

    void writeNext()
    {
        std::string const name = _bytes.ConsumeRandomLengthString(16);
        switch (_bytes.ConsumeIntegralInRange(0, 3))
        {
        case 0:
            if (took([&] { _writer.openTag(name); }))
                _open.push_back(&addNode(name));
            break;
        case 1:
        {
            std::string const value = _bytes.ConsumeRandomLengthString();
            if (took([&] { _writer.writeAttrib(name, value); }))
                _open.back()->attributes.emplace_back(name, value);
            break;
        }
        case 2:
        {
            std::string const text = _bytes.ConsumeRandomLengthString();
            if (took([&] { _writer.writeTag(name, text); }))
                addNode(name).text = text;
            break;
        }
        default:
            if (_open.empty())
                Fuzz::require(!took([&] { _writer.closeTag(); }), "only what is open can be closed");
            else
                close();
        }
    }

    FuzzedDataProvider _bytes;
    std::ostringstream _stream;
    XmlWriter _writer{_stream, 1};
    std::vector<Node> _roots;
    /// Nobody adds a sibling to one that is open.
    std::vector<Node*> _open;
};

} // namespace

extern "C" int LLVMFuzzerTestOneInput(std::uint8_t const* data, std::size_t size)
{
    Author(data, size).write();
    return 0;
}
