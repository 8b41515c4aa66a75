"""The workspace and the browser where there is no application, and compositions that scripts read themselves."""

import os
import pathlib
from concurrent.futures import ThreadPoolExecutor

import pytest

from quorvane_velmora import graph, ui
from scripts import run_script

COMPOSITION = '''<composition version="1">
  <node name="Grade" type="ColourGrade">
    <value name="gain" text="1"/>
    <input name="source" node="Plate"/>
  </node>
  <node name="Plate" type="Read"/>
</composition>
'''


@pytest.fixture
def shot(tmp_path):
    path = tmp_path / 'shot.vmcomposition'
    path.write_text(COMPOSITION)
    return path


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


@pytest.mark.standalone
@pytest.mark.parametrize('arguments, keywords', [(['t'], {}), (['t', '/', len], {}), ([], {'title': 't'}), (
    ['t'], {'initialPath': b'/\xff', 'pathValidationCb': 5})])
def test_there_is_no_browser_outside_the_application_whatever_the_arguments(arguments, keywords):
    with pytest.raises(ui.UiError) as refused:
        ui.showBrowser(*arguments, **keywords)
    assert str(refused.value) == 'ui.showBrowser() can only be used within Velmora.'


@pytest.mark.parametrize('no_graph', [None, 'shot.vmcomposition', 1, ui.Workspace()])
def test_only_a_graph_can_be_opened(no_graph):
    with pytest.raises(TypeError) as caught:
        ui.Workspace.openComposition(no_graph)
    assert type(caught.value).__name__ == 'ArgumentError'


@pytest.mark.standalone
def test_a_composition_is_read_changed_and_saved_without_a_window(shot):
    run_script('''
import os, sys
from quorvane_velmora import graph
os.chdir(os.path.dirname(sys.argv[1]))
shot = graph.readComposition(path='shot.vmcomposition')
assert type(shot) is graph.Graph and (shot.getName(), shot.getPath()) == ('shot', os.path.realpath(sys.argv[1]))
assert shot.isWritable() and shot.getNodes() == ['Grade', 'Plate'] and shot.getNodeInputs('Grade') == {'source': 'Plate'}
shot.setNodeValue('Grade', 'gain', '2')
shot.save()
assert graph.readComposition(shot.getPath()).getNodeValues('Grade') == {'gain': '2'}
with open('/proc/self/maps') as maps:
    assert 'libQt' not in maps.read()
''', str(shot))
    assert shot.read_text() == COMPOSITION.replace('"1"/', '"2"/')


@pytest.mark.parametrize('text, words', [
    (None, 'No such file'),
    (COMPOSITION.replace('"Plate"/', '"None"/'), "line 4: input 'source' refers to node 'None'"),
])
def test_a_file_that_holds_no_composition_is_told_with_its_path(shot, text, words):
    shot.write_text(text) if text else shot.unlink()
    with pytest.raises(graph.GraphError) as refused:
        graph.readComposition(str(shot))
    assert str(shot) in str(refused.value) and words in str(refused.value)
    with pytest.raises(graph.GraphError):
        graph.readComposition('')


@pytest.mark.parametrize('no_path, failure', [(None, TypeError), (5, TypeError), ('a\0b', ValueError)])
@pytest.mark.parametrize('take', [graph.readComposition, lambda path: ui.showBrowser('t', path)])
def test_what_is_no_path_is_refused(take, no_path, failure):
    with pytest.raises(failure):
        take(no_path)


@pytest.mark.parametrize('kind', [os.fsencode, os.fsdecode, pathlib.Path])
def test_the_path_may_be_bytes_and_no_text(shot, kind):
    path = shot.rename(shot.with_name('shot \udcff.vmcomposition'))
    shot = graph.readComposition(kind(path))
    assert (shot.getName(), shot.getPath()) == ('shot \udcff', os.path.realpath(path))


def test_what_cannot_be_written_when_it_is_read_only_reads(shot):
    shot.chmod(0o444)
    locked = graph.readComposition(shot)
    shot.chmod(0o644)
    free = graph.readComposition(shot)
    free.setNodeValue('Plate', 'file', 'a.exr')
    shot.write_text(COMPOSITION + '<!-- changed -->')
    for call, words in ((lambda: locked.setNodeValue('Plate', 'file', 'a.exr'), 'is read-only'), (locked.save, 'is read-only'),
                        (free.save, 'has been changed on disk since it was opened')):
        with pytest.raises(graph.GraphError, match=words):
            call()
    assert not locked.isWritable() and free.isWritable() and 'changed' in shot.read_text()


def test_a_composition_is_for_the_thread_of_the_user_interface(shot):
    graph.readComposition(shot)
    with ThreadPoolExecutor() as threads, pytest.raises(graph.GraphError, match='another thread'):
        threads.submit(graph.readComposition, shot).result()
