#pragma once

#include "kvExport.h"
#include "pointers/rcBase.h"

#include <cstdint>
#include <initializer_list>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace Kv
{

struct XmlTree;

/// An element of a document that has been read. Cheap to copy; each keeps the whole document alive. All texts are
/// UTF-8 with their references decoded.
class KV_API XmlElement : public RCBase<LkCounter<int>>
{
public:
    /// `index` is that of the element in the tree. `XmlDocument` makes the first one, the elements give the others.
    XmlElement(std::shared_ptr<XmlTree const> tree, std::uint32_t index);

    std::string getName() const;
    bool isNamed(std::string_view name) const;

    /// The line, from 1, where the element begins.
    int getLine() const;

    /// Nothing where there is no such attribute.
    std::optional<std::string> findAttribute(std::string_view name) const;

    /// Throws `XmlError`, naming element and attribute, where there is no such attribute.
    std::string getAttribute(std::string_view name) const;

    /// The names of all attributes, as they stand in the document.
    std::vector<std::string> getAttributeNames() const;

    /// The name of the first attribute that is none of these; nothing where there is none.
    std::optional<std::string> findOtherAttribute(std::initializer_list<std::string_view> known) const;

    /// The elements directly in this one, in order.
    std::vector<XmlElement> getChildren() const;

    /// The first of the elements directly in this one that has the name.
    std::optional<XmlElement> findChild(std::string_view name) const;

    /// All text directly in this element, also from CDATA sections, joined, with all its white space.
    std::string getText() const;

    /// True where `getText` is more than white space.
    bool hasText() const;

private:
    std::shared_ptr<XmlTree const> _tree;
    std::uint32_t _index;
};

} // namespace Kv
