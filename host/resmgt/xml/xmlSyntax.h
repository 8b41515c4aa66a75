#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <string_view>

/// The rules of XML that the reader and the writer share.
namespace Kv::XmlSyntax
{

/// The deepest nesting of elements; the root alone is one deep.
constexpr int maximumDepth = 1024;

/// True for the white space of XML.
constexpr bool isBlank(char character)
{
    return character == ' ' || character == '\t' || character == '\r' || character == '\n';
}

/// The first thing in a text that no XML document can hold.
struct Offence
{
    std::size_t offset;
    char const* words;
};

/// True for what may name an element or an attribute. Any bytes may be asked about.
bool isName(std::string const& text);

/// Nothing for a text of well-formed UTF-8 that is made of allowed characters.
std::optional<Offence> findOffence(std::string_view text);

} // namespace Kv::XmlSyntax
