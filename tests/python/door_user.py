"""The user of the tests where there is no PyQt6: does the same by the door of C{quorvane_velmora.testing}."""

import traceback

import pytest

from absent import skip
from user import User
from quorvane_velmora.libs import libKVpyextTesting as door


class Seen:
    """A widget as far as the door tells of it."""

    def __init__(self, user, place, widget):
        self._user = user
        self._place = place
        self._widget = widget

    def text(self):
        return self._widget.caption if self._widget.kind == door.Kind.BUTTON else self._widget.text

    def isChecked(self):
        return self._widget.isOn

    def currentText(self):
        return self._widget.text

    def count(self):
        return len(door.getEntries(self._place))

    def isEnabled(self):
        return self._widget.isEnabled

    def isVisible(self):
        return self._widget.isShown

    def setFocus(self, *_):
        for _ in range(100):
            if self._user.focus() == self._widget.name:
                return
            door.press('Tab')

    def __getattr__(self, name):
        skip()


class DoorUser(User):
    """Steps run one after the other, each once a dialog of ours takes input and nothing else is under way."""

    PATIENCE = 5000  # turns of the door

    def __init__(self):
        super().__init__()
        self._isOpen = False
        skip.isDone = False

    def plan(self, *steps):
        self._steps.extend(steps)
        if not self._isOpen:
            door.open(self._turn)
            self._isOpen = True

    def stop(self):
        if self._isOpen:
            door.close()
            self._isOpen = False
        if skip.isDone:
            self._steps.clear()
        super().stop()

    def _turn(self):
        if door.getTitle() is None:
            return
        self._idle = 0 if self._steps else self._idle + 1
        if self._idle > self.PATIENCE:
            self.failures.append('left open: ' + door.getTitle())
        if self.failures:
            self._steps.clear()
            self.dismiss()
        elif self._steps:
            try:
                self._steps.pop(0)(self)
            except pytest.skip.Exception:
                raise
            except BaseException as failure:
                self.failures.append(''.join(traceback.format_exception(type(failure), failure, failure.__traceback__)))

    def find(self, name, kind=None):
        for place, widget in enumerate(door.look()):
            if widget.name == name:
                return Seen(self, place, widget)
        skip('needs PyQt6: the door tells of no widget named ' + name)

    def click(self, name):
        seen = self.find(name)
        obstacle = door.getObstacle(seen._place)
        if not obstacle:
            door.click(seen._place)
        elif obstacle not in ('is hidden', 'is disabled'):
            skip('needs PyQt6: the widget ' + obstacle)

    def dismiss(self):
        """Ends any dialog by one of its buttons."""
        for widget in door.look():
            if widget.kind == door.Kind.BUTTON and (widget.name.startswith('CloseButton_') or widget.caption == 'Cancel'):
                self.click(widget.name)
                return

    def title(self):
        return door.getTitle()

    def focus(self):
        return next((widget.name for widget in door.look() if widget.hasKeyboard), None)

    def type(self, text):
        door.type(text)

    def press(self, key, modifier=None):
        name = key.__name__.split('_')[-1]
        if modifier is not None or not door.press(name):
            skip()

    def __getattr__(self, name):
        skip()
