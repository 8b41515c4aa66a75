#include "application.h"
#include "buildInfo.h"
#include "commandLine.h"
#include "interpreter.h"
#include "stopWindow.h"
#include "theme.h"

#include "exBase.h"
#include "packages/inBuildInfo.h"
#include "wsNative.h"

#include <QCoreApplication>

#include <fcntl.h>
#include <filesystem>
#include <iostream>
#include <memory>

namespace
{

using namespace Velmora;

constexpr int usageStatus = 2;

/// Before a window opens: what cannot be run is told on the terminal.
void requireScript(ScriptCall const& script)
{
    std::error_code error;
    if (script.kind == ScriptCall::Kind::File && !std::filesystem::exists(script.target, error))
        throw UsageError("there is no script \"" + script.name + "\"");
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
        Interpreter const interpreter;
        writeBuildInfo(std::cout);
        return 0;
    }
    if (line.script)
        requireScript(*line.script);
    Kv::InBuildInfoUtil::setApplicationMode(Kv::ApplicationModes::Interactive);
    // Qt starts here.
    Kv::WsNative::getPlatform();
    applyTheme();
    // The streams of Python copy what they write to it to the end.
    ScriptOutput output;
    // The window goes while scripts can still hear of it. Where a script has deleted the application object it has lost
    // its screen already, and Qt cannot take the rest down.
    static auto& application = *new std::unique_ptr<Application>;
    Interpreter interpreter({[]
                             {
                                 if (QCoreApplication::instance())
                                     application.reset();
                             },
                             []
                             {
                                 if (application)
                                     application->keepUnsaved();
                             }});
    // A script that has the application to itself finds it as it is for everybody.
    application = std::make_unique<Application>(interpreter, output, !line.exit);
    for (std::string const& path : line.compositions)
        application->openComposition(path);
    int const status = application->run(line.script, line.exit);
    return interpreter.finish(status);
}

/// Opens the standard streams that are closed: else another file would get their number, and would be written to.
void openStandardStreams()
{
    for (int stream = 0; stream <= 2; ++stream)
        if (fcntl(stream, F_GETFD) == -1)
            static_cast<void>(open("/dev/null", O_RDWR));
}

} // namespace

int main(int argc, char** argv)
{
    openStandardStreams();
    try
    {
        if (StopWindow::isWanted(argc, argv))
            return StopWindow::run(argv);
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
