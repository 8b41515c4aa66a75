#pragma once

#include "kvExport.h"

#include <string>

namespace Kv
{

/// The host's string: bytes, as a rule UTF-8, of any content.
class KV_API LiString
{
public:
    LiString();
    LiString(LiString const&);
    LiString(LiString&&) noexcept;
    LiString& operator=(LiString const&);
    LiString& operator=(LiString&&) noexcept;
    ~LiString();

    /// A null text gives the empty string.
    LiString(char const* text);
    LiString(std::string text);

    /// The text ended by a zero byte; borrowed, valid while the string lives unchanged.
    char const* getChars() const;

    /// The whole text, with any zero bytes in it.
    std::string const& toString() const;

    bool isEmpty() const;

private:
    std::string _text;
};

KV_API bool operator==(LiString const& a, LiString const& b);
KV_API bool operator!=(LiString const& a, LiString const& b);

} // namespace Kv
