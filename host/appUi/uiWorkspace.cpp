#include "uiWorkspace.h"

#include "wsThread.h"

namespace Kv
{

namespace
{

RCShdPtr<UiWorkspace>& getCurrent()
{
    static RCShdPtr<UiWorkspace> current;
    return current;
}

} // namespace

UiView::~UiView() = default;

UiWorkspace::~UiWorkspace() = default;

RCShdPtr<UiWorkspace> UiWorkspace::getCurrentWorkspace()
{
    if (getCurrent())
        WsThread::require("Workspace");
    return getCurrent();
}

void UiWorkspace::setCurrentWorkspace(RCShdPtr<UiWorkspace> const& workspace)
{
    getCurrent() = workspace;
}

} // namespace Kv
