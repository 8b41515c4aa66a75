"""The tour through the application does what its page says."""

import pathlib
import runpy
import shutil

import pytest

import scripts
import stage
from quorvane_velmora import graph, ui
from PyQt6.QtCore import Qt
from PyQt6.QtTest import QTest
from PyQt6.QtWidgets import QApplication, QTreeView

pytestmark = [pytest.mark.inside, scripts.needs_pyqt]

EXAMPLES = pathlib.Path(__file__).parents[2] / 'examples'
SHOTS = ['1  shot_010', '2  shot_020']


def run(examples):
    runpy.run_path(str(examples / 'tour.py'), run_name='__main__')


@pytest.fixture
def examples(tmp_path):
    """A copy of the examples: what the tour saves is none of the project's files."""
    return shutil.copytree(EXAMPLES, tmp_path / 'examples')


@pytest.fixture
def closing():
    """Closes the compositions that a test leaves open."""
    yield
    while ui.Workspace.getNbCompositions():
        QTest.keyClick(stage.APPLICATION, Qt.Key.Key_W, Qt.KeyboardModifier.ControlModifier)


@pytest.fixture
def shots(examples, closing):
    """The folder of the compositions, which are open."""
    folder = examples / 'compositions'
    for path in sorted(folder.iterdir()):
        ui.Workspace.openComposition(graph.readComposition(str(path)))
    yield folder
    for shot in ui.Workspace.getCompositions():
        shot.save()  # else somebody would be asked what is to become of changes


def click_beside_the_rows(person):
    files = stage.active().findChild(QTreeView, 'Browser.list')
    while not files.model().rowCount():
        QApplication.processEvents()
    QTest.mouseClick(files.viewport(), Qt.MouseButton.LeftButton, pos=files.viewport().rect().bottomLeft())


def test_the_tour_opens_the_examples_where_no_composition_is_open(person, examples, closing):
    person.answer('Tour', says='No composition is open.', press='Cancel')
    run(examples)
    assert ui.Workspace.getNbCompositions() == 0
    person.answer('Tour', says='Open the examples?', press='Open')
    person.answer('Tour', {'Composition': (SHOTS, 1)}, 'Cancel')
    run(examples)
    assert [shot.getPath() for shot in ui.Workspace.getCompositions()] == [
        str((examples / 'compositions' / name[3:]).with_suffix('.vmcomposition')) for name in SHOTS]


def test_the_tour_changes_a_value_and_reports_to_a_folder_that_can_hold_a_report(person, examples, shots):
    before = (shots / 'shot_010.vmcomposition').read_text()
    person.answer('Tour', {'Composition': SHOTS[0], 'Value': 'Grade: gain', 'Change to': '1.3'}, 'Apply')
    person.answer('Folder for the report', {'Files': 'shot_020.vmcomposition'}, 'OK')
    person.answer('Tour', says='A report needs a folder that can be written to.', press='OK')
    person.answer('Folder for the report', do=click_beside_the_rows, press='OK')
    person.answer('Tour', says='gain of Grade is now 1.3.', press='OK',
                  do=lambda person: person.see().index('The report is shot_010.report.txt'))
    run(examples)
    report = (shots / 'shot_010.report.txt').read_text().splitlines()
    assert report == [str(shots / 'shot_010.vmcomposition'), 'gain of Grade is now 1.3.', 'Selected files:', '  none']
    assert (shots / 'shot_010.vmcomposition').read_text() == before

    person.answer('Tour', {'Composition': SHOTS[0], 'Change to': '1.3', 'Save': True}, 'Apply')
    person.answer('Folder for the report', do=click_beside_the_rows, press='OK')
    person.answer('Tour', says='Replace it?', press='Cancel')
    person.answer('Folder for the report', press='Cancel')
    person.answer('Tour', says='The composition has been saved.', press='OK')
    run(examples)
    assert (shots / 'shot_010.vmcomposition').read_text() == before.replace('"1.15"', '"1.3"')
