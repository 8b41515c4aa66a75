"""The application as a whole, in a process of its own, as it is started from a terminal."""

import os
import re
import subprocess
import sys
import textwrap
import zipfile

import pytest

from scripts import TREE, environment, needs_pyqt

pytestmark = [pytest.mark.standalone, needs_pyqt]

PROGRAM = str(TREE / 'bin' / 'velmora')
PACKAGES = {'base', 'resmgt', 'pluginAPI', 'internalAPI', 'framework', 'gfx', 'ui', 'appUi', 'scriptingAPI',
            'pyextInit', 'pyextGraph', 'pyextUi'}
COMPOSITION = '''<composition>
  <node name="Plate" type="Read">
    <value name="file" text="a.exr"/>
  </node>
</composition>
'''

# A user inside the process who does each step at the end of a run, given by its number and what the bottom line says.
PLATFORM_HINT = 'This plugin does not support propagateSizeHints()\n'
WATCHING = '''
import stage
from PyQt6.QtCore import QTimer
from PyQt6.QtGui import QAction
from PyQt6.QtWidgets import QApplication, QLabel, QPushButton

runs, plan = 0, []

def trigger(label):
    action, = (one for one in stage.APPLICATION.findChildren(QAction) if one.text().replace('&', '') == label)
    assert action.isEnabled(), label
    action.trigger()

def run_again():
    trigger('Run Script Again')

def answer(label):
    box = QApplication.activeModalWidget()
    buttons = box.findChildren(QPushButton) if box else []
    if not buttons:
        QTimer.singleShot(5, lambda: answer(label))
    for button in buttons:
        if button.text().replace('&', '') == label:
            button.click()

def proceed():
    if plan and plan[0][0] == runs and plan[0][1] in stage.APPLICATION.findChild(QLabel, 'message').text():
        plan.pop(0)[2]()

timer = QTimer(stage.APPLICATION)
timer.timeout.connect(proceed)
timer.start(5)
'''


def write(folder, **texts):
    for name, text in texts.items():
        (folder / (name + '.py')).write_text(textwrap.dedent(text))


def run(folder, *command, platform='offscreen', **changes):
    """Runs a program to its end, and gives its status, as a shell tells it, and what it said."""
    chosen = {'QT_QPA_PLATFORM': platform} if platform else {}
    settings = environment(QT_LOGGING_RULES='default.warning=false', **chosen, **changes)
    done = subprocess.run(command, cwd=folder, env=settings, capture_output=True, timeout=120)
    status = done.returncode if done.returncode >= 0 else 128 - done.returncode
    return status, done.stdout.decode(errors='surrogateescape'), done.stderr.decode()


def run_inside(folder, script, *options, plan='', **changes):
    """Runs a script in the application until that ends, and gives its status, the lines that it printed, and what it
    said of errors."""
    write(folder, script=script, watching=WATCHING + textwrap.dedent(plan))
    status, printed, errors = run(folder, PROGRAM, *options, 'script.py', **changes)
    return status, printed.splitlines(), errors


def test_it_tells_how_it_is_used_and_what_it_is_made_of(tmp_path):
    status, usage, errors = run(tmp_path, PROGRAM, '--help', platform=None)
    assert (status, errors) == (0, '') and all(option in usage for option in ('--open', '--exit', '-m', '--build-info'))
    status, table, errors = run(tmp_path, PROGRAM, '--build-info', platform=None)
    rows = [row.split(None, 2) for row in table.splitlines()]
    assert (status, errors) == (0, '') and {row[0] for row in rows} == PACKAGES and len(rows) == 12
    for package, library, details in rows:
        assert library == ('libKvpyextUi' if package == 'pyextUi' else 'libKV' + package)
        assert re.fullmatch(r'Quorvane Velmora Library 8\.0 \(2013\), '
                            r'build 2600 of [A-Z][a-z]{2} [ \d]\d \d{4}, [\w.]+', details), details


@pytest.mark.parametrize('arguments, status, words', [
    (['--nonsense'], 2, '--nonsense is no option'), (['-x'], 2, '-x is no option'),
    (['--open'], 2, '--open needs an argument'), (['-m'], 2, '-m needs an argument'),
    (['--exit'], 2, '--exit needs a script'), (['nothing.py'], 2, 'there is no script "nothing.py"'),
    (['script.py'], 1, 'there is no display: DISPLAY is not set'),
])
def test_what_it_cannot_do_without_a_display_it_says_and_ends(tmp_path, arguments, status, words):
    write(tmp_path, script='print("has run")')
    ended, printed, errors = run(tmp_path, PROGRAM, *arguments, platform=None)
    assert (ended, printed) == (status, '') and words in errors


