#include "commandLine.h"

#include <array>
#include <filesystem>
#include <getopt.h>
#include <utility>

namespace Velmora
{

namespace
{

enum Option
{
    Open = 256,
    Exit,
    BuildInfo,
};

std::string describeFault(char const* argument, int option)
{
    std::string const shown = option > ' ' && option < Open ? std::string("-") + static_cast<char>(option) : argument;
    return shown + (option == Open || option == 'm' ? " needs an argument" : " is no option");
}

} // namespace

ScriptCall ScriptCall::makeFile(std::string const& path, std::vector<std::string> arguments)
{
    std::error_code nowhere;
    std::filesystem::path const absolute = std::filesystem::absolute(path, nowhere);
    return {Kind::File, path, nowhere ? path : absolute.string(), std::move(arguments)};
}

CommandLine readCommandLine(int argc, char** argv)
{
    static constexpr std::array<option, 5> options{{{"open", required_argument, nullptr, Open},
                                                    {"exit", no_argument, nullptr, Exit},
                                                    {"build-info", no_argument, nullptr, BuildInfo},
                                                    {"help", no_argument, nullptr, 'h'},
                                                    {nullptr, 0, nullptr, 0}}};
    CommandLine line;
    optind = 1;
    // The plus: options end where the script begins. The colon: what is wrong is told from here.
    for (int found = 0; !line.script && (found = getopt_long(argc, argv, "+:hm:", options.data(), nullptr)) != -1;)
        switch (found)
        {
        case Open:
            line.compositions.emplace_back(optarg);
            break;
        case Exit:
            line.exit = true;
            break;
        case BuildInfo:
            line.buildInfo = true;
            break;
        case 'h':
            line.help = true;
            break;
        case 'm':
            line.script = ScriptCall{ScriptCall::Kind::Module, optarg, optarg,
                                     std::vector<std::string>(argv + optind, argv + argc)};
            break;
        default:
            throw UsageError(describeFault(argv[optind - 1], optopt));
        }
    if (!line.script && optind < argc)
        line.script = ScriptCall::makeFile(argv[optind], std::vector<std::string>(argv + optind + 1, argv + argc));
    if (line.exit && !line.script)
        throw UsageError("--exit needs a script to end with");
    return line;
}

char const* getUsage()
{
    return R"(usage: velmora [--open FILE.vmcomposition]... [--exit] [SCRIPT | -m MODULE] [ARGUMENT]...

Opens the application, and runs a Python script in it.

  --open FILE     opens a composition; can be given more than once, the last one is the current one
  --exit          ends the application with the script, with the script's exit status
  -m MODULE       runs a module of Python's path as the script
  --build-info    prints every package that is there with its build information, and ends
  -h, --help      prints this text, and ends

All that follows the script or the module is handed to it.
)";
}

} // namespace Velmora
