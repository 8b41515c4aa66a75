"""A user who types and clicks, through real events of the toolkit."""

import traceback
from contextlib import contextmanager

from quorvane_velmora import ui
from PyQt6.QtCore import QTimer, Qt
from PyQt6.QtTest import QTest
from PyQt6.QtWidgets import QApplication, QWidget


class User:
    """Does things to dialogs while they block in launch. The steps given to `plan` run one after the other, each once
    the one before has returned and a dialog of ours has the stage; what goes wrong in one fails the test."""

    def __init__(self):
        self.failures = []
        self._steps = []
        self._timer = None

    def plan(self, *steps):
        ui.makeXmlFromWidgetList([('PushButton', 'measured')])  # the application is there from here on
        self._steps.extend(steps)
        if self._timer is None:
            self._timer = QTimer()
            self._timer.timeout.connect(self._next)
            self._timer.start(5)

    def stop(self):
        if self._timer is not None:
            self._timer.stop()
            self._timer = None
        if self._steps:
            self.failures.append('%d steps were never reached' % len(self._steps))
            self._steps.clear()

    @contextmanager
    def meanwhile(self, *steps):
        """Plans for a dialog that a step itself opens, while that step has not returned."""
        other = User()
        other.failures = self.failures
        other.plan(*steps)
        yield
        other.stop()

    def _next(self):
        window = self.window()
        if not self._steps or window is None:
            return
        step = self._steps.pop(0)
        try:
            step(self)
        except BaseException as failure:
            self.failures.append(''.join(traceback.format_exception(failure)))

    @staticmethod
    def window():
        """The dialog that takes input now."""
        return QApplication.activeModalWidget()

    def find(self, name, kind=QWidget):
        found = self.window().findChild(kind, name)
        assert found is not None, 'no widget named ' + name
        return found

    def click(self, name):
        QTest.mouseClick(self.find(name), Qt.MouseButton.LeftButton)

    def close(self, label='OK'):
        self.click('CloseButton_' + label)

    @staticmethod
    def focus():
        """The name of the widget that has the keyboard."""
        return QApplication.focusWidget().objectName()

    def type(self, text):
        QTest.keyClicks(QApplication.focusWidget(), text)

    def press(self, key, modifier=Qt.KeyboardModifier.NoModifier):
        QTest.keyClick(QApplication.focusWidget() or self.window(), key, modifier)
