#include "text/liStringSubstituter.h"

#include "exBase.h"
#include "text/liString.h"

#include <algorithm>

namespace Kv
{

LiStringSubstituter::LiStringSubstituter() = default;

LiStringSubstituter::~LiStringSubstituter() = default;

void LiStringSubstituter::add(std::string const& pattern, CbHandler<std::string>* handler)
{
    if (pattern.empty())
        throw ExBase(__FILE__, __LINE__, "The pattern of a substitution is empty");
    if (!handler)
        throw ExBase(__FILE__, __LINE__, "No handler for the pattern " + LiStringUtil::getPrintable(pattern));
    _rules.push_back({pattern, handler});
    if (_firstBytes.find(pattern.front()) == std::string::npos)
        _firstBytes += pattern.front();
}

std::string LiStringSubstituter::substitute(std::string const& text) const
{
    std::string result;
    result.reserve(text.size());
    std::size_t copied = 0;
    std::size_t position = findFirstByte(text, 0);
    while (position != std::string::npos)
    {
        std::size_t next = position + 1;
        if (Rule const* const rule = findRule(text, position))
        {
            std::string replacement = rule->pattern;
            next = position + rule->pattern.size();
            rule->handler->call(replacement);
            result.append(text, copied, position - copied);
            result += replacement;
            copied = next;
        }
        position = findFirstByte(text, next);
    }
    return result.append(text, copied);
}

std::size_t LiStringSubstituter::findFirstByte(std::string const& text, std::size_t from) const
{
    // The search for one byte is many times as fast as that for one of several.
    return _firstBytes.size() == 1 ? text.find(_firstBytes.front(), from) : text.find_first_of(_firstBytes, from);
}

LiStringSubstituter::Rule const* LiStringSubstituter::findRule(std::string const& text, std::size_t position) const
{
    auto const matches = [&](Rule const& rule)
    { return text.compare(position, rule.pattern.size(), rule.pattern) == 0; };
    auto const rule = std::find_if(_rules.begin(), _rules.end(), matches);
    return rule == _rules.end() ? nullptr : &*rule;
}

} // namespace Kv
