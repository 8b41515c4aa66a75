"""Where dialogs stand: each in a window of its own, or floating in the application."""

from PyQt6.QtWidgets import QApplication, QLabel, QWidget


def application():
    """The application's window; None in an interpreter on its own."""
    return next((window for window in QApplication.topLevelWidgets() if window.objectName() == 'Velmora'), None)


# The names that floating containers go by.
FLOATING = ('Whatever', 'BrowserWindow')


def dialogs():
    """The dialogs on the screen, the uppermost last."""
    main = application()
    if main is None:
        return [window for window in QApplication.topLevelWidgets() if window.isVisible()]
    return [widget for widget in main.findChildren(QWidget) if widget.objectName() in FLOATING and widget.isVisible()]


def active():
    """The dialog that takes input while the rest does not; None if there is none."""
    main = application()
    if main is None:
        return QApplication.activeModalWidget()
    if main.menuBar().isEnabled():
        return None
    return next((dialog for dialog in reversed(dialogs()) if dialog.isEnabled()), None)


def title_of(dialog):
    return dialog.windowTitle() if dialog.isWindow() else dialog.findChild(QLabel, 'titleBar').text()


def titles():
    return [title_of(dialog) for dialog in dialogs()]
