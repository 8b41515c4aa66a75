"""A folder that does not answer, as that of a network in its bad hour, keeps nobody but its own reader."""

import os
import sys
import textwrap
import time

import pytest
from scripts import TREE, needs_pyqt

from test_application import COMPOSITION, PROGRAM, run_inside
from test_application_window import TOOLS

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


def hanging(folder):
    """The environment in which the folder "dead" hangs while there is a file "gate"."""
    preload = [os.environ.get('LD_PRELOAD'), str(TREE / 'tests' / 'libhangingFolder.so')]
    return {'LD_PRELOAD': ':'.join(filter(None, preload)), 'KV_HANGING_FOLDER': str(folder / 'dead'),
            'KV_HANGING_WHILE': str(folder / 'gate')}


@pytest.fixture
def inside(tmp_path):
    """Runs a script in the application in which the folder "dead" can hang, to its end, which comes while it does."""
    for name in 'dead/deep', 'alive':
        (tmp_path / name).mkdir(parents=True)
    (tmp_path / 'dead/file').touch()
    (tmp_path / 'alive/other').touch()

    def run(script, *options, status=0, **changes):
        ended, _, errors = run_inside(tmp_path, TOOLS + HANGING + textwrap.dedent(script), *options, **changes,
                                      **hanging(tmp_path))
        assert ended == status, errors
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


# The folder in which changes are kept hangs: those of a composition that is elsewhere.
KEEPING = '''
import signal

path = dead + '/state/velmora/recovery/shot.1.vmrecovery'
shot, = ui.Workspace.getCompositions()

def change(text):
    before = time.monotonic()
    shot.setNodeValue('Plate', 'file', text)
    assert time.monotonic() < before + 2

def kept():
    return open(path).read() if os.path.exists(path) else ''

def hang_amid_a_write():
    change('before')
    QTest.qWait(2100)
    hang()
    change('amid')
'''


@pytest.fixture
def keeping(inside, tmp_path):
    """The same with a composition open, where all that the application keeps and remembers is in the folder "dead"."""
    shot = tmp_path / 'alive/shot.vmcomposition'
    shot.write_text(COMPOSITION)

    def run(script, *options, **changes):
        inside(KEEPING + textwrap.dedent(script), '--open', str(shot), *options,
               XDG_STATE_HOME=str(tmp_path / 'dead/state'), XDG_CONFIG_HOME=str(tmp_path / 'dead/config'), **changes)

    return run


def test_where_changes_cannot_be_kept_the_loop_and_dialogs_go_on_and_what_is_new_is_kept_once_they_can(keeping):
    keeping('''
        hang_amid_a_write()
        still_turns()
        user = users.User()
        user.plan(lambda user: user.close())
        assert ui.showMessageBox('Box', ['text'], ['OK']) == 'OK'
        user.judge()
        wait_for(lambda: any('cannot be kept' in line and 'does not answer' in line for line in lines()))
        before = threads()
        for number in range(100):
            change(str(number))
        assert threads() <= before
        wake()
        wait_for(lambda: '99' in kept())

        # What is saved is gone, though a write of it comes to its end afterwards.
        hang_amid_a_write()
        before = time.monotonic()
        shot.save()
        assert time.monotonic() < before + 2
        still_turns()
        wake()
        wait_for(lambda: not kept())
        hang()
        ''', '--exit')


def test_the_application_and_dialogs_start_where_settings_and_what_former_ones_left_cannot_be_read(desk, tmp_path):
    (tmp_path / 'dead/state/velmora/recovery').mkdir(parents=True)
    (tmp_path / 'gate').touch()
    variables = {**hanging(tmp_path), 'XDG_CONFIG_HOME': str(tmp_path / 'dead'), 'XDG_STATE_HOME': str(tmp_path / 'dead/state')}
    command = ['env', *map('='.join, variables.items())]
    script = desk.start(*command, sys.executable, '-c',
                        "from quorvane_velmora import ui; print(ui.showMessageBox('Settings', ['.']))")
    desk.wait_for_window('Settings')
    desk.run('key', 'Return')
    assert script.communicate()[0] == 'OK\n'
    application = desk.start(*command, PROGRAM, cwd=tmp_path)
    desk.wait_for_window('Changes That Cannot Be Read')
    desk.run('key', 'Return')
    desk.wait_for_window('Velmora')
    desk.run('key', 'ctrl+q')
    assert application.wait() == 0


def test_what_is_remembered_can_be_seen_and_changed_and_is_written_once_there_is_an_answer(keeping):
    keeping('''
        wait_for(lambda: recent_names() == ['script.py'])
        hang()
        before = time.monotonic()
        assert recent_names() == ['script.py']
        recent()[-1].trigger()
        assert recent_names() == [] and time.monotonic() < before + 2
        still_turns()
        wake()
        wait_for(lambda: 'script.py' not in open(dead + '/config/velmora/velmora.ini').read())
        assert recent_names() == []
        hang()
        window.close()
        ''')


ENDS = {
    'SIGTERM': ('os.kill(os.getpid(), signal.SIGTERM)', 128 + 15),
    'SIGHUP while idle': ("QTimer.singleShot(0, lambda: os.kill(os.getpid(), signal.SIGHUP))", 128 + 1),
    'the script': ('sys.exit(3)', 3),
    'the user': ("watching.answer('Discard'); window.close()", 0),
    'the QApplication': ('from PyQt6 import sip; sip.delete(QApplication.instance())', 1),
}


@pytest.mark.parametrize('end, status', ENDS.values(), ids=ENDS)
def test_the_application_ends_though_changes_cannot_be_kept(keeping, tmp_path, end, status):
    options = ['--exit'] if status == 3 else []
    keeping('''
        hang_amid_a_write()
        change('last')
        pathlib.Path('ending').touch()
        %s
        ''' % end, *options, status=status)
    assert time.time() < (tmp_path / 'ending').stat().st_mtime + 10
