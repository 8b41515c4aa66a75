"""The workspace where there is no application."""

import pytest

from quorvane_velmora import graph, ui

REFUSED = 'Ui workspace access only available within interactive application.'


@pytest.mark.standalone
def test_there_is_no_workspace_outside_the_application():
    workspace = ui.Workspace()
    for owner in ui.Workspace, workspace:
        for name, arguments in (('getCurrentComposition', ()), ('getCompositions', ()), ('getNbCompositions', ()),
                                ('isCompositionOpened', ('shot.vmcomposition',)), ('getBrowserSelection', ())):
            with pytest.raises(ui.UiError) as caught:
                getattr(owner, name)(*arguments)
            assert str(caught.value) == REFUSED, name


@pytest.mark.parametrize('no_graph', [None, 'shot.vmcomposition', 1, ui.Workspace()])
def test_only_a_graph_can_be_opened(no_graph):
    with pytest.raises(TypeError) as caught:
        ui.Workspace.openComposition(no_graph)
    assert type(caught.value).__name__ == 'ArgumentError'


def test_scripts_make_no_graphs_and_have_one_exception_for_them():
    with pytest.raises(RuntimeError):
        graph.Graph()
    assert issubclass(graph.GraphError, Exception) and graph.GraphError is not ui.UiError
