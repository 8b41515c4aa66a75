#include "commandLine.h"

#include <getopt.h>

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

ScriptCall readScript(ScriptCall::Kind kind, std::string const& target, int next, int argc, char** argv)
{
    return {kind, target, std::vector<std::string>(argv + next, argv + argc)};
}

} // namespace

CommandLine readCommandLine(int argc, char** argv)
{
    static option const options[] = {{"open", required_argument, nullptr, Open},
                                     {"exit", no_argument, nullptr, Exit},
                                     {"build-info", no_argument, nullptr, BuildInfo},
                                     {"help", no_argument, nullptr, 'h'},
                                     {nullptr, 0, nullptr, 0}};
    CommandLine line;
    optind = 1;
    // The plus: options end where the script begins. The colon: what is wrong is told from here.
    for (int found = 0; !line.script && (found = getopt_long(argc, argv, "+:hm:", options, nullptr)) != -1;)
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
            line.script = readScript(ScriptCall::Kind::Module, optarg, optind, argc, argv);
            break;
        default:
            throw UsageError(describeFault(argv[optind - 1], optopt));
        }
    if (!line.script && optind < argc)
        line.script = readScript(ScriptCall::Kind::File, argv[optind], optind + 1, argc, argv);
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