@pytest.mark.parametrize('name, words', [('none', 'No such file'), ('bad', "bad.vmcomposition': line 3")])
def test_a_composition_that_cannot_be_opened_is_told_before_the_script_runs(tmp_path, name, words):
    (tmp_path / 'good.vmcomposition').write_text(COMPOSITION)
    (tmp_path / 'bad.vmcomposition').write_text('<composition>\n  <node name="Plate" type="Read">\n</composition>\n')
    write(tmp_path, script='print("has run")')
    status, printed, errors = run(tmp_path, PROGRAM, '--open', 'good.vmcomposition', '--open', name + '.vmcomposition',
                                  '--exit', 'script.py')
    assert (status, printed) == (1, '') and name + '.vmcomposition' in errors and words in errors


SHOW = '''
import os, sys, __main__
print(ascii([__name__, __file__, sys.argv, sys.path[0], __package__, __spec__ and __spec__.name, type(__loader__)]))
print(__main__.__dict__ is globals(), sys.executable, type(__builtins__), sys.flags, sys.stdout.encoding)
'''
FAILING = '''
class Unwilling(Exception): pass
def fail():
    raise Unwilling('\u00fc', b'\\xff')
try:
    fail()
except Unwilling as failure:
    raise KeyError('why') from failure
'''
ENDING = '''
import atexit, sys, threading, time
class Kept:
    def __del__(self): print('gone')
kept = Kept()
atexit.register(print, 'at exit')
threading.Thread(target=lambda: (time.sleep(0.1), print('thread'))).start()
print('no end of line', end='')
'''


@pytest.fixture
def scripts(tmp_path):
    write(tmp_path, show=SHOW, failing=FAILING, ending=ENDING, names='print(sorted(globals()))', syntax='x = = 1',
          three='import sys; sys.exit(3)', words='import sys; sys.exit("w\\udc80rds")', none='raise SystemExit',
          huge='raise SystemExit(-2 ** 70)', pair='raise SystemExit((1, 2))', interrupt='raise KeyboardInterrupt',
          control_c='import os, signal; os.kill(os.getpid(), signal.SIGINT); input()', hook='''
              import sys
              sys.excepthook = lambda kind, *_: print('hooked', kind)
              nonsense''', imports='import failing', full='import sys; sys.stdout = open("/dev/full", "w"); print(1)')
    for folder in 'package', 'folder', 'empty':
        (tmp_path / folder).mkdir()
    (tmp_path / 'package' / '__init__.py').write_text('')
    for path in ('package/__main__.py', 'package/module.py', 'folder/__main__.py', 'sk\u00fc\u6f22 x.py',
                 os.fsdecode(b'\xff.py')):
        (tmp_path / path).write_text(SHOW)
    (tmp_path / 'link.py').symlink_to('package/module.py')
    with zipfile.ZipFile(tmp_path / 'archive.zip', 'w') as archive:
        archive.writestr('__main__.py', SHOW)
    return tmp_path


@pytest.mark.parametrize('arguments', [
    ['show.py', 'a', '--open', '', '-m', '--exit'], ['package/../show.py'], ['link.py'], ['--', 'show.py', '--'],
    ['sk\u00fc\u6f22 x.py', '\u00fc'], [b'\xff.py', b'\xfe'], ['-m', 'package.module', 'a', '--exit'],
    ['-m', 'package'], ['-m', 'nothing'], ['folder', 'a'], ['archive.zip', 'a'], ['empty'], ['three.py'], ['words.py'],
    ['none.py'], ['huge.py'], ['pair.py'], ['failing.py'], ['syntax.py'], ['imports.py'], ['-m', 'failing'],
    ['hook.py'], ['interrupt.py'], ['control_c.py'], ['ending.py'], ['full.py'], ['names.py'],
], ids=ascii)
def test_a_script_runs_and_ends_as_in_the_interpreter_itself(scripts, arguments):
    assert run(scripts, PROGRAM, '--exit', *arguments) == run(scripts, sys.executable, *arguments)


