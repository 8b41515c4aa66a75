#include "assertions.h"

namespace Kv
{

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
