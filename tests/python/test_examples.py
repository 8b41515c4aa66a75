"""The examples do what their pages say."""

import os
import pathlib
import re
import runpy
import shutil
import subprocess
import sys

import pytest

import stage
from quorvane_velmora import ui
from PyQt6.QtCore import Qt
from PyQt6.QtTest import QTest
from PyQt6.QtWidgets import QApplication, QComboBox, QLabel, QLineEdit, QTreeView

pytestmark = pytest.mark.usefixtures('no_wait_is_endless')

EXAMPLES = pathlib.Path(__file__).parents[2] / 'examples'


def run(name):
    runpy.run_path(str(EXAMPLES / name), run_name='__main__')


@pytest.mark.standalone
def test_the_demo_plays_itself_where_there_is_no_display_and_leaves_pictures(tmp_path):
    environment = {name: value for name, value in os.environ.items() if name not in ('DISPLAY', 'WAYLAND_DISPLAY')}
    del environment['QT_QPA_PLATFORM']
    done = subprocess.run([sys.executable, str(EXAMPLES / 'demo.py')], env=environment, cwd=tmp_path,
                          capture_output=True, text=True, timeout=60)
    assert done.returncode == 0, done.stderr
    lines = done.stdout.splitlines()
    assert "Show: 'Golden Reel Awards'" in lines and "Category: 'Music'" in lines
    pictures = [pathlib.Path(line.split(': ', 1)[1]) for line in lines if line.startswith('Picture: ')]
    assert len(pictures) == 2 and all(picture.stat().st_size > 1000 for picture in pictures)


def test_a_vote_needs_the_box_and_a_name(patient, capsys):
    tips = []
    patient.plan(lambda user: tips.append(user.find('Vote').toolTip()),
                 lambda user: user.click('CloseButton_Send'), lambda user: user.click('Vote'),
                 lambda user: user.click('CloseButton_Send'), lambda user: user.close(),
                 lambda user: user.click('Name'), lambda user: user.type('Ada'),
                 lambda user: user.click('CloseButton_Send'))
    run('votes.py')
    assert capsys.readouterr().out == 'Ada votes for The Long Take.\n' and tips[0]


def test_a_review_is_sent_with_its_note(patient, capsys):
    patient.plan(lambda user: user.type('Too dark'), lambda user: user.click('Urgent'),
                 lambda user: user.click('CloseButton_Send'))
    run('review.py')
    assert capsys.readouterr().out == 'Retake: Too dark\n'


def test_the_recipe_for_a_text_that_follows_the_values_follows_each_key(patient):
    page = (EXAMPLES.parent / 'docs' / 'callbacks.md').read_text()
    recipe = page.split('## A text that follows the values')[1].split('## ')[0]
    first, second = re.findall(r'```python\n(.*?)```', recipe, re.DOTALL)

    def shows(text):
        def step(user):
            while user.find('File').text() != text:
                QApplication.processEvents()
        return step

    patient.plan(shows('_beauty.exr'), lambda user: user.type('sh01'), shows('_beauty.exr'),
                 lambda user: user.press(Qt.Key.Key_Return), shows('sh01_beauty.exr'), lambda user: user.type('0'),
                 shows('sh01_beauty.exr'),
                 lambda user: (user.find('Pass').setFocus(), user.press(Qt.Key.Key_Down)), shows('sh010_depth.exr'),
                 lambda user: user.close())
    names = {}
    exec(first + 'dialog.launch()', names)
    patient.plan(lambda user: user.type('7'), shows('7_depth.exr'), lambda user: user.close())
    exec(second, names)
    assert not names['timer'].isActive()


@pytest.fixture
def closing():
    """Closes the compositions that a test leaves open."""
    yield
    while ui.Workspace.getNbCompositions():
        QTest.keyClick(stage.APPLICATION, Qt.Key.Key_W, Qt.KeyboardModifier.ControlModifier)


