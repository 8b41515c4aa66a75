#pragma once

#include "resmgt/kvResmgtExport.h"

#include <filesystem>
#include <string>

namespace Kv
{

/// Path of a file: a list of components, of which a default path and one made from the empty string have none.
class KVRESMGT_API OsFilePath
{
public:
    OsFilePath() = default;

    /// Keeps the path as it is given. Throws `ExBase` for one with a zero byte, behind which the system would not look.
    explicit OsFilePath(std::string const& path);

    /// The path as given, ended by a zero byte; borrowed, valid while the path lives unchanged.
    char const* getChars() const;

    std::string toString() const;

    /// True for a path without components.
    bool isEmpty() const;

private:
    std::filesystem::path _path;
};

} // namespace Kv
