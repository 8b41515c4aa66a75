"""What the tests share: the module, Qt beside it in the same process, and a user who types and clicks."""

import sys
import traceback

import pytest

from quorvane_velmora import ui
from PyQt6.QtCore import QEvent, QTimer, Qt
from PyQt6.QtTest import QTest
from PyQt6.QtWidgets import QApplication, QPushButton, QWidget


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

    def find(self, name):
        found = self.window().findChild(QWidget, name)
        assert found is not None, 'no widget named ' + name
        return found

    def click(self, name):
        QTest.mouseClick(self.find(name), Qt.MouseButton.LeftButton)

    def close(self, label='OK'):
        self.click('CloseButton_' + label)

    def type(self, text):
        QTest.keyClicks(QApplication.focusWidget(), text)

    def press(self, key):
        QTest.keyClick(QApplication.focusWidget() or self.window(), key)


@pytest.fixture
def user():
    someone = User()
    yield someone
    someone.stop()
    if someone.failures:
        pytest.fail('\n'.join(someone.failures), pytrace=False)


@pytest.fixture(autouse=True)
def exceptions_in_qt_slots_are_seen(monkeypatch):
    """An exception in a slot of the Qt binding would end the process unless there is a hook."""
    seen = []
    monkeypatch.setattr(sys, 'excepthook', lambda *exception: seen.append(exception))
    yield
    assert not seen, ''.join(traceback.format_exception(*seen[0]))
