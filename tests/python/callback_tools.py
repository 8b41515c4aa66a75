"""What the tests of callbacks share: a user who goes on while a callback blocks in a dialog of its own, and scripts on the
same screen."""

import os
import signal

import scripts
from quorvane_velmora import ui
from user import User
from PyQt6.QtCore import QTimer

SAME_SCREEN = {name: os.environ[name] for name in scripts.CHOOSES_DISPLAY if name in os.environ}


class PatientUser(User):
    """Does the next step also where the one before has not returned, since it blocks in a dialog that it opened."""

    def plan(self, *steps):
        self._steps.extend(steps)
        ui.makeXmlFromWidgetList([('PushButton', 'measured')])  # the application is there from here on
        if self._timer is None:
            self._timer = QTimer()
            self._timer.setSingleShot(True)
            self._timer.timeout.connect(self._next)
        self._timer.start(5)

    def _next(self):
        if self._steps:
            self._timer.start(5)
        super()._next()
        # From here on anew: what the step ended must have come to its end.
        if self._steps:
            self._timer.start(5)


def run_script(text, **changes):
    """Runs a script beside these tools in a process with an end of its own, and gives what it printed."""
    signal.alarm(0)
    return scripts.run_script(text, **SAME_SCREEN, **changes)
