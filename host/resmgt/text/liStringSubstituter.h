#pragma once

#include "cbHandler.h"
#include "kvExport.h"

#include <string>
#include <vector>

namespace Kv
{

/// Replaces patterns in a text by what handlers give for them.
class KV_API LiStringSubstituter
{
public:
    LiStringSubstituter();
    LiStringSubstituter(LiStringSubstituter const&) = delete;
    LiStringSubstituter& operator=(LiStringSubstituter const&) = delete;
    ~LiStringSubstituter();

    /// The handler is borrowed until the last `substitute`. It is called once per occurrence, with a string that holds
    /// the pattern, and leaves there what replaces it. Throws `ExBase` for an empty pattern or no handler.
    void add(std::string const& pattern, CbHandler<std::string>* handler);

    /// The text with every occurrence replaced, in one pass from left to right: what came in is not searched again.
    /// Where two patterns match at one place, the one added first wins. Whatever a handler throws passes through.
    std::string substitute(std::string const& text) const;

private:
    struct Rule
    {
        std::string pattern;
        CbHandler<std::string>* handler;
    };

    /// The next place at which a pattern can begin.
    std::size_t findFirstByte(std::string const& text, std::size_t from) const;
    Rule const* findRule(std::string const& text, std::size_t position) const;

    std::vector<Rule> _rules;
    std::string _firstBytes;
};

} // namespace Kv
