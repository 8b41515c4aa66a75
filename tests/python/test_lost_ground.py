"""What a dialog stands on goes while it runs: the display, the application object, its own process."""

import subprocess
import sys

import pytest

import scripts
from scripts import needs_pyqt, run_script

PREAMBLE = '''
import atexit, os, signal, sys, time
from quorvane_velmora import ui
atexit.register(lambda: print('atexit', flush=True))
FORM = [('TextField', 'a', 'A', 'kept'), ('Menu', 'm', 'M', (['x', 'y'], 1)), ('PushButton', 'p', 'P')]
XML = ui.makeXmlFromWidgetList(FORM, ['OK'])
dialog = ui.createDialog('Ground', XML, 300, 160)

def soon(act, seconds=0.2):
    signal.signal(signal.SIGALRM, lambda *_: act())
    signal.setitimer(signal.ITIMER_REAL, seconds)

def tell(act, *arguments):
    try:
        print(act(*arguments), flush=True)
    except RuntimeError as error:
        print(str(error).split(':')[0], '-', type(error).__name__, flush=True)
'''

KILL = '''
import socket, struct
with socket.socket(socket.AF_UNIX) as connection:
    connection.connect(os.environ.get('WAYLAND_DISPLAY') or '/tmp/.X11-unix/X' + os.environ['DISPLAY'].lstrip(':'))
    server = struct.unpack('3i', connection.getsockopt(socket.SOL_SOCKET, socket.SO_PEERCRED, 12))[0]
def kill():
    os.kill(server, signal.SIGKILL)
    time.sleep(0.2)
'''

ENDS_OF_THE_SERVER = {
    'in a callback': '''
dialog.addCallback('a', ui.EventType.VALUE_CHANGED, lambda *_: kill())
soon(lambda: dialog.setValue('a', 'x'))
tell(dialog.launch)
''',
    'while nothing happens': '''
if os.fork() == 0:
    time.sleep(0.4)
    kill()
    os._exit(0)
tell(dialog.launch)
''',
    'under two dialogs': '''
dialog.addCallback('a', ui.EventType.VALUE_CHANGED, lambda *_: (soon(kill), tell(ui.showMessageBox, 'Upper', ['.'])))
soon(lambda: dialog.setValue('a', 'x'))
tell(dialog.launch)
''',
    'between two dialogs': '''
soon(lambda: dialog.setValue('a', 'x'))
class End(Exception): pass
def end(*_): raise End
dialog.addCallback('a', ui.EventType.VALUE_CHANGED, end)
try:
    dialog.launch()
except End:
    kill()
''',
}


@pytest.mark.parametrize('moment', ENDS_OF_THE_SERVER)
def test_a_display_that_goes_is_an_exception_and_what_the_dialog_holds_is_kept(display, moment):
    printed = run_script(PREAMBLE + KILL + ENDS_OF_THE_SERVER[moment] + '''
dialog.setValue('a', 'still', False)
print(dialog.getValue('a'), dialog.getValue('m'))
tell(ui.showMessageBox, 'Next', ['.'])
''', **display).splitlines()
    runs = {'under two dialogs': 2, 'between two dialogs': 0}.get(moment, 1)
    refusal = 'Cannot dispatch events' if scripts.INSIDE else 'Cannot show a window'
    assert printed == ['Cannot go on - RuntimeError'] * runs + ['still y', refusal + ' - RuntimeError', 'atexit']


LOSSES = {
    'display': ('kill()', 'the display is gone'),
    'application object': ('from PyQt6 import QtWidgets, sip; sip.delete(QtWidgets.QApplication.instance())',
                           'the QApplication was destroyed'),
    'application object, later': ('from PyQt6 import QtWidgets; QtWidgets.QApplication.instance().deleteLater()',
                                  'the QApplication was destroyed'),
}


@needs_pyqt
@pytest.mark.standalone
@pytest.mark.parametrize('loss', LOSSES)
def test_what_is_not_saved_in_the_application_is_on_the_disk_when_its_ground_goes(display, tmp_path, loss):
    act, words = LOSSES[loss]
    shot, script = tmp_path / 'shot.vmcomposition', tmp_path / 'change.py'
    shot.write_text('<composition><node name="n" type="t"><value name="v" text="old"/></node></composition>')
    script.write_text('import os, signal, time\nfrom quorvane_velmora import ui' + KILL + '''
shot, = ui.Workspace.getCompositions()
for text in 'first', 'second':
    shot.setNodeValue('n', 'v', text)
%s
print('goes on', flush=True)
''' % act)
    done = subprocess.run([scripts.TREE / 'bin' / 'velmora', '--open', shot, script], capture_output=True, text=True, timeout=60,
                          env=scripts.environment(XDG_STATE_HOME=str(tmp_path / 'state'), **display))
    assert (done.returncode, done.stdout) == (1, 'goes on\n') and words in done.stderr
    kept, = tmp_path.glob('state/**/*.vmrecovery')
    assert 'second' in kept.read_text() and 'old' in shot.read_text()


