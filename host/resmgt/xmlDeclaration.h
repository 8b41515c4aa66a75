#pragma once

#include "resmgt/xmlLines.h"

#include <cstddef>
#include <string_view>

/// The XML declaration, the optional first thing in a document.
namespace Kv::XmlDeclaration
{

/// The length in bytes of the declaration that `text` begins with, or 0. Throws `XmlError` for one that is malformed or
/// declares an encoding of which UTF-8 is no superset.
std::size_t check(std::string_view text, XmlLines const& lines);

} // namespace Kv::XmlDeclaration
