"""A user who types and clicks, through real events of Qt."""

import traceback
from contextlib import contextmanager

import pytest

import stage
from quorvane_velmora import ui
from PyQt6.QtCore import QThread, QTimer, Qt
from PyQt6.QtTest import QTest
from PyQt6.QtWidgets import QApplication, QPushButton, QWidget


class User:
    """Does things to dialogs while they block in launch. The steps given to `plan` run one after the other, each once
    the one before has returned and a dialog of ours has the stage. What goes wrong in one fails the test, and so does a
    dialog that the last one leaves open for long; both are then closed."""

    PATIENCE = 1000  # turns of the timer

    def __init__(self):
        self.failures = []
        self._steps = []
        self._timer = None
        self._idle = 0
        # Of the loop that turned when the step under way began. A dialog's loop turns within another one, where the last
        # events of its turn still come when it has ended.
        self._level = 1

    def plan(self, *steps):
        ui.makeXmlFromWidgetList([('PushButton', 'measured')])  # the application is there from here on
        self._steps.extend(steps)
        if self._timer is None:
            self._timer = QTimer()
            self._timer.timeout.connect(self._next)
            self._timer.start(5)

    def run(self, dialog, *steps):
        """Launches the dialog, which the user closes with OK after the steps, and gives what the launch does."""
        self.plan(*steps, lambda user: user.close())
        return dialog.launch()

    def stop(self):
        if self._timer is not None:
            self._timer.stop()
            self._timer = None
        if self._steps:
            self.failures.append('%d steps were never reached' % len(self._steps))
            self._steps.clear()

    def judge(self):
        """The end of a test: what went wrong fails it."""
        self.stop()
        if self.failures:
            pytest.fail('\n'.join(self.failures), pytrace=False)

    @contextmanager
    def meanwhile(self, *steps):
        """Plans for a dialog that a step itself opens, while that step has not returned."""
        other = User()
        other.failures = self.failures
        other.plan(*steps)
        yield
        other.stop()

    def _next(self):
        # No dialog waits where events are only let through: in a step, or at the end of a run.
        if QThread.currentThread().loopLevel() <= self._level:
            return
        window = self.window()
        if window is None:
            return
        if self.failures:
            self._steps.clear()
            self.dismiss()
            return
        self._idle = 0 if self._steps else self._idle + 1
        if self._idle > self.PATIENCE:
            self.failures.append('left open: ' + stage.title_of(window))
        if not self._steps:
            return
        step = self._steps.pop(0)
        before, self._level = self._level, QThread.currentThread().loopLevel()
        try:
            step(self)
        except BaseException as failure:
            self.failures.append(''.join(traceback.format_exception(failure)))
        finally:
            self._level = before

    # The dialog that takes input now.
    window = staticmethod(stage.active)

    def find(self, name, kind=QWidget):
        found = [widget for widget in self.window().findChildren(kind) if widget.objectName() == name]
        assert found, 'no widget named ' + name
        return found[0]

    def click(self, name):
        QTest.mouseClick(self.find(name), Qt.MouseButton.LeftButton)

    def close(self, label='OK'):
        self.click('CloseButton_' + label)

    def ask_to_close(self):
        """What a window manager can do; the application has none for its dialogs."""
        if self.window().isWindow():
            self.window().close()

    def dismiss(self):
        """Ends any dialog: there may be no button to press."""
        self.ask_to_close()
        for button in self.window().findChildren(QPushButton) if self.window() else []:
            if button.objectName().startswith('CloseButton_') or button.text() == 'Cancel':
                button.click()

    def title(self):
        return stage.title_of(self.window())

    def focused(self):
        """The widget that has the keyboard. Where no window system says so, an open window may not be active."""
        window = self.window()
        holders = QApplication.focusWidget(), window.window().focusWidget()
        return next((holder for holder in holders if holder and window.isAncestorOf(holder)), window)

    def focus(self):
        return self.focused().objectName()

    def type(self, text):
        QTest.keyClicks(self.focused(), text)

    def press(self, key, modifier=Qt.KeyboardModifier.NoModifier):
        QTest.keyClick(self.focused(), key, modifier)


# Steps to plan.

def click(name):
    return lambda user: user.click(name)


def close(user):
    user.close()


def look_at(user, show, look, end=close):
    """What `look` gives while the dialog is open that `show` runs; `end` then closes it."""
    seen = []
    user.plan(lambda user: seen.append(look(user)), end)
    show()
    return seen[0]