def test_a_script_that_fails_leaves_the_application_running_and_can_be_run_again(tmp_path):
    status, printed, errors = run_inside(tmp_path, '''
        import watching
        from quorvane_velmora import ui

        def fail(*_):
            raise ValueError('out of a callback')

        watching.runs += 1
        description = ui.makeXmlFromWidgetList([('PushButton', 'Fails')])
        dialog = ui.createDialog('run %d' % watching.runs, description, 300, 200)
        dialog.addCallback('Fails', ui.EventType.ACTIVATE, fail)
        if watching.runs == 1:
            raise KeyError('mine')
        ''', plan='''
        def look_and_run_again():
            print(stage.titles())
            run_again()

        def press_and_close():
            stage.dialogs()[0].findChild(QPushButton, 'Fails').click()
            print(stage.titles(), stage.APPLICATION.close())

        plan += [(1, 'script.py has failed: KeyError', look_and_run_again),
                 (2, 'script.py has ended', look_and_run_again), (3, 'script.py has ended', press_and_close)]
        ''')
    assert (status, printed) == (0, ['[]', "['run 2']", "['run 3'] True"]), errors
    assert "KeyError: 'mine'" in errors and errors.endswith('ValueError: out of a callback\n')


@pytest.mark.parametrize('exit', [[], ['--exit']])
@pytest.mark.parametrize('inner', ['inner.launch()', 'ui.showBrowser("Pick")',
                                   'ui.showBrowser("Pick", "/", lambda *_: inner.launch())'])
def test_its_window_can_be_closed_under_dialogs_and_the_script_comes_to_its_own_end(tmp_path, inner, exit):
    status, printed, errors = run_inside(tmp_path, '''
        import stage, sys
        from callback_tools import PatientUser
        from forms import make_dialog, ui
        outer, inner = make_dialog('outer'), make_dialog('inner')
        outer.addCallback('Button', ui.EventType.ACTIVATE, lambda *_: print(repr(%s)))
        user = PatientUser()
        user.plan(lambda user: user.click('Button'), *[lambda user: user.click('OK')] * %d,
                  lambda user: stage.APPLICATION.close())
        print(repr(outer.launch()))
        user.stop()
        assert not user.failures, user.failures
        for show in outer.launch, lambda: ui.showMessageBox('Box', ['text']), lambda: ui.showBrowser('Pick'):
            try:
                show()
            except RuntimeError as refusal:
                print(refusal)
        assert outer.getValue('Text') == 'old'
        sys.exit(7)
        ''' % (inner, inner.count('lambda')), *exit)
    assert status == 7 and printed[:2] == ["''", "''"], errors
    assert len(printed) == 5 and len(set(printed[2:])) == 1 and 'clos' in printed[2], printed


def test_a_script_that_asks_until_it_is_answered_ends_when_its_window_is_closed(tmp_path):
    status, _, errors = run_inside(tmp_path, '''
        import stage
        from callback_tools import QTimer
        from forms import make_dialog
        dialog = make_dialog()
        QTimer.singleShot(50, stage.APPLICATION.close)
        while True:
            try:
                dialog.launch()
            except Exception:
                pass
        ''')
    assert status == 130 and errors.endswith('KeyboardInterrupt\n')


LEAVING = '''
import gc, stage
from forms import make_dialog
from PyQt6.QtCore import QObject
from PyQt6.QtWidgets import QApplication, QTreeView

class Filter(QObject):
    def eventFilter(self, *_):
        hear()
        return False

def hear(*_):
    assert dialog and application

application, dialog = QApplication.instance(), make_dialog()
application.installEventFilter(Filter(application))
%s
gc.collect()
'''
SIGNALS = {
    'focus': ('QApplication.instance()', 'focusChanged'), 'end': ('QApplication.instance()', 'aboutToQuit'),
    'window': ('stage.APPLICATION', 'destroyed'), 'dialog': ('stage.dialogs()[-1]', 'destroyed'),
    'list': ('stage.APPLICATION.findChild(QTreeView, "Browser.list")', 'destroyed'),
}


@pytest.mark.parametrize('sender, signal', SIGNALS.values(), ids=SIGNALS)
@pytest.mark.parametrize('connect', [
    'sender = {0}; sender.{1}.connect(hear)', '{0}.{1}.connect(hear)',
    'def connect():\n sender = {0}; sender.{1}.connect(lambda *_: hear(sender))\nconnect()',
], ids=['by a variable', 'by nothing', 'by a closure'])
def test_what_a_script_leaves_connected_ends_neither_the_application_nor_the_next_script(tmp_path, connect, sender,
                                                                                         signal):
    script = LEAVING % connect.format(sender, signal)
    status, printed, errors = run_inside(tmp_path, script, '--exit')
    assert (status, printed, errors.replace(PLATFORM_HINT, '')) == (0, [], '')
    status, printed, errors = run_inside(tmp_path, 'import watching; watching.runs += 1' + script, plan='''
        end = 'script.py has ended'
        plan += [(1, end, run_again), (2, end, run_again), (3, end, lambda: print(stage.APPLICATION.close()))]
        ''')
    assert (status, printed, errors.replace(PLATFORM_HINT, '')) == (0, ['True'], '')


