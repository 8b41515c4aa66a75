#include <boost/python.hpp>

#include "pyWorkspace.h"

#include "brBrowsable.h"
#include "exBase.h"
#include "piCompositionGraphInterface.h"
#include "piGraph.h"
#include "pointers/plainPtr.h"
#include "pointers/rcWeakPtr.h"
#include "pyUiError.h"
#include "snSelection.h"
#include "uiCompositionWorkspace.h"
#include "uiWorkspace.h"

namespace bp = boost::python;

namespace Kv
{

namespace
{

using CompWorkspace = UPtr<UiCompositionWorkspaceClientInterface>;
using Composition = RCWeakPtr<const PiCompositionGraphInterface>;
using WritableComposition = RCWeakPtr<PiCompositionGraphInterface>;

RCShdPtr<UiWorkspace> getUiWorkspace()
{
    RCShdPtr<UiWorkspace> workspace = UiWorkspace::getCurrentWorkspace();
    if (workspace.isNull())
        throw PyextUi::UiError(__FILE__, __LINE__,
                               "Ui workspace access only available within interactive application.");
    return workspace;
}

/// Borrowed from the workspace.
CompWorkspace getCompWorkspace(RCShdPtr<UiWorkspace> const& workspace)
{
    CompWorkspace const compWorkspace(dynamic_cast<UiCompositionWorkspaceClientInterface*>(workspace.get()));
    if (compWorkspace.isNull())
        Assertions::throwAssertionFailed(__FILE__, __LINE__, "! compWorkspace.isNull()");
    return compWorkspace;
}

/// The same composition without the const, which only its node can give; expired where it must not be changed.
WritableComposition getWritableComposition(Composition const& composition, CompWorkspace const& compWorkspace)
{
    if (composition.isExpired() || compWorkspace.isNull())
        return {};
    RCWeakPtr<const PiNodeController> const controller(composition);
    if (controller.isExpired())
        RCExUtil::throwExCastFailed(typeid(PiCompositionGraphInterface const*).name(),
                                    typeid(PiNodeController const*).name());
    RCShdPtr<const PiNode> const node = RCWeakAccessor<const PiNodeController>(controller)->getNode();
    RCShdPtr<const PiGraph> const graph = node->getGraph();
    RCWeakAccessor<const PiNodeController> const graphController(graph->getController());
    if (!compWorkspace->isCompositionEditable(graphController.castTo<const PiCompositionGraphInterface>()))
        return {};
    RCWeakAccessor<PiNodeController> const nodeController(const_cast<PiNode&>(*node).getController());
    return nodeController.castTo<PiCompositionGraphInterface>();
}

RCShdPtr<PyextGraph::Graph> makeGraph(Composition const& composition, CompWorkspace const& compWorkspace)
{
    if (compWorkspace->isCompositionEditable(composition))
    {
        RCWeakAccessor<PiCompositionGraphInterface> const writable(getWritableComposition(composition, compWorkspace));
        return makeShd<PyextGraph::Graph>(writable->getGraph());
    }
    RCWeakAccessor<const PiCompositionGraphInterface> const readOnly(composition);
    return makeShd<PyextGraph::Graph>(readOnly->getGraph());
}

RCShdPtr<ManagedGraph> makePyGraph(Composition const& composition, CompWorkspace const& compWorkspace)
{
    return makeShd<ManagedGraph>(makeGraph(composition, compWorkspace));
}

/// Null where the widget is none that shows a collection.
RCShdPtr<UiView> findView(UiWidget const& widget)
{
    RCShdPtr<RCBase<LkCounter<int>>> const* const data = widget.getClientDataListPtr();
    for (int i = 0; i < widget.getClientDataListSize(); ++i)
        if (RCShdPtr<UiView> view = dynamicCast<UiView>(data[i]))
            return view;
    return nullptr;
}

} // namespace

RCShdPtr<ManagedGraph> Workspace::getCurrentComposition()
{
    RCShdPtr<UiWorkspace> const workspace = getUiWorkspace();
    CompWorkspace const compWorkspace = getCompWorkspace(workspace);
    Composition const composition = compWorkspace->getCurrentComposition();
    if (composition.isExpired())
        throw PyextUi::UiError(__FILE__, __LINE__, "There is no current composition.");
    return makePyGraph(composition, compWorkspace);
}

bp::list Workspace::getCompositions()
{
    RCShdPtr<UiWorkspace> const workspace = getUiWorkspace();
    CompWorkspace const compWorkspace = getCompWorkspace(workspace);
    bp::list graphs;
    for (ConstIterator<Composition> compositions = compWorkspace->getCompositions(); !compositions.atEnd();
         ++compositions)
        graphs.append(makePyGraph(*compositions, compWorkspace));
    return graphs;
}

unsigned int Workspace::getNbCompositions()
{
    RCShdPtr<UiWorkspace> const workspace = getUiWorkspace();
    return getCompWorkspace(workspace)->getNbCompositions();
}

void Workspace::openComposition(RCShdPtr<ManagedGraph> const& graph)
{
    RCShdPtr<UiWorkspace> const workspace = getUiWorkspace();
    CompWorkspace const compWorkspace = getCompWorkspace(workspace);
    RCShdPtr<const PiGraph> const piGraph = graph->getValue()->getPiGraphRO();
    compWorkspace->openComposition(compWorkspace->getComposition(piGraph));
}

bool Workspace::isCompositionOpened(OsFilePath const& path)
{
    RCShdPtr<UiWorkspace> const workspace = getUiWorkspace();
    return getCompWorkspace(workspace)->isCompositionOpened(path);
}

bp::list Workspace::getBrowserSelection()
{
    RCShdPtr<UiWorkspace> const workspace = getUiWorkspace();
    bp::list paths;
    UPtr<UiWidget> const focus = workspace->getFocus();
    if (focus.isNull())
        return paths;
    RCShdPtr<UiView> const view = findView(*focus);
    if (view.isNull())
        return paths;
    RCShdPtr<SnSelection> const selection = view->getSelection();
    if (selection.isNull())
        return paths;
    using Convert = SnItemConvert<RCShdPtr<BrBrowsable>>;
    RCShdPtr<const SnSelection> const browsables = selection->filter(Convert::getPredicate());
    for (RCShdPtr<const SnItem> const& item : *browsables)
        paths.append(OsFilePath(Convert::get(item)->getPath().toString()));
    return paths;
}

template class PyManagedObject<RCShdPtr<PyextGraph::Graph>>;

} // namespace Kv
