#include "exBase.h"

#include <array>
#include <cstdio>
#include <utf8.h>
#include <utility>

namespace Kv
{

namespace
{

bool isInsideCharacter(char byte)
{
    constexpr unsigned char mask = 0xc0;
    constexpr unsigned char inside = 0x80;
    return (static_cast<unsigned char>(byte) & mask) == inside;
}

/// Takes out the middle of words that nobody would read to their end. What is wrong stands at either end.
std::string shorten(std::string text)
{
    constexpr std::size_t half = ExBase::mostBytes / 2;
    if (text.size() <= ExBase::mostBytes)
        return text;
    std::size_t from = half;
    std::size_t to = text.size() - half;
    while (from > 0 && isInsideCharacter(text[from]))
        --from;
    while (to < text.size() && isInsideCharacter(text[to]))
        ++to;
    return text.replace(from, to - from, " … ");
}

std::string makeReadable(std::string text)
{
    auto bad = utf8::find_invalid(text.begin(), text.end());
    while (bad != text.end())
    {
        std::array<char, 5> escape{};
        static_cast<void>(std::snprintf(escape.data(), escape.size(), "\\x%02x", static_cast<unsigned char>(*bad)));
        auto const offset = bad - text.begin();
        text.replace(bad, bad + 1, escape.data());
        bad = utf8::find_invalid(text.begin() + offset, text.end());
    }
    return text;
}

} // namespace

ExBase::ExBase(char const* sourcePath, int line, std::string reason)
    : _reason(makeReadable(shorten(std::move(reason)))),
      _detailedReason(_reason + " (" + sourcePath + ":" + std::to_string(line) + ")")
{
}

ExBase::ExBase(ExBase const&) = default;

ExBase& ExBase::operator=(ExBase const&) = default;

ExBase::~ExBase() = default;

char const* ExBase::what() const noexcept
{
    return _reason.c_str();
}

char const* ExBase::getReason() const
{
    return _reason.c_str();
}

char const* ExBase::getDetailedReason() const
{
    return _detailedReason.c_str();
}

ExBase* ExBase::clone() const
{
    return new ExBase(*this);
}

void ExBase::raise() const
{
    throw ExBase(*this);
}

ExBase* ExAssertionFailed::clone() const
{
    return new ExAssertionFailed(*this);
}

void ExAssertionFailed::raise() const
{
    throw ExAssertionFailed(*this);
}

void Assertions::throwAssertionFailed(char const* sourcePath, int line, char const* expression)
{
    throw ExAssertionFailed(sourcePath, line, std::string("Assertion failed: ") + expression);
}

} // namespace Kv
