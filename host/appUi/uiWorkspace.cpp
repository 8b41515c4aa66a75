#include "appUi/uiWorkspace.h"

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

UiWorkspace::~UiWorkspace() = default;

RCShdPtr<UiWorkspace> UiWorkspace::getCurrentWorkspace()
{
    return getCurrent();
}

void UiWorkspace::setCurrentWorkspace(RCShdPtr<UiWorkspace> const& workspace)
{
    getCurrent() = workspace;
}

} // namespace Kv