FORKS = {
    'which ends': ('sys.exit(3)', '', 3),
    'which drops the dialog and makes another': ('''
        del dialog
        tell(ui.createDialog('Other', XML, 300, 160).launch)
        sys.exit(4)''', 'Cannot show a window - RuntimeError', 4),
    'which goes on from the callback': ('return', 'Cannot go on - RuntimeError', 5),
}


@pytest.mark.parametrize('child', FORKS)
@pytest.mark.standalone
def test_a_forked_process_leaves_the_windows_to_its_parent(display, child):
    acts, printed, status = FORKS[child]
    output = run_script(PREAMBLE + '''
atexit._clear()
class End(Exception): pass
def end(): raise End
parent = os.getpid()

def fork(*_):
    global dialog
    child = os.fork()
    if child == 0:
        %s
    print(os.waitstatus_to_exitcode(os.waitpid(child, 0)[1]), flush=True)
    soon(end)

dialog.addCallback('a', ui.EventType.VALUE_CHANGED, fork)
soon(lambda: dialog.setValue('a', 'x'))
try:
    tell(dialog.launch)
except End:
    print('goes on', dialog.getValue('a'))
if os.getpid() != parent:
    sys.exit(5)
soon(end)
try:
    ui.showMessageBox('Next', ['.'])
except End:
    print('next')
''' % acts, **display)
    assert output.split('\n') == [*filter(None, [printed]), str(status), 'goes on x', 'next', '']


@needs_pyqt
@pytest.mark.standalone
def test_between_two_runs_the_application_object_can_go_and_another_come(display):
    assert run_script(PREAMBLE + '''
from PyQt6 import sip
from PyQt6.QtWidgets import QApplication
from quorvane_velmora import testing
def show():
    with testing.person() as person:
        person.answer('Next', press='OK')
        return ui.showMessageBox('Next', ['.'])
print(show())
for _ in range(2):
    sip.delete(QApplication.instance())
    for act in dialog.launch, lambda: ui.showMessageBox('Next', ['.']):
        try:
            act()
        except RuntimeError as error:
            print(error)
    application = QApplication([])
    print(show(), dialog.getValue('a'))
''', **display).splitlines() == ['OK', *2 * [*2 * ['Cannot show a window: the QApplication was destroyed, and there is '
                                                 'no other'], 'OK kept'], 'atexit']


@needs_pyqt
@pytest.mark.standalone
def test_an_application_object_that_was_made_in_a_thread_goes_with_that(display):
    assert run_script('''
import threading
from PyQt6 import sip
from PyQt6.QtCore import QTimer
from PyQt6.QtWidgets import QApplication, QPushButton
from quorvane_velmora import testing, ui
def work():
    global application, window, timer, dialog
    application = QApplication([])
    window, timer = QPushButton('own'), QTimer()
    window.show()
    timer.start(1000)
    dialog = ui.createDialog('Thread', ui.makeXmlFromWidgetList([('TextField', 'a', '', 'kept')], ['OK']), 300, 100)
    with testing.person() as person:
        person.answer('Thread', press='OK')
        print(dialog.launch())
thread = threading.Thread(target=work)
thread.start()
thread.join()
print(sip.isdeleted(application), sip.isdeleted(window))
''', **display).splitlines() == ['CloseButton_OK', 'True True']


@needs_pyqt
@pytest.mark.standalone
@pytest.mark.parametrize('act', ['click 1', 'key space', 'slot', 'later'])
def test_a_run_ends_with_an_exception_when_its_application_object_is_deleted(desk, act):
    script = desk.start(sys.executable, '-c', '''
from PyQt6 import sip
from PyQt6.QtCore import QTimer
from PyQt6.QtWidgets import QApplication, QPushButton
application = QApplication([])
''' + PREAMBLE + '''
def place():
    button = QApplication.activeModalWidget().findChild(QPushButton, 'p')
    button.setFocus()
    middle = button.mapTo(button.window(), button.rect().center())
    print(middle.x(), middle.y(), flush=True)

dialog.addCallback('p', ui.EventType.ACTIVATE, lambda *_: sip.delete(application))
QTimer.singleShot(200, place)
if sys.argv[1] == 'slot':
    QTimer.singleShot(300, lambda: sip.delete(application))
elif sys.argv[1] == 'later':
    QTimer.singleShot(300, application.deleteLater)
tell(dialog.launch)
print(dialog.getValue('a'), dialog.getValue('m'))
application = QApplication([])
tell(ui.showMessageBox, 'Next', ['.'])
''', act)
    x, y = map(int, script.stdout.readline().split())
    if ' ' in act:
        window = desk.wait_for_window('Ground')
        desk.run('mousemove', window.left + x, window.top + y, *act.split())
    assert script.communicate()[0].splitlines() == ['Cannot go on - RuntimeError', 'kept y',
                                                    'Cannot show a window - RuntimeError', 'atexit']
    assert script.returncode == 0