WORKSPACE = '''
    import os, pytest, stage, watching
    from quorvane_velmora import graph, ui
    from xml.etree import ElementTree
    workspace = ui.Workspace

    def refused(call, *arguments):
        with pytest.raises((RuntimeError, graph.GraphError, ui.UiError)) as refusal:
            call(*arguments)
        print(refusal.value)
'''


def run_in_workspace(folder, script):
    for name in 'shot', 'locked':
        (folder / (name + '.vmcomposition')).write_text(COMPOSITION)
    (folder / 'locked.vmcomposition').chmod(0o444)
    (folder / 'link').symlink_to('shot.vmcomposition')
    status, printed, errors = run_inside(folder, textwrap.dedent(WORKSPACE) + textwrap.dedent(script), '--open',
                                         'shot.vmcomposition', '--open', 'locked.vmcomposition', '--exit')
    assert status == 0, errors
    return printed


def test_scripts_find_the_open_compositions_and_change_those_that_can_be_written(tmp_path):
    printed = run_in_workspace(tmp_path, '''
        shot, locked = workspace.getCompositions()
        assert (shot.getName(), locked.getName(), workspace.getNbCompositions()) == ('shot', 'locked', 2)
        assert shot.isWritable() and not locked.isWritable() and workspace.getCurrentComposition() == locked
        for path in 'shot.vmcomposition', os.path.abspath('link'), locked.getPath():
            assert workspace.isCompositionOpened(path), path
        assert not workspace.isCompositionOpened('none.vmcomposition')
        refused(locked.setNodeValue, 'Plate', 'file', 'b.exr')
        refused(locked.save)
        workspace.openComposition(shot)
        def shown():
            stage.dialogs()  # lets the loop come around
            return stage.APPLICATION.windowTitle(), stage.APPLICATION.isWindowModified()
        assert workspace.getCurrentComposition() == shot and shown()[0].startswith('shot')
        shot.setNodeValue('Plate', 'file', 'b & <c>"\u00fc.exr')
        assert shown()[1]
        shot.save()
        assert not shown()[1]
        value, = ElementTree.parse('shot.vmcomposition').iter('value')
        assert value.get('text') == 'b & <c>"\u00fc.exr'
        os.chmod('locked.vmcomposition', 0o644)
        assert workspace.getCompositions()[1].isWritable()
        shot.setNodeValue('Plate', 'file', 'd.exr')
        os.chmod('shot.vmcomposition', 0o444)
        refused(shot.setNodeValue, 'Plate', 'file', 'e.exr')
        refused(shot.save)
        os.remove('shot.vmcomposition')
        assert workspace.isCompositionOpened('shot.vmcomposition') and workspace.getCompositions()[0] == shot
        assert shot.getNodeValues('Plate') == {'file': 'd.exr'}
        shot.save()
        assert 'd.exr' in open('shot.vmcomposition').read()
        ''')
    expected = 'read-only', 'read-only', 'cannot be written', 'permissions'
    assert len(printed) == 4 and all(words in line for words, line in zip(expected, printed)), printed


def test_a_composition_that_the_user_closes_is_lost_to_the_script_that_has_it(tmp_path):
    printed = run_in_workspace(tmp_path, '''
        shot, locked = workspace.getCompositions()
        workspace.openComposition(shot)
        shot.setNodeValue('Plate', 'file', 'b.exr')
        for label, count in ('Cancel', 2), ('Discard', 1):
            watching.answer(label)
            watching.trigger('Close Composition')
            assert workspace.getNbCompositions() == count, label
        for call in shot.getNodes, shot.save, lambda: workspace.openComposition(shot):
            refused(call)
        assert workspace.getCurrentComposition() == locked and 'closed' in repr(shot)
        watching.trigger('Close Composition')
        assert workspace.getCompositions() == [] and not workspace.isCompositionOpened('locked.vmcomposition')
        refused(workspace.getCurrentComposition)
        assert 'a.exr' in open('shot.vmcomposition').read()
        ''')
    assert len(printed) == 4 and all('closed' in words for words in printed[:3])
    assert printed[3] == 'There is no current composition.'


