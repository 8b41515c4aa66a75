"""The same form made and used with the module and with PyQt6.

A form has C{n} rows, a text, a toggle and a menu of five entries in turn, each with a caption, and one button. Each side
is written as its users write: PyQt6 keeps its widgets in a dict, but looks one up by its name where the module does.
"""

from PyQt6.QtCore import QEvent, QObject, QTimer, Qt
from PyQt6.QtWidgets import (QApplication, QCheckBox, QComboBox, QDialog, QFormLayout, QLineEdit, QPushButton,
                             QScrollArea, QVBoxLayout, QWidget)

from quorvane_velmora import ui

ENTRIES = ['one', 'two', 'three', 'four', 'five']
TITLE = 'Form'
WIDTH = 400

application = QApplication.instance() or QApplication([])


def rows(count):
    """The widget list of the form."""
    kinds = [('TextField', 'text'), ('ToggleButton', True), ('Menu', (ENTRIES, 1))]
    return [(kind, 'w%d' % i, 'Row %d' % i, state) for i in range(count) for kind, state in [kinds[i % 3]]]


def start_values(count):
    return {'w%d' % i: ('text', True, 'two')[i % 3] for i in range(count)}


def other_values(count):
    """What a writing of all values leaves."""
    return {'w%d' % i: ('other', False, 'four')[i % 3] for i in range(count)}


class Presser(QObject):
    """Presses the button of a dialog of Qt once its first row has been painted."""

    def __init__(self, find_dialog, button):
        super().__init__()
        self.find_dialog = find_dialog
        self.name = button
        QTimer.singleShot(0, self.wait)

    def wait(self):
        dialog = self.find_dialog()
        self.button = dialog.findChild(QPushButton, self.name)
        first = dialog.findChild(QLineEdit, 'w0')
        first.installEventFilter(self)
        first.update()

    def eventFilter(self, first, event):
        if event.type() == QEvent.Type.Paint:
            first.removeEventFilter(self)
            QTimer.singleShot(0, self.button.click)
        return False


def flush():
    """Lets Qt do what it has put off, so that neither side pays for the other."""
    application.sendPostedEvents()
    application.sendPostedEvents(None, QEvent.Type.DeferredDelete.value)
    application.processEvents()


class Ours:
    name = 'ours'

    def prepare(self, count):
        self.values = {'w%d' % i: ('other', False, ([], 3))[i % 3] for i in range(count)}
        self.rows = rows(count)

    def build(self, count):
        xml = ui.makeXmlFromWidgetList(self.rows)
        return ui.createDialog(TITLE, xml, WIDTH, 28 * count + 56)

    def launch(self, dialog):
        presser = Presser(QApplication.activeModalWidget, 'CloseButton_OK')
        assert dialog.launch() == 'CloseButton_OK'
        return presser

    def read(self, dialog):
        return dialog.getValues()

    def write(self, dialog):
        dialog.setValues(self.values, False)

    def listen(self, dialog, name, call):
        dialog.addCallback(name, ui.EventType.VALUE_CHANGED, call)

    def set(self, dialog, name, text):
        dialog.setValue(name, text)


class PyQt:
    name = 'PyQt6'

    def __init__(self, scrolls=True):
        self.scrolls = scrolls

    def prepare(self, count):
        self.values = {'w%d' % i: ('other', False, 3)[i % 3] for i in range(count)}

    def build(self, count):
        dialog = QDialog()
        dialog.setWindowTitle(TITLE)
        dialog.resize(WIDTH, min(28 * count + 56, 700) if self.scrolls else 28 * count + 56)
        form = QFormLayout()
        dialog.widgets = {}
        for i in range(count):
            if i % 3 == 0:
                widget = QLineEdit('text')
            elif i % 3 == 1:
                widget = QCheckBox()
                widget.setChecked(True)
            else:
                widget = QComboBox()
                widget.addItems(ENTRIES)
                widget.setCurrentIndex(1)
            name = 'w%d' % i
            widget.setObjectName(name)
            dialog.widgets[name] = widget
            form.addRow('Row %d' % i, widget)
        column = QVBoxLayout(dialog)
        # A form that is higher than the screen has to scroll.
        if self.scrolls and count > 20:
            page = QWidget()
            page.setLayout(form)
            area = QScrollArea()
            area.setWidgetResizable(True)
            area.setWidget(page)
            column.addWidget(area)
        else:
            column.addLayout(form)
        button = QPushButton('OK', objectName='OK')
        button.clicked.connect(dialog.accept)
        column.addWidget(button)
        return dialog

    def launch(self, dialog):
        presser = Presser(lambda: dialog, 'OK')
        assert dialog.exec() == QDialog.DialogCode.Accepted
        return presser

    def read(self, dialog):
        values = {}
        for name, widget in dialog.widgets.items():
            if isinstance(widget, QLineEdit):
                values[name] = widget.text()
            elif isinstance(widget, QCheckBox):
                values[name] = widget.isChecked()
            else:
                values[name] = widget.currentText()
        return values

    def write(self, dialog):
        for name, value in self.values.items():
            widget = dialog.widgets[name]
            if isinstance(widget, QLineEdit):
                widget.setText(value)
            elif isinstance(widget, QCheckBox):
                widget.setChecked(value)
            else:
                widget.setCurrentIndex(value)

    def listen(self, dialog, name, call):
        dialog.findChild(QLineEdit, name).textChanged.connect(call)

    def set(self, dialog, name, text):
        dialog.findChild(QLineEdit, name).setText(text)
