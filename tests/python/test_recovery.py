"""Changes that are not saved when the application ends before its time are offered by its next start."""

import os
import signal
import stat
import textwrap
import time

import pytest

from scripts import needs_pyqt
from test_application import COMPOSITION, PROGRAM, run_inside, write
from test_application_window import TOOLS

pytestmark = [pytest.mark.standalone, needs_pyqt]

NAME = os.fsdecode(b'sh\xfft %1')
CHANGE = '''
from quorvane_velmora import ui
for shot in ui.Workspace.getCompositions():
    shot.setNodeValue('Plate', 'file', 'changed.exr')
print('changed', flush=True)
'''
TELL = '''
import stage
from quorvane_velmora import ui
from PyQt6.QtWidgets import QPlainTextEdit
stage.dialogs()
for shot in ui.Workspace.getCompositions():
    print(ascii(shot.getName()), shot.getNodeValues('Plate')['file'])
print(stage.APPLICATION.isWindowModified(), flush=True)
print(ascii(stage.APPLICATION.findChild(QPlainTextEdit, 'log').toPlainText()), flush=True)
'''


class Studio:
    """Applications of one user."""

    def __init__(self, desk, folder):
        self.desk, self.folder = desk, folder
        self.recovery = folder / 'state' / 'velmora' / 'recovery'
        write(folder, change=CHANGE, tell=TELL)

    def make(self, name=NAME):
        path = self.folder / (name + '.vmcomposition')
        path.write_text(COMPOSITION)
        return path

    def start(self, *arguments):
        return self.desk.start('env', 'XDG_STATE_HOME=%s' % (self.folder / 'state'), PROGRAM, *map(str, arguments),
                               cwd=self.folder)

    def change(self, path):
        """An application that has changes which are not saved."""
        application = self.start('--open', path, 'change.py')
        assert application.stdout.readline() == 'changed\n'
        return application

    def lose(self, path):
        application = self.change(path)
        application.kill()
        application.wait()

    def ask(self, question='Recover Changes', options=()):
        """An application that has a question."""
        application = self.start(*options, 'tell.py')
        self.desk.wait_for_window(question)
        return application

    def answer(self, application, *keys):
        """What is open when the keys have been pressed, and what the log says."""
        for key in keys:
            self.desk.run('key', key)
        lines = []
        while not lines or lines[-1] not in ('True', 'False'):
            lines.append(application.stdout.readline().rstrip('\n'))
        return lines, application.stdout.readline()

    def kept(self):
        return sorted(path.name for path in self.recovery.iterdir() if path.is_file())


@pytest.fixture
def studio(desk, tmp_path):
    return Studio(desk, tmp_path)


def test_what_a_killed_application_had_not_saved_is_restored_and_that_of_others_left_alone(studio):
    shot, other = studio.make(), studio.make('other')
    living = studio.change(other)
    studio.lose(shot)
    modes = [stat.S_IMODE(path.stat().st_mode) for path in (studio.recovery, *studio.recovery.iterdir())]
    assert modes == [0o700, 0o600, 0o600]
    application = studio.ask()
    lines, _ = studio.answer(application, 'Return')
    assert lines == [ascii(NAME) + ' changed.exr', 'True'] and 'a.exr' in shot.read_text()
    studio.desk.run('key', 'ctrl+s', 'ctrl+q')
    assert application.wait() == 0 and 'changed.exr' in shot.read_text()
    assert studio.kept() == ['other.1.vmrecovery'] and living.poll() is None


def test_what_is_put_off_is_asked_again_and_what_is_thrown_away_is_gone(studio):
    shot = studio.make()
    studio.lose(shot)
    for answer in 'Escape', 'alt+l':
        application = studio.ask()
        assert studio.answer(application, answer)[0] == ['False'] and len(studio.kept()) == 1
        application.kill()
    application = studio.start('tell.py')
    for sure in 'Return', 'alt+t':
        studio.desk.wait_for_window('Recover Changes')
        studio.desk.run('key', 'alt+t')
        studio.desk.wait_for_window('Throw Away Changes')
        studio.desk.run('key', sure)
    assert studio.answer(application)[0] == ['False'] and studio.kept() == [] and shot.read_text() == COMPOSITION


def test_a_restored_composition_takes_the_place_of_the_open_file_and_does_not_save_over_what_others_wrote(studio):
    shot = studio.make()
    studio.lose(shot)
    shot.write_text(COMPOSITION.replace('a.exr', 'of another.exr'))
    application = studio.ask(options=['--open', shot])
    assert studio.answer(application, 'alt+r')[0] == [ascii(NAME) + ' changed.exr', 'True']
    studio.desk.run('key', 'ctrl+s')
    time.sleep(0.5)
    studio.desk.run('key', 'Return')  # Cancel
    application.kill()
    application.wait()
    assert 'of another.exr' in shot.read_text() and len(studio.kept()) == 1


