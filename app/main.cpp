#include "application.h"
#include "buildInfo.h"
#include "commandLine.h"
#include "interpreter.h"
#include "theme.h"

#include "base/exBase.h"
#include "base/inBuildInfoUtil.h"
#include "gfx/wsNative.h"

#include <cstdio>
#include <filesystem>
#include <iostream>

namespace
{

using namespace Velmora;

constexpr int usageStatus = 2;

/// Before a window opens: what cannot be run is told on the terminal.
void requireScript(ScriptCall const& script)
{
    std::error_code error;
    if (script.kind == ScriptCall::Kind::File && !std::filesystem::exists(script.target, error))
        throw UsageError("there is no script \"" + script.target + "\"");
}

int run(CommandLine const& line)
{
    if (line.help)
    {
        std::cout << getUsage();
        return 0;
    }
    if (line.buildInfo)
    {
        Interpreter().loadModules();
        writeBuildInfo(std::cout);
        return 0;
    }
    if (line.script)
        requireScript(*line.script);
    Kv::InBuildInfoUtil::setApplicationMode(Kv::ApplicationModes::Interactive);
    // The toolkit starts here.
    Kv::WsNative::getPlatform();
    applyTheme();
    Application application;
    for (std::string const& path : line.compositions)
        application.openComposition(path);
    return application.run(line.script, line.exit);
}

} // namespace

int main(int argc, char** argv)
{
    try
    {
        return run(readCommandLine(argc, argv));
    }
    catch (UsageError const& error)
    {
        std::cerr << "velmora: " << error.what() << "\nTry velmora --help.\n";
        return usageStatus;
    }
    catch (std::exception const& error)
    {
        std::cerr << "velmora: " << error.what() << '\n';
        return 1;
    }
}
