"""A thousand dialogs in one process leave nothing behind."""

from scripts import run_script

SCRIPT = '''
import gc, os, subprocess
from quorvane_velmora import ui
from PyQt6.QtCore import QEvent, QTimer
from PyQt6.QtGui import QPixmapCache
from PyQt6.QtWidgets import QApplication, QPushButton
import stage

FORM = [('TextField', 'a', 'A', 'text'), ('ToggleButton', 'b', 'B', True), ('Menu', 'c', 'C', (['x', 'y'], 1)),
        ('PushButton', 'd', 'D'), ('Label', 'e', 'E', 'text')]

def close():
    window = stage.active()
    if window is not None:
        window.findChild(QPushButton, 'CloseButton_OK').click()

def show(times):
    for turn in range(times):
        assert ui.showSimpleDialog('Dialog %d' % turn, FORM, 300, True)['CloseButtonClicked'] == 'CloseButton_OK'

def take_stock():
    gc.collect()
    # What Qt lets go when the loop comes around that the application itself runs in.
    QApplication.sendPostedEvents(None, QEvent.Type.DeferredDelete.value)
    windows = 0
    if QApplication.platformName() == 'xcb':
        QApplication.processEvents()
        search = ['xdotool', 'search', '--name', '']
        windows = len(subprocess.run(search, capture_output=True, check=True).stdout.split())
    with open('/proc/self/statm') as statm:
        resident = int(statm.read().split()[1]) * os.sysconf('SC_PAGE_SIZE')
    return len(QApplication.allWidgets()), windows, resident

ui.makeXmlFromWidgetList([('PushButton', 'application')])
QPixmapCache.setCacheLimit(0)  # it grows up to a bound of its own
timer = QTimer()
timer.timeout.connect(close)
timer.start(0)
show(1)
before = take_stock()
show(199)
early = take_stock()
show(800)
late = take_stock()
print(before, early, late)
assert before[:2] == early[:2] == late[:2]
with open('/proc/self/maps') as maps:
    keeps_what_was_freed = 'libasan' in maps.read()
assert late[2] - early[2] <= 1 << 20 or keeps_what_was_freed
'''


def test_a_thousand_dialogs_leave_no_widgets_and_no_memory():
    run_script(SCRIPT, QT_QPA_PLATFORM='offscreen')


def test_a_thousand_dialogs_on_a_display_leave_no_windows_either(display):
    run_script(SCRIPT, **display)