@pytest.fixture
def shots(tmp_path, closing):
    """The folder of the examples' compositions, copied, and opened in the application's own browser."""
    field, files = (stage.APPLICATION.findChild(kind, 'Browser.' + name)
                    for kind, name in ((QLineEdit, 'path'), (QTreeView, 'list')))
    for path in sorted((EXAMPLES / 'compositions').iterdir()):
        shutil.copy(path, tmp_path)
        field.setFocus()
        field.selectAll()
        QTest.keyClicks(field, str(tmp_path / path.name))
        QTest.keyClick(field, Qt.Key.Key_Return)
        while not files.selectionModel().hasSelection():
            QApplication.processEvents()
        QTest.keyClick(files, Qt.Key.Key_Return)
    yield tmp_path
    for shot in ui.Workspace.getCompositions():
        shot.save()  # else somebody would be asked what is to become of changes


def words(user):
    return [label.text() for label in user.window().findChildren(QLabel, 'Msg')]


@pytest.mark.inside
def test_the_tour_opens_the_examples_where_no_composition_is_open(patient, closing):
    read = []
    patient.plan(lambda user: read.extend(words(user)), lambda user: user.close('Cancel'))
    run('tour.py')
    assert read == ['No composition is open.', 'Open the examples?'] and ui.Workspace.getNbCompositions() == 0

    def look(user):
        menu = user.find('Composition', QComboBox)
        read[:] = [menu.itemText(row) for row in range(menu.count())]
        user.close('Cancel')

    patient.plan(lambda user: user.close('Open'), look)
    run('tour.py')
    assert read == ['1  shot_010', '2  shot_020']
    assert [shot.getPath() for shot in ui.Workspace.getCompositions()] == [
        str((EXAMPLES / 'compositions' / name[3:]).with_suffix('.vmcomposition')) for name in read]


@pytest.mark.inside
def test_the_tour_changes_a_value_and_reports_to_a_folder_that_can_hold_a_report(patient, shots):
    before = (shots / 'shot_010.vmcomposition').read_text()
    read = []

    def look(user):
        read.append(words(user))

    def read_folder(user):
        while not user.find('Browser.list', QTreeView).model().rowCount():
            QApplication.processEvents()

    def folder_alone(user):
        read_folder(user)
        files = user.find('Browser.list', QTreeView)
        QTest.mouseClick(files.viewport(), Qt.MouseButton.LeftButton, pos=files.viewport().rect().bottomLeft())

    patient.plan(lambda user: user.press(Qt.Key.Key_Up), lambda user: user.click('Text'),
                 lambda user: user.press(Qt.Key.Key_A, Qt.KeyboardModifier.ControlModifier),
                 lambda user: user.type('1.3'), lambda user: user.close('Apply'), read_folder,
                 lambda user: user.type('shot_020'),
                 lambda user: user.click('OK'), look, lambda user: user.close(),
                 folder_alone, lambda user: user.click('OK'), look, lambda user: user.close())
    run('tour.py')
    assert read[0][0] == 'A report needs a folder that can be written to.'
    assert read[1] == ['gain of Grade is now 1.3.', 'The report is shot_010.report.txt']
    report = (shots / 'shot_010.report.txt').read_text().splitlines()
    assert report == [str(shots / 'shot_010.vmcomposition'), 'gain of Grade is now 1.3.', 'Selected files:',
                      '  ' + str(shots / 'shot_020.vmcomposition')]
    assert (shots / 'shot_010.vmcomposition').read_text() == before

    patient.plan(lambda user: user.press(Qt.Key.Key_Up), lambda user: user.click('Save'), lambda user: user.close('Apply'),
                 folder_alone, lambda user: user.click('OK'), lambda user: user.close('Cancel'),
                 lambda user: user.click('Cancel'), lambda user: user.close())
    run('tour.py')
    assert (shots / 'shot_010.vmcomposition').read_text() == before.replace('"1.15"', '"1.3"')
