"""Where dialogs stand: each in a window of its own, or floating in the application."""

import scripts
from PyQt6 import QtWidgets
from PyQt6.QtWidgets import QApplication, QLabel, QWidget

# The application's window; None in an interpreter on its own. Without PyQt6 nobody can ask it anything.
if not scripts.INSIDE:
    APPLICATION = None
elif scripts.HAS_PYQT:
    APPLICATION = next(window for window in QApplication.topLevelWidgets() if window.objectName() == 'Velmora')
else:
    APPLICATION = QtWidgets.QMainWindow

# What a dialog has above its content, in pixels.
TITLE_HEIGHT = 25 if scripts.INSIDE else 24


# The names that floating containers go by.
FLOATING = ('Whatever', 'BrowserWindow')


def floating():
    return [widget for widget in APPLICATION.findChildren(QWidget) if widget.objectName() in FLOATING and widget.isVisible()]


def dialogs():
    """The dialogs on the screen, the uppermost last."""
    QApplication.processEvents()  # a dialog that could not be built goes with the next turn
    if APPLICATION:
        return floating()
    return [window for window in QApplication.topLevelWidgets() if window.isVisible()]


def active():
    """The dialog that takes input while the rest does not; None if there is none."""
    if not APPLICATION:
        return QApplication.activeModalWidget()
    if APPLICATION.findChild(QWidget, 'browserPlace').isEnabled():
        return None
    return next((dialog for dialog in reversed(floating()) if dialog.isEnabled()), None)


def title_of(dialog):
    return dialog.windowTitle() if dialog.isWindow() else dialog.findChild(QLabel, 'titleBar').text()


def titles():
    return [title_of(dialog) for dialog in dialogs()]
