#pragma once

#include "brBrowserFloatingHandler.h"
#include "piWidget.h"

#include <functional>
#include <string>

namespace Velmora
{

/// Asks the user for a file, in a browser that floats above the application.
class PathQuestion
{
public:
    /// `place` is where the browser begins; what is selected in the application is selected in it, if it is there.
    PathQuestion(char const* title, std::string const& place);
    PathQuestion(PathQuestion const&) = delete;
    PathQuestion& operator=(PathQuestion const&) = delete;

    /// Blocks until the user has chosen a file, whose path it gives, or has cancelled: then it is empty.
    std::string ask();

private:
    void onOk(Kv::EvEvent& event);

    Kv::BrBrowserFloatingHandler _handler;
    Kv::UiEventCallback<PathQuestion> _okCb;
    std::string _path;
};

} // namespace Velmora
