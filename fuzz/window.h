#pragma once

#include "uiTopLevel.h"

namespace Kv::Fuzz
{

/// A window as a dialog has it.
inline RCShdPtr<UiTopLevel> makeWindow()
{
    return UiTopLevel::create("window", "Window",
                              WsWindowStyleUtils::getNormalWindowStyle({0, 400, 0, 300}, 0, BorderStyle(0),
                                                                       TitleBarStyle(0), TaskBarStyle(0),
                                                                       StackingStyle(0), CloseButtonStyle(1)),
                              nullptr);
}

} // namespace Kv::Fuzz
