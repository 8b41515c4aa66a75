#pragma once

#include "exBase.h"
#include "kvExport.h"

namespace Kv
{

/// Thrown for what is wrong with an XML text, read or written.
class KV_API XmlError : public ExBase
{
public:
    /// `sourcePath` and `sourceLine` tell where it is thrown. `line` is the line of the text, from 1, which then stands
    /// in front of the words as "line N: "; or 0 where there is none.
    XmlError(char const* sourcePath, int sourceLine, int line, std::string const& words);

    /// The line of the text, from 1, or 0 where there is none.
    int getLine() const;

    ExBase* clone() const override;
    [[noreturn]] void raise() const override;

private:
    int _line;
};

} // namespace Kv
