#pragma once

#include <optional>
#include <stdexcept>
#include <string>
#include <vector>

namespace Velmora
{

/// A script with its arguments, all in the bytes that the system gave.
struct ScriptCall
{
    enum class Kind
    {
        File,
        Module,
    };

    /// A script is found again by its absolute path, wherever the process goes meanwhile.
    static ScriptCall makeFile(std::string const& path, std::vector<std::string> arguments);

    Kind kind = Kind::File;
    /// The script as it was named, or the module.
    std::string name;
    /// The script's absolute path, or the module's name.
    std::string target;
    std::vector<std::string> arguments;
};

/// The task of the application, as its command line gives it.
struct CommandLine
{
    /// Paths of composition files, in order.
    std::vector<std::string> compositions;
    /// True to end with the script.
    bool exit = false;
    bool help = false;
    bool buildInfo = false;
    std::optional<ScriptCall> script;
};

/// A command line that says nothing sensible; the words are for its author.
class UsageError : public std::runtime_error
{
public:
    using std::runtime_error::runtime_error;
};

/// Throws `UsageError`. What comes behind the script or the module is the script's.
CommandLine readCommandLine(int argc, char** argv);

/// The text of `--help`.
char const* getUsage();

} // namespace Velmora
