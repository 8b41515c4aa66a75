#pragma once

#include "exBase.h"

#include <gtest/gtest.h>
#include <string>

namespace Kv
{

/// The words of the exception that `action` must end with.
template <typename Exception = ExBase, typename Action> std::string wordsOf(Action const& action)
{
    try
    {
        action();
    }
    catch (Exception const& exception)
    {
        return exception.getReason();
    }
    ADD_FAILURE() << "nothing was refused";
    return {};
}

inline void expectContains(std::string const& text, std::string const& part)
{
    EXPECT_NE(text.find(part), std::string::npos) << "no \"" << part << "\" in \"" << text << "\"";
}

} // namespace Kv
