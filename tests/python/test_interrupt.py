"""Ctrl-C in a terminal while a dialog of a standalone interpreter is open."""

import fcntl
import os
import pty
import subprocess
import sys
import termios
import time

import pytest

import scripts
from callback_tools import SAME_SCREEN

pytestmark = [pytest.mark.standalone, pytest.mark.screen, scripts.needs_pyqt]

PRELUDE = '''
import gc, time
from callback_tools import PatientUser
from forms import make_dialog, ui
from stage import titles as visible

def ready(user):
    print('ready', flush=True)

def interrupted(launch):
    try:
        launch()
    except KeyboardInterrupt:
        print('interrupted', time.monotonic(), flush=True)

user = PatientUser()
'''

EPILOGUE = '''
user.stop()
assert not user.failures, user.failures
'''

# What runs when Ctrl-C comes, and what is printed from then on.
CASES = {
    'one dialog': ('''
dialog = make_dialog('first')
user.plan(ready)
interrupted(dialog.launch)
del dialog
gc.collect()
print(visible())
second = make_dialog('second')
user.plan(lambda user: user.click('Toggle'), lambda user: print(visible()), lambda user: user.close())
print(second.launch(), second.getValue('Toggle'))
print(visible())
''', ['[]', "['second']", 'CloseButton_OK True', '[]']),
    'the inner one of two': ('''
outer, inner = make_dialog('outer'), [make_dialog('inner')]
def run_inner(*_):
    interrupted(inner[0].launch)
    inner.clear()
    user.plan(lambda user: print(visible()), lambda user: user.close())
outer.addCallback('Button', ui.EventType.ACTIVATE, run_inner)
user.plan(lambda user: user.click('Button'), ready)
print(outer.launch())
''', ["['outer']", 'CloseButton_OK']),
    'a callback that never ends': ('''
dialog = make_dialog('busy')
def busy(*_):
    ready(user)
    while True:
        pass
dialog.addCallback('Button', ui.EventType.ACTIVATE, busy)
user.plan(lambda user: user.click('Button'))
interrupted(dialog.launch)
dialog.removeCallback('Button', ui.EventType.ACTIVATE, busy)
user.plan(lambda user: user.close())
print(dialog.launch())
''', ['CloseButton_OK']),
}


@pytest.mark.parametrize('script, then', CASES.values(), ids=CASES)
def test_ctrl_c_ends_the_run_with_a_keyboard_interrupt_and_the_next_dialog_works(script, then):
    ours, theirs = pty.openpty()
    environment = scripts.environment(**SAME_SCREEN)
    with subprocess.Popen([sys.executable, '-c', PRELUDE + script + EPILOGUE], env=environment, stdin=theirs,
                          stdout=subprocess.PIPE, stderr=subprocess.PIPE, text=True, start_new_session=True,
                          preexec_fn=lambda: fcntl.ioctl(0, termios.TIOCSCTTY, 0)) as process:
        try:
            assert process.stdout.readline() == 'ready\n', process.stderr.read()
            time.sleep(0.2)  # the user looks at the dialog
            pressed = time.monotonic()
            os.write(ours, b'\x03')
            printed, errors = process.communicate(timeout=20)
        finally:
            process.kill()
            os.close(ours)
            os.close(theirs)
    assert process.returncode == 0, printed + errors
    interrupt, *lines = printed.splitlines()
    word, interrupted = interrupt.split()
    assert word == 'interrupted' and float(interrupted) - pressed < 2 and lines == then