DAMAGES = {
    'half of one': (lambda text: text[:len(text) // 2], 'line'),
    'nothing but the first line': (lambda text: text[:text.index(b'\n')], 'there is no element'),
    'no such file': (lambda text: b'\x00\xff' * 500, 'it does not begin as such a file'),
    'no path': (lambda text: text.replace(b' /', b' ', 1), 'it does not name a composition'),
    'a later version': (lambda text: text.replace(b' 1 ', b' 2 ', 1), 'a later version of the application'),
    'a later version of compositions': (lambda text: text.replace(b'version="1"', b'version="7"'), 'line 2: a later version'),
}


@pytest.mark.parametrize('damage, words', DAMAGES.values(), ids=DAMAGES)
def test_what_cannot_be_read_is_said_and_kept_aside(studio, damage, words):
    studio.lose(studio.make())
    file, = studio.recovery.iterdir()
    damaged = damage(file.read_bytes())
    file.write_bytes(damaged)
    (studio.recovery / 'empty.1.vmrecovery').write_text('')
    aside = studio.recovery / 'unreadable' / (file.name + '.2')
    aside.parent.mkdir()
    aside.with_suffix('').write_text('of another time')
    lines, log = studio.answer(studio.ask('Changes That Cannot Be Read'), 'Return')
    assert lines == ['False'] and words in log and str(aside) in log
    assert aside.read_bytes() == damaged and studio.kept() == [] and len(os.listdir(aside.parent)) == 2


# A script that has a composition open.
HERE = TOOLS + '''
import atexit, os, resource, subprocess
from quorvane_velmora import graph, ui

path = os.environ['XDG_STATE_HOME'] + '/velmora/recovery/shot.1.vmrecovery'
shot, = ui.Workspace.getCompositions()

def change(text):
    shot.setNodeValue('Plate', 'file', str(text))

def kept():
    return open(path).read() if os.path.exists(path) else ''
'''


def run_here(folder, script, *options, state='state', status=0):
    """What a script prints that has a composition open, and ends with that status."""
    (folder / 'shot.vmcomposition').write_text(COMPOSITION)
    ended, printed, errors = run_inside(folder, HERE + textwrap.dedent(script), '--open', 'shot.vmcomposition',
                                        *options, XDG_STATE_HOME=os.path.join(folder, state))
    assert ended == status, errors
    return printed


def test_nothing_is_left_of_what_is_saved_discarded_or_ended_in_order(tmp_path):
    assert run_here(tmp_path, '''
        if os.fork() == 0:
            change('of a child')
            os._exit(0)
        os.wait()
        assert not kept()
        change('b.exr')
        assert 'b.exr' in kept()
        shot.save()
        assert not kept()
        change('c.exr')
        wait_for(lambda: 'c.exr' in kept())
        watching.answer('Discard')
        trigger('Close Composition')
        assert not kept()
        shot = graph.readComposition('shot.vmcomposition')
        change('of the script alone')
        assert not kept()
        ui.Workspace.openComposition(shot)
        wait_for(lambda: 'of the script alone' in kept())
        atexit.register(change, 'too late')
        print('ends')
        ''', '--exit') == ['ends']
    assert list((tmp_path / 'state' / 'velmora' / 'recovery').iterdir()) == []


def test_many_changes_are_written_once_in_a_while_and_the_last_one_too(tmp_path):
    run_here(tmp_path, '''
        versions = set()
        for number in range(3000):
            change(number)
            versions.add(os.stat(path).st_ino)
        assert len(versions) < 10 and '2999' not in kept()
        time.sleep(2.1)
        change('while the loop does not come around')
        assert 'while' in kept()
        change('the last')
        wait_for(lambda: 'the last' in kept())
        ''', '--exit')


WAITING = {'computing': 'while True: pass', 'sleeping': 'time.sleep(60)', 'idle': '',
           'in a dialog': "ui.showMessageBox('Box', ['text'])", 'in a box': "trigger('Build Information')"}


@pytest.mark.parametrize('number', [signal.SIGTERM, signal.SIGHUP])
@pytest.mark.parametrize('waiting', WAITING.values(), ids=WAITING)
def test_a_signal_that_ends_the_application_leaves_the_last_change_and_ends_children_as_ever(tmp_path, waiting, number):
    assert run_here(tmp_path, '''
        child = os.fork()
        if child == 0:
            time.sleep(60)
            os._exit(1)
        os.kill(child, {0})
        print(os.WTERMSIG(os.waitpid(child, 0)[1]), flush=True)
        change('first')
        change('last')
        subprocess.Popen(['sh', '-c', 'sleep 0.3; kill -{0} %d' % os.getpid()])
        {1}
        '''.format(int(number), waiting), status=128 + number) == [str(int(number))]
    file, = (tmp_path / 'state' / 'velmora' / 'recovery').iterdir()
    assert 'last' in file.read_text()


@pytest.mark.parametrize('state, limit', [('/dev/null', -1), ('state', 100)], ids=['no folder', 'a full disk'])
def test_where_nothing_can_be_kept_that_is_said_once_and_work_goes_on(tmp_path, state, limit):
    run_here(tmp_path, '''
        resource.setrlimit(resource.RLIMIT_FSIZE, (%d, -1))
        for text in 'b.exr', 'c.exr':
            change(text)
            QTest.qWait(2300)
        assert sum('cannot be kept' in line for line in lines()) == 1, lines()
        resource.setrlimit(resource.RLIMIT_FSIZE, (-1, -1))
        shot.save()
        assert 'c.exr' in open('shot.vmcomposition').read()
        ''' % limit, '--exit', state=state)
