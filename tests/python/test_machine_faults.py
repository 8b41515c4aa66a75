"""Faults of the machine while files are read and written: full disks, folders that cannot be written, processes that
are killed, and no file handles."""

import contextlib
import fcntl
import os
import random
import resource
import socket
import subprocess
import sys
import time

import pytest

import displays
from quorvane_velmora import graph
from scripts import NO_SEARCH_FOR_LEAKS, TREE, environment, needs_pyqt, run_script

pytestmark = pytest.mark.standalone

ROWS = 400


def composition(mark):
    """A file of some pages, which says the same at its begin and at its end."""
    nodes = ''.join('  <node name="n%d" type="Read">\n    <value name="file" text="%s"/>\n  </node>\n'
                    % (row, mark if row in (0, ROWS - 1) else 'plate') for row in range(ROWS))
    return '<composition version="1">\n%s</composition>\n' % nodes


def read_mark(path):
    """What the whole file says; it must be one that a save has written."""
    text = path.read_text()
    mark = text.split('text="')[1].split('"')[0]
    assert text == composition(mark)
    return mark


@pytest.fixture
def path(tmp_path):
    path = tmp_path / 'folder' / 'shot.vmcomposition'
    path.parent.mkdir()
    path.write_text(composition('old'))
    return path


SAVING = '''
import sys
from quorvane_velmora import graph, ui
shot = graph.readComposition(sys.argv[1])
if sys.argv[2:]:
    ui.Workspace.openComposition(shot)
print('reads', flush=True)
for number in range(10 ** 6):
    for node in 'n0', 'n%d':
        shot.setNodeValue(node, 'file', str(number))
    shot.save()
    print(number, flush=True)
''' % (ROWS - 1)


@pytest.mark.parametrize('inside', [False, True], ids=['script', 'application'])
def test_a_process_that_is_killed_at_any_moment_of_its_saves_leaves_the_old_file_or_the_new_one(path, inside):
    script = path.parent.with_suffix('.py')
    script.write_text(SAVING)
    program = [TREE / 'bin' / 'velmora', '--exit', script, path, 'open'] if inside else [sys.executable, script, path]
    seed = random.randrange(10 ** 6)
    print('seed', seed)
    chance = random.Random(seed)
    saves = 0
    while saves < 100:
        process = subprocess.Popen(program, text=True, stdout=subprocess.PIPE,
                                   env=environment(QT_QPA_PLATFORM='offscreen', XDG_STATE_HOME=str(path.parents[1])))
        assert process.stdout.readline() == 'reads\n'
        before = read_mark(path)
        time.sleep(chance.uniform(0.01, 0.25))
        process.kill()
        told = process.communicate()[0].split()
        saves += len(told)
        assert read_mark(path) in ((told[-1], str(int(told[-1]) + 1)) if told else (before, '0'))
        assert len(os.listdir(path.parent)) <= 2, 'what one leaves goes with the next save'
    graph.readComposition(path).save()
    assert os.listdir(path.parent) == [path.name]


def test_what_another_process_is_saving_is_left_alone(path):
    name = path.parent / ('.saving-%s-0' % socket.gethostname())
    with open(name, 'w') as other:
        fcntl.flock(other, fcntl.LOCK_EX)
        graph.readComposition(path).save()
        assert sorted(os.listdir(path.parent)) == [name.name, path.name]
    name.unlink()
    name.symlink_to('/dev/null')
    graph.readComposition(path).save()
    assert name.is_symlink() and path.is_file()


@contextlib.contextmanager
def full_disk(path):
    """Another disk at the place of the folder, without the file; or a limit that leads the same way."""
    if subprocess.run(['mount', '-t', 'tmpfs', '-o', 'size=64k', 'tmpfs', path.parent], capture_output=True).returncode:
        old = resource.getrlimit(resource.RLIMIT_FSIZE)
        resource.setrlimit(resource.RLIMIT_FSIZE, (4096, old[1]))
        yield 'File too large'
        resource.setrlimit(resource.RLIMIT_FSIZE, old)
        return
    try:
        yield 'No space left on device'
    finally:
        subprocess.run(['umount', path.parent], check=True)


@contextlib.contextmanager
def locked(path, folder_mode, file_mode, words):
    path.chmod(file_mode)
    path.parent.chmod(folder_mode)
    yield words
    path.parent.chmod(0o700)
    path.chmod(0o600)


@contextlib.contextmanager
def folder_gone(path):
    path.parent.rename(path.parent.with_suffix('.gone'))
    yield 'its folder cannot be found: No such file or directory'
    path.parent.with_suffix('.gone').rename(path.parent)


FAULTS = {'a full disk': full_disk, 'a folder that is gone': folder_gone,
          'a read-only folder': lambda path: locked(path, 0o500, 0o600, 'its folder cannot be written'),
          'a read-only file': lambda path: locked(path, 0o700, 0o400, 'its permissions do not allow it')}


@pytest.mark.parametrize('fault', FAULTS.values(), ids=FAULTS)
def test_a_save_that_cannot_be_done_is_refused_with_words_and_leaves_all_as_it_was(path, fault):
    shot = graph.readComposition(path)
    shot.setNodeValue('n0', 'file', 'x' * 200000)
    with fault(path) as words:
        for _ in range(2):
            with pytest.raises(graph.GraphError, match=words):
                shot.save()
        left = os.listdir(path.parent) if path.parent.exists() else []
        assert left in ([], [path.name]) and (not left or read_mark(path) == 'old')
    shot.save()
    assert 'x' * 200000 in path.read_text() and os.listdir(path.parent) == [path.name]


