#pragma once

#include "resmgt/xmlLines.h"

#include <pugixml.hpp>
#include <string>
#include <string_view>
#include <vector>

namespace Kv
{

/// Walks the nodes of a document as the parser leaves them, decodes their values, and throws `XmlError` for everything
/// that XML does not allow but the parser lets pass.
class XmlChecker : public pugi::xml_tree_walker
{
public:
    /// Names and values of the nodes lie in `text`, where they are decoded in place. Both are borrowed.
    XmlChecker(std::string& text, XmlLines const& lines);

    bool for_each(pugi::xml_node& node) override;

private:
    void checkTopLevel(pugi::xml_node node);
    void checkElement(pugi::xml_node node);
    void checkAttributes(pugi::xml_node node);
    void checkComment(char const* value) const;
    void requireName(char const* name) const;

    void decode(char const* value, char const* special, char lineEnd) const;
    void decodeReference(char const*& in, char*& out) const;

    [[noreturn]] void fail(char const* place, std::string const& words) const;

    std::string& _text;
    XmlLines const& _lines;
    bool _hasRoot = false;
    std::vector<std::string_view> _attributeNames;
};

} // namespace Kv
