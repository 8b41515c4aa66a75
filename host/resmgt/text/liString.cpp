#include "text/liString.h"

#include <utility>

namespace Kv
{

LiString::LiString() = default;

LiString::LiString(LiString const&) = default;

LiString::LiString(LiString&&) noexcept = default;

LiString& LiString::operator=(LiString const&) = default;

LiString& LiString::operator=(LiString&&) noexcept = default;

LiString::~LiString() = default;

LiString::LiString(char const* text) : _text(text ? text : "") {}

LiString::LiString(std::string text) : _text(std::move(text)) {}

char const* LiString::getChars() const
{
    return _text.c_str();
}

std::string const& LiString::toString() const
{
    return _text;
}

bool LiString::isEmpty() const
{
    return _text.empty();
}

bool operator==(LiString const& a, LiString const& b)
{
    return a.toString() == b.toString();
}

bool operator!=(LiString const& a, LiString const& b)
{
    return !(a == b);
}

} // namespace Kv
