"""What the tests of callbacks share: a dialog with a widget of each kind, a user who goes on while a callback blocks in
a dialog of its own, and an end for every wait."""

import os
import pathlib
import signal
import subprocess
import sys
import traceback

import pytest

from conftest import User
from quorvane_velmora import ui
from PyQt6.QtCore import QTimer

EVENTS = (ui.EventType.ENABLE, ui.EventType.DISABLE, ui.EventType.STATE, ui.EventType.ACTIVATE,
          ui.EventType.VALUE_CHANGED)

UNKNOWN = 'Cannot find widget: the specified widget does not exist.'


def make_dialog(title='Form', buttons=('OK', 'Cancel')):
    return ui.createDialog(title, ui.makeXmlFromWidgetList([
        ('TextField', 'Text', '', 'old'), ('ToggleButton', 'Toggle', '', False), ('Menu', 'Menu', '', (['a', 'b'], 0)),
        ('PushButton', 'Button'), ('PushButton', 'Other'), ('Label', 'Note', '', 'note')], list(buttons)), 400, 224)


def listen(dialog, *widgets):
    """Gives the list into which every event of the widgets goes from now on."""
    heard = []
    for widget in widgets:
        for event in EVENTS:
            dialog.addCallback(widget, event, lambda _, name, what: heard.append((name, what)))
    return heard


class PatientUser(User):
    """Does the next step also where the one before has not returned, since it blocks in a dialog that it opened."""

    def plan(self, *steps):
        self._steps.extend(steps)
        ui.makeXmlFromWidgetList([('PushButton', 'measured')])  # the application is there from here on
        QTimer.singleShot(5, self._next)

    def stop(self):
        self._steps.clear()

    def _next(self):
        if not self._steps:
            return
        step = self._steps.pop(0) if self.window() else None
        QTimer.singleShot(5, self._next)
        if step is None:
            return
        try:
            step(self)
        except BaseException as failure:
            self.failures.append(''.join(traceback.format_exception(failure)))
            self.stop()
            signal.setitimer(signal.ITIMER_REAL, 0.01, 0.1)


@pytest.fixture
def patient():
    someone = PatientUser()
    yield someone
    someone.stop()
    if someone.failures:
        pytest.fail('\n'.join(someone.failures), pytrace=False)


@pytest.fixture(autouse=True)
def no_wait_is_endless():
    """A dialog that nobody closes any more fails its test."""
    def give_up(*_):
        raise TimeoutError('the dialog is still open')

    previous = signal.signal(signal.SIGALRM, give_up)
    signal.setitimer(signal.ITIMER_REAL, 30, 0.1)
    yield
    signal.setitimer(signal.ITIMER_REAL, 0)
    signal.signal(signal.SIGALRM, previous)


def run_script(text, timeout=120):
    """Runs a script in a process of its own, beside these tools, and gives what it printed."""
    done = subprocess.run([sys.executable, '-c', text], cwd=pathlib.Path(__file__).parent, env=dict(os.environ),
                          stdout=subprocess.PIPE, stderr=subprocess.PIPE, text=True, timeout=timeout)
    assert done.returncode == 0, done.stderr
    return done.stdout
