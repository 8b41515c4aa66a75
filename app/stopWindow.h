#pragma once

#include "busyWatch.h"

#include <string>
#include <vector>

/// The window by which a script is stopped that keeps the application's own window from answering. It is all that its
/// process shows.
namespace Velmora::StopWindow
{

/// The command line of the process. Its standard input is the connection to the application.
std::vector<std::string> makeCommand(BusyWatch::Offer const& offer);

/// True if the process was started for that.
bool isWanted(int argc, char** argv);

/// Runs the window, and gives the exit status.
int run(char** argv);

} // namespace Velmora::StopWindow
