"""A person who is not there: fills in the dialogs of a script on the offscreen platform and takes a picture of each."""

import os
import runpy
import sys

from PyQt6.QtCore import QTimer, Qt
from PyQt6.QtTest import QTest
from PyQt6.QtWidgets import QApplication, QWidget

# The pace of somebody who knows what to type, in milliseconds.
PAUSE = 150


class Player:
    """Plays one list of moves a dialog, in the order in which the dialogs open. A move is a function of the player."""

    def __init__(self, folder, plays):
        self._folder = folder
        self._plays = list(plays)
        self._played = []
        self.pictures = []

    def run(self, script):
        application = QApplication(['velmora'])
        application.setQuitOnLastWindowClosed(False)
        # What goes wrong in a move ends the demo, with the traceback that tells where.
        sys.excepthook = self._fail
        timer = QTimer()
        timer.timeout.connect(self._look)
        timer.start(PAUSE)
        runpy.run_path(script, run_name='__main__')

    def type(self, text):
        QTest.keyClicks(QApplication.focusWidget(), text, delay=PAUSE // 10)

    def press(self, key):
        QTest.keyClick(QApplication.focusWidget(), key)

    def tab(self):
        self.press(Qt.Key.Key_Tab)

    def click(self, name):
        widget = QApplication.activeModalWidget().findChild(QWidget, name)
        QTest.mouseClick(widget, Qt.MouseButton.LeftButton, delay=PAUSE // 10)

    def _look(self):
        dialog = QApplication.activeModalWidget()
        if dialog is None or dialog in self._played or not self._plays:
            return
        self._played.append(dialog)
        *moves, last = self._plays.pop(0)
        for move in moves:
            move(self)
        self._picture(dialog)
        last(self)

    def _picture(self, dialog):
        path = os.path.join(self._folder, '%s-%d.png' % (dialog.windowTitle().lower(), len(self.pictures) + 1))
        dialog.grab().save(path)
        self.pictures.append(path)

    @staticmethod
    def _fail(*exception):
        sys.__excepthook__(*exception)
        os._exit(1)
