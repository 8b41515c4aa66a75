#pragma once

#include <boost/python/list.hpp>

#include "files/osFilePath.h"
#include "pointers/rcShdPtr.h"
#include "pyGraph.h"

namespace Kv
{

/// The running application as a script sees it. Nothing is stored: every call asks the current workspace anew. Where
/// there is no application, each throws `UiError`.
class Workspace
{
public:
    /// Throws `UiError` where there is none.
    static RCShdPtr<ManagedGraph> getCurrentComposition();

    /// All open ones, in the order in which they were opened.
    static boost::python::list getCompositions();

    static unsigned int getNbCompositions();

    /// Makes the composition the current one; one that a script has read becomes one of the workspace.
    static void openComposition(RCShdPtr<ManagedGraph> const& graph);

    static bool isCompositionOpened(OsFilePath const& path);

    /// The paths of what is selected in the browser that has the keyboard; empty where none has.
    static boost::python::list getBrowserSelection();
};

} // namespace Kv
