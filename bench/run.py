"""Measures the module against itself: how cost grows with the size of a dialog. Ratios within one run are what counts."""

import os
import subprocess
import sys
import time

os.environ.setdefault('QT_QPA_PLATFORM', 'offscreen')

from quorvane_velmora import ui

ROUNDS = 5


def rows(count):
    kinds = [('TextField', 'text'), ('ToggleButton', True), ('Menu', (['a', 'b', 'c'], 1)), ('Label', 'text')]
    return [(kinds[i % 4][0], 'w%d' % i, 'Row %d' % i, kinds[i % 4][1]) for i in range(count)]


def best(action):
    def once():
        start = time.perf_counter()
        action()
        return time.perf_counter() - start
    return min(once() for _ in range(ROUNDS))


def show(xml):
    """Shows a dialog and ends it at once, as its only button is pressed by Escape."""
    from PyQt6.QtCore import QTimer, Qt
    from PyQt6.QtTest import QTest
    from PyQt6.QtWidgets import QApplication
    dialog = ui.createDialog('bench', xml, 400, 400)
    QTimer.singleShot(0, lambda: QTest.keyClick(QApplication.activeModalWidget(), Qt.Key.Key_Escape))
    dialog.launch()


def measure(count):
    widgets = rows(count)
    xml = ui.makeXmlFromWidgetList(widgets)
    dialog = ui.createDialog('bench', xml, 400, 400)
    values = {name: value for kind, name, _, value in widgets if kind == 'TextField'}
    return {
        'describe': best(lambda: ui.makeXmlFromWidgetList(widgets)),
        'build': best(lambda: ui.createDialog('bench', xml, 400, 400)),
        'read all': best(dialog.getValues),
        'write all': best(lambda: dialog.setValues(values)),
        'find each': best(lambda: [dialog.isEnabled(entry[1]) for entry in widgets]),
        'show': best(lambda: show(xml)),
    }


def measure_import():
    command = [sys.executable, '-c', 'from quorvane_velmora import ui']
    bare = [sys.executable, '-c', 'pass']
    return best(lambda: subprocess.run(command, check=True)) - best(lambda: subprocess.run(bare, check=True))


small, large = 200, 2000
few, many = measure(small), measure(large)
print('%-10s %10s %10s %14s' % ('', '%d rows' % small, '%d rows' % large, 'growth (10: linear)'))
for name in few:
    print('%-10s %7.2f ms %7.2f ms %11.1f' % (name, few[name] * 1e3, many[name] * 1e3, many[name] / few[name]))
print('import     %7.2f ms' % (measure_import() * 1e3))
