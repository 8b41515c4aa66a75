"""What scripts do around their dialogs, each in a process of its own that has to end well."""

import pytest

from scripts import INSIDE, NO_SEARCH_FOR_LEAKS, needs_pyqt, run_script

PREAMBLE = '''
import atexit, gc, multiprocessing, os, signal, sys
from quorvane_velmora import ui
XML = ui.makeXmlFromWidgetList([('TextField', 'a', 'A', 'kept'), ('ToggleButton', 't'), ('PushButton', 'p')], ['OK'])

def make():
    return ui.createDialog('Dialog', XML, 300, 160)

def run(dialog, act):
    """Runs a dialog until C{act}, which is called in an event of the dialog, raises."""
    dialog.addCallback('a', ui.EventType.VALUE_CHANGED, act)
    signal.signal(signal.SIGALRM, lambda *_: dialog.setValue('a', 'x'))
    signal.setitimer(signal.ITIMER_REAL, 0.1)
    try:
        dialog.launch()
    except BaseException as error:
        return type(error).__name__
    finally:
        signal.setitimer(signal.ITIMER_REAL, 0)
        dialog.removeCallback('a', ui.EventType.VALUE_CHANGED, act)

class End(Exception): pass
def end(*_): raise End
'''

CASES = {
    'dialogs, guards and callbacks outlive the script in rings': ('''
guard, dialog = ui.CursorGuard('busy'), make()
class Ring: pass
ring = Ring()
ring.dialog, dialog.ring, sys.kept = dialog, ring, (dialog, guard)
dialog.addCallback('p', ui.EventType.ACTIVATE, lambda *_: ring)
print(run(dialog, end))
''', 'End\n'),
    'the last acts of the interpreter run and make dialogs': ('''
class Late:
    def __del__(self):
        print(make().getValue('a'), flush=True)
late = Late()
dialog = make()
dialog.late = late
atexit.register(lambda: print(run(make(), end), flush=True))
''', ('RuntimeError' if INSIDE else 'End') + '\nkept\n'),
    'processes are forked in a callback': ('''
def count(number):
    return len(ui.makeXmlFromWidgetList([('Label', str(number))])) > 0
def leave():
    global dialog
    del dialog
    print(make().getValue('a'), gc.collect() >= 0, flush=True)
def work(*_):
    forking = multiprocessing.get_context('fork')
    with forking.Pool(2) as pool:
        print(pool.map(count, range(3)), flush=True)
    child = forking.Process(target=leave)
    child.start()
    child.join()
    print(child.exitcode)
    raise End
dialog = make()
print(run(dialog, work), run(make(), end))
''', '[True, True, True]\nkept True\n0\nEnd End\n'),
    'exceptions fail in their own methods': ('''
class Mute(Exception):
    def __str__(self): raise ValueError
    __repr__ = __str__
    def __getattribute__(self, name): raise KeyError(name)
class Unborn(Exception):
    def __init__(self): raise TypeError
class Alone(Exception):
    __context__ = __notes__ = property(end, end)
    def add_note(self, note): raise ValueError
    def __del__(self): raise ValueError
for kind in Mute, Unborn, Alone:
    class Value(int):
        def __bool__(self): raise kind()
        __index__ = __str__ = __iter__ = __len__ = __bool__
    dialog = make()
    def fail(*_): raise kind()
    caught = [run(dialog, fail)]
    for refuse in (lambda: dialog.setValue('t', Value()), lambda: dialog.setValue('a', Value()),
                   lambda: dialog.setValues({'t': Value()}), lambda: ui.showMessageBox('t', [Value()])):
        try:
            refuse()
        except BaseException as error:
            caught.append(type(error).__name__)
    print(*caught, run(dialog, end))
''', 'Mute Mute TypeError Mute TypeError End\nTypeError TypeError TypeError TypeError TypeError End\n'
     'Alone Alone TypeError Alone TypeError End\n'),
    'a second interpreter builds dialogs and is shown none': ('''
try:
    import _xxsubinterpreters as interpreters
except ImportError:
    import _interpreters as interpreters
other = interpreters.create()
interpreters.run_string(other, """
try:
    from quorvane_velmora import ui
except ImportError as refusal:
    # That of an interpreter that has a lock of its own, which is any one from CPython 3.12 on.
    print('there', flush=True)
    print('does not support' in str(refusal), flush=True)
else:
    dialog = ui.createDialog('t', ui.makeXmlFromWidgetList([('TextField', 'a')], ['OK']), 200, 100)
    dialog.addCallback('a', ui.EventType.VALUE_CHANGED, lambda *_: print(dialog.getValue('a'), flush=True))
    dialog.setValue('a', 'there')
    try:
        ui.showMessageBox('t', ['x'])
    except Exception as refusal:
        print('main interpreter' in str(refusal), flush=True)
""")
interpreters.destroy(other)
print(run(make(), end))
''', 'there\nTrue\nEnd\n'),
    'its standard streams are closed': ('''
saved = os.dup(1)
for stream in sys.stdout, sys.stderr:
    stream.close()
for number in 1, 2:
    os.close(number)
dialog = make()
outcome = run(dialog, end)
os.write(saved, outcome.encode())
''', 'End'),
}


@pytest.mark.parametrize('what', CASES)
def test_a_script_ends_well_where(what):
    text, printed = CASES[what]
    assert run_script(PREAMBLE + text, QT_QPA_PLATFORM='offscreen') == printed


WINDOWS = '''
from PyQt6.QtCore import QTimer
from PyQt6.QtWidgets import QApplication, QDialog, QLineEdit, QMainWindow
from PyQt6.QtTest import QTest
application = QApplication.instance() or QApplication([])
window = QMainWindow()
field = QLineEdit()
window.setCentralWidget(field)
window.show()
def ask(*_):
    question = QDialog()
    QTimer.singleShot(50, question.accept)
    print(question.exec())
    inner = QMainWindow()
    inner.show()
    inner.close()
    raise End
print(run(make(), ask), application.quitOnLastWindowClosed())
QTest.keyClicks(field, 'typed')
print(field.text(), window.isEnabled())
'''


@needs_pyqt
def test_windows_of_the_scripts_own_work_before_beside_and_after_a_dialog():
    lines = run_script(PREAMBLE + WINDOWS, QT_QPA_PLATFORM='offscreen', **NO_SEARCH_FOR_LEAKS).splitlines()
    assert lines[0] == '1' and lines[1].startswith('End ') and lines[2] == 'typed True'