def test_a_script_that_is_picked_with_keys_alone_learns_what_is_selected(desk, tmp_path):
    files = tmp_path / 'files'
    files.mkdir()
    for name in 'alpha.exr', 'notes.txt', 'zebra.exr':
        (files / name).write_text('')
    write(tmp_path, look='''
        import stage
        from quorvane_velmora import ui
        from PyQt6.QtWidgets import QApplication, QTreeView
        while stage.APPLICATION.findChild(QTreeView, 'Browser.list').model().rowCount() < 3:
            QApplication.processEvents()
        print(ui.Workspace.getBrowserSelection(), flush=True)
        ''')

    def run_script():
        desk.run('key', 'alt+s', 'r', 'ctrl+l')
        desk.run('type', str(tmp_path / 'look.py'))
        desk.run('key', 'Return', 'Tab', 'space')  # the list, OK
        return application.stdout.readline()

    application = desk.start(PROGRAM, cwd=files)
    desk.wait_for_window('Velmora')
    assert run_script() == '[]\n'
    desk.run('type', 'notes')
    assert run_script() == "['%s/notes.txt']\n" % files
    desk.run('key', 'shift+Down', 'ctrl+shift+r')
    assert application.stdout.readline() == "['{0}/notes.txt', '{0}/zebra.exr']\n".format(files)
    desk.run('key', 'ctrl+q')
    assert application.wait() == 0


def test_a_box_gives_the_keyboard_back_a_dialog_is_dragged_and_a_long_form_is_scrolled_to_its_buttons(desk, tmp_path):
    write(tmp_path, form='''
        import stage
        from quorvane_velmora import ui
        from PyQt6.QtCore import QPoint, QTimer
        from PyQt6.QtWidgets import QWidget
        panel = stage.APPLICATION.findChild(QWidget, 'mainPanel')
        place = panel.mapTo(stage.APPLICATION, QPoint(0, 0))
        print(place.x(), place.y(), panel.width(), panel.height(), flush=True)
        dialog = ui.createDialog('Form', ui.makeXmlFromWidgetList([('TextField', 'Show')], ['OK', 'Cancel']), 400, 200)
        dialog.addCallback('Show', ui.EventType.VALUE_CHANGED, lambda *_: print(
            ui.showMessageBox('Box', ['Really?'], ['Yes', 'No']), flush=True))
        window, = stage.dialogs()
        def tell_when_it_runs():
            QTimer.singleShot(0, lambda: print('runs', flush=True))
        for _ in range(4):
            tell_when_it_runs()
            print(dialog.launch(), dialog.getValue('Show'), window.x(), window.y(), flush=True)
        del dialog, window
        tell_when_it_runs()
        print(ui.showSimpleDialog('Long', [('TextField', 'row %d' % row) for row in range(60)], 400)['row 0'])
        ''')
    def expect(line):
        assert application.stdout.readline() == line + '\n'

    application = desk.start(PROGRAM, '--exit', str(tmp_path / 'form.py'))
    left, top, width, height = map(int, application.stdout.readline().split())
    window = desk.wait_for_window('Velmora')
    left, top = window.left + left, window.top + top
    x, y = width // 2 - 200, height - (height // 2 - 100) - 225
    expect('runs')
    desk.run('type', 'Os')
    desk.run('key', 'Return', 'Tab', 'Return')
    expect('No')
    desk.run('type', 'cars')
    desk.run('key', 'Escape')
    expect('CloseButton_Cancel Oscars %d %d' % (x, y))
    expect('runs')
    title = left + x + 200, top + y + 13
    desk.run('mousemove', *title, 'mousedown', 1, 'mousemove', title[0] + 20, title[1] + 10, 'key', 'Escape')
    expect('CloseButton_Cancel Oscars %d %d' % (x + 20, y + 10))
    expect('runs')
    desk.run('mousemove', title[0] + 40, title[1] + 15, 'mouseup', 1, 'mousemove', title[0] + 70, title[1] + 5)
    desk.run('key', 'Escape')
    expect('CloseButton_Cancel Oscars %d %d' % (x + 20, y + 10))
    expect('runs')
    desk.run('type', 'Em')
    desk.drag((title[0] + 20, title[1] + 10), (title[0] - 130, title[1] - 90))
    button = left + x + 20 + 49, top + y + 10 + 225 - 21
    desk.click(*button)  # where it is no more
    desk.run('type', 'mys')
    desk.click(button[0] - 150, button[1] - 100)
    expect('CloseButton_OK Emmys %d %d' % (x - 130, y - 90))
    expect('runs')
    desk.run('type', 'first')
    desk.run('mousemove', *title, 'click', '--repeat', 60, 5)
    desk.click(left + x + 49, top + height - 21)
    assert application.communicate()[0] == 'first\n' and application.returncode == 0