NO_HANDLES = '''
import contextlib, os, pytest, resource, sys
from quorvane_velmora import graph, testing, ui

@contextlib.contextmanager
def no_handles(left=0):
    limits = resource.getrlimit(resource.RLIMIT_NOFILE)
    resource.setrlimit(resource.RLIMIT_NOFILE, (max(map(int, os.listdir('/proc/self/fd'))) + 20, limits[1]))
    taken = []
    try:
        while True:
            taken.append(os.open('/dev/null', os.O_RDONLY))
    except OSError:
        pass
    for _ in range(left):
        os.close(taken.pop())
    yield
    for one in taken:
        os.close(one)
    resource.setrlimit(resource.RLIMIT_NOFILE, limits)

def refused(words, call, *arguments):
    with pytest.raises((RuntimeError, graph.GraphError, ui.UiError), match=words):
        call(*arguments)

def make(title='Form', rows=1):
    form = [('TextField', 'Show', 'Show'), ('PushButton', 'Go')] + [('TextField', str(row)) for row in range(rows)]
    return ui.createDialog(title, ui.makeXmlFromWidgetList(form, ['OK']), 300 + rows, 112 + 28 * rows)

def fill(person, rows, title='Form'):
    person.answer(title, {'Show': 'x'}, 'OK')
    dialog = make(title, rows)
    dialog.launch()
    assert dialog.getValue('Show') == 'x'

def lose_in_callback(person):
    with contextlib.ExitStack() as lost:
        def lose(*_):
            lost.enter_context(no_handles())
            fill(person, 18, 'Inner')
            person.answer('Form', {'Show': 'y'}, 'OK')

        dialog = make()
        dialog.addCallback('Go', ui.EventType.ACTIVATE, lose)
        person.answer('Form', press='Go')
        dialog.launch()
        assert dialog.getValue('Show') == 'y'

path = sys.argv[1]
os.chdir(os.path.dirname(path))
shot = graph.readComposition(path)
for name, text in ('dialog.xml', ui.makeXmlFromWidgetList([], ['OK'])), ('tips.xml', '<Tooltips/>'):
    with open(name, 'w') as file:
        file.write(text)

def refuse_files():
    refused('Too many open files', graph.readComposition, path)
    refused('Too many open files', shot.save)
    refused('Error opening file', ui.showDialog, 'Form', 'dialog.xml')
'''


@pytest.mark.parametrize('left', [0, 1, 3, 8])
# On Wayland one comes free now and then while the test holds them: Qt closes those that the compositor sends.
@pytest.mark.parametrize('platform', ['offscreen', 'xcb'])
def test_without_file_handles_all_is_refused_with_words_or_works_and_works_again_with_them(path, platform, left):
    shown = contextlib.nullcontext({}) if platform == 'offscreen' else displays.display(platform)
    leaks = {} if platform == 'offscreen' else NO_SEARCH_FOR_LEAKS
    with shown as variables:
        run_script(NO_HANDLES + '''
left = int(sys.argv[2])
with no_handles(left):
    refused('too few file handles', make)  # the first that needs Qt
    if left == 0:
        refuse_files()
with testing.person() as person:
    fill(person, 1)
    dialog = make()
    with no_handles():
        refuse_files()
        refused('Too many open files', dialog.setWidgetResourceName, 'Show', './tips.xml')
        fill(person, 10)
    dialog.setWidgetResourceName('Show', './tips.xml')
    lose_in_callback(person)
    fill(person, 20)
shot.save()
graph.readComposition(path)
''', str(path), str(left), QT_QPA_PLATFORM=platform, **leaks, **variables)


@needs_pyqt
@pytest.mark.parametrize('desk', ['xcb'], indirect=True)  # elsewhere nobody else can make a window larger
def test_the_application_goes_on_where_a_script_leaves_no_file_handles(path, desk):
    (path.parent / 'lose.py').write_text(NO_HANDLES + '''
lost = contextlib.ExitStack()
lost.enter_context(no_handles())
with testing.person() as person:
    person.answer('Pick', do=lambda person: lost.close())
    person.answer('Pick', {'Files': 'lose.py'}, 'OK')
    assert ui.showBrowser('Pick', os.getcwd()).endswith('lose.py')
lost.enter_context(no_handles())
shot, = ui.Workspace.getCompositions()
shot.setNodeValue('n0', 'file', 'new')
shot.setNodeValue('n%d', 'file', 'new')
refuse_files()
print('lost', flush=True)
''' % (ROWS - 1))
    state = path.parent.parent / 'state'
    application = desk.start('env', 'XDG_STATE_HOME=%s' % state, str(TREE / 'bin' / 'velmora'), '--open', str(path),
                             str(path.parent / 'lose.py'), str(path))
    assert application.stdout.readline() == 'lost\n'
    window = desk.find_window('shot.*Velmora')
    end = time.monotonic() + 30
    while not any('"new"' in kept.read_text() for kept in state.rglob('*.vmrecovery')):
        assert time.monotonic() < end
        time.sleep(0.05)
    desk.run('windowsize', window.identity, 1270, 1000, 'key', 'alt+h', 'Down', 'Return')
    desk.wait_for_window('Build Information')
    desk.run('key', 'Escape')
    desk.wait_for_window('shot.*Velmora')
    desk.run('key', 'ctrl+s', 'ctrl+q')
    assert application.wait() == 0 and read_mark(path) == 'new'
