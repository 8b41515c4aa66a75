"""A folder that does not answer, as that of a network in its bad hour, keeps nobody but its own reader."""

import os
import textwrap

import pytest
from scripts import TREE, needs_pyqt

from test_application import COMPOSITION
from test_application_window import run_with_tools

pytestmark = [pytest.mark.standalone, needs_pyqt]

HANGING = '''
import os, pathlib
from quorvane_velmora import graph, ui
import user as users

dead, alive, gate = (os.path.join(os.getcwd(), name) for name in ('dead', 'alive', 'gate'))
turns = 0

def count():
    global turns
    turns += 1

counter = QTimer()
counter.timeout.connect(count)
counter.start(1)

def hang():
    pathlib.Path(gate).touch()

def wake():
    os.remove(gate)

def threads():
    return len(os.listdir('/proc/self/task'))

def names(view):
    return [view.model().index(row, 0).data() for row in range(view.model().rowCount())]

def part(view, kind, name):
    return view.parentWidget().findChild(kind, 'Browser.' + name)

def words(view):
    return part(view, QLabel, 'message').text().replace('\\u200b', '')

def shown(view):
    return part(view, QLineEdit, 'path').text()

def still_turns():
    before = turns
    wait_for(lambda: turns > before + 50)

def go(view, path, key=Qt.Key.Key_Return):
    QTest.keyClick(view, Qt.Key.Key_L, Qt.KeyboardModifier.ControlModifier)
    field = part(view, QLineEdit, 'path')
    field.selectAll()
    QTest.keyClicks(field, path)
    if key:
        QTest.keyClick(field, key)

def pick_in(view, name):
    wait_for(lambda: name in names(view))
    view.setFocus()
    view.setCurrentIndex(view.model().index(names(view).index(name), 0))

def waits(view):
    return 'has not answered yet' in words(view)
'''


@pytest.fixture
def inside(tmp_path):
    """Runs a script in the application in which the folder "dead" can hang, to its end, which comes while it does."""
    for name in 'dead/deep', 'alive':
        (tmp_path / name).mkdir(parents=True)
    (tmp_path / 'dead/file').touch()
    (tmp_path / 'alive/other').touch()

    def run(script, *options):
        library = TREE / 'tests' / 'libhangingFolder.so'
        preload = ':'.join(filter(None, [os.environ.get('LD_PRELOAD'), str(library)]))
        run_with_tools(tmp_path, HANGING + textwrap.dedent(script), *options, LD_PRELOAD=preload,
                       KV_HANGING_FOLDER=str(tmp_path / 'dead'), KV_HANGING_WHILE=str(tmp_path / 'gate'))
        assert (tmp_path / 'gate').exists()

    return run


def test_the_window_goes_elsewhere_shows_the_folder_once_it_answers_and_is_closed_while_it_does_not(inside):
    inside('''
        hang()
        pick_in(files, 'dead')
        QTest.keyClick(files, Qt.Key.Key_Return)
        wait_for(lambda: waits(files))
        still_turns()
        pick_in(files, 'alive')
        QTest.keyClick(files, Qt.Key.Key_Return)
        wait_for(lambda: names(files) == ['other'])
        assert shown(files) == alive and not words(files)

        # The folder above has it as an entry: its names are there, and it can be left.
        QTest.keyClick(files, Qt.Key.Key_Backspace)
        wait_for(lambda: 'dead' in names(files))
        wait_for(lambda: words(files).startswith('Something in ') and waits(files))
        still_turns()
        assert files.model().index(names(files).index('script.py'), 1).data() is None
        go(files, dead + '/d', None)
        still_turns()
        go(files, dead)
        wake()
        wait_for(lambda: names(files) == ['deep', 'file'])
        assert shown(files) == dead and not words(files)

        # While it is shown.
        hang()
        QTest.keyClick(files, Qt.Key.Key_F5)
        wait_for(lambda: waits(files))
        still_turns()
        assert names(files) == ['deep', 'file']
        QTimer.singleShot(0, window.close)
        ''')


def test_who_goes_there_again_and_again_leaves_few_threads(inside):
    inside('''
        hang()
        counts = []
        for number in range(50):
            go(files, dead if number % 2 else dead + '/deep/%d' % number)
            go(files, alive)
            wait_for(lambda: names(files) == ['other'])
            go(files, dead + '/x', None)
            QTest.keyClick(files, Qt.Key.Key_F5)
            counts.append(threads())
        assert max(counts) < 20, counts
        go(files, dead)
        wake()
        wait_for(lambda: names(files) == ['deep', 'file'])
        wait_for(lambda: threads() < counts[0])
        hang()
        ''', '--exit')


@pytest.mark.parametrize('initial', ['dead', 'dead/file', 'alive'])
def test_a_script_asks_for_a_path_and_the_user_cancels_or_takes_another(inside, initial):
    inside('''
        user, initial = users.User(), %r

        def view(user):
            return user.find('Browser.list', QTreeView)

        def look(user):
            wait_for(lambda: initial != 'alive' and waits(view(user)) or names(view(user)) == ['other'])
            go(view(user), dead + '/new', None)
            user.click('OK')
            wait_for(lambda: waits(view(user)))
            still_turns()

        def leave(user):
            go(view(user), alive)
            wait_for(lambda: names(view(user)) == ['other'])
            user.click('OK')

        hang()
        user.plan(look, lambda user: user.press(Qt.Key.Key_Escape))
        assert ui.showBrowser('Pick', initial) == ''
        user.plan(look, leave)
        assert ui.showBrowser('Pick', initial) == alive

        # OK of the path that was typed counts once there is an answer.
        user.plan(look, lambda user: wake())
        assert ui.showBrowser('Pick', initial) == dead + '/new'
        user.judge()
        hang()
        ''' % initial, '--exit')


def test_the_commands_of_the_window_refuse_what_does_not_answer(inside, tmp_path):
    for folder in 'dead', 'alive':
        (tmp_path / folder / 'shot.vmcomposition').write_text(COMPOSITION)
    (tmp_path / 'dead/tool.py').write_text('print(1)')
    (tmp_path / 'link.vmcomposition').symlink_to(tmp_path / 'dead/shot.vmcomposition')
    inside('''
        from PyQt6.QtWidgets import QMessageBox

        told = []

        def close_box():
            box = QApplication.activeModalWidget()
            if isinstance(box, QMessageBox) and 'does not answer' in box.text():
                told.append(turns)
                if turns > told[0] + 50:
                    watching.answer('Close')

        go(files, dead)
        pick_in(files, 'tool.py')
        shot = graph.readComposition(os.path.join(dead, 'shot.vmcomposition'))
        ui.Workspace.openComposition(shot)
        shot.setNodeValue('Plate', 'file', 'b.exr')
        still_turns()
        hang()
        assert ui.Workspace.getBrowserSelection() in ([], [dead + '/tool.py'])
        QTest.keyClick(files, Qt.Key.Key_Return)
        wait_for(lambda: waits(files))
        watcher = QTimer()
        watcher.timeout.connect(close_box)
        watcher.start(5)
        watching.trigger('Save Composition')
        watcher.stop()
        assert told
        ui.Workspace.openComposition(graph.readComposition(os.path.join(alive, 'shot.vmcomposition')))
        still_turns()
        ''', '--exit')
