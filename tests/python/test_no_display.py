"""Scripts where there is no display: everything works but showing a window, which fails with words."""

import pytest

import displays
from scripts import run_script

pytestmark = pytest.mark.standalone

SCRIPT = '''
import re
from quorvane_velmora import ui
xml = ui.makeXmlFromWidgetList([('PushButton', 'A name to be measured'), ('TextField', 'a', 'A', 'x'),
                                ('Menu', 'm', '', (['one', 'two'], 0))])
narrow, wide = (int(re.search(r'X2 Value="(\\d+)" Type="uu" Target="w"', text).group(1))
                for text in (ui.makeXmlFromWidgetList([('PushButton', 'i')]), xml))
assert 4 < narrow < wide
dialog = ui.createDialog('t', xml, -1, -1, {'a': 'y'})
dialog.setValue('m', (['three'], 0))
dialog.hideWidget('a')
assert dialog.getValues() == {'a': 'y', 'm': 'three'}
for show in dialog.launch, lambda: ui.showSimpleDialog('t', [], 300), lambda: ui.showMessageBox('t', ['text']):
    try:
        show()
    except RuntimeError as error:
        print(error)
    else:
        raise SystemExit('shown')
assert dialog.getValues() == {'a': 'y', 'm': 'three'}
'''
REMEDY = ['there is no display', 'set DISPLAY or WAYLAND_DISPLAY', 'QT_QPA_PLATFORM=offscreen']

# A socket that somebody has in the current directory, and at which no compositor answers.
SOCKET = '''
import os, socket, tempfile
folder = tempfile.TemporaryDirectory()
os.chdir(folder.name)
listening = socket.socket(socket.AF_UNIX)
listening.bind('wayland-0')
listening.listen()
'''
WAYLAND = {'QT_QPA_PLATFORM': 'wayland'}


@pytest.mark.parametrize('preamble, settings, words', [
    ('', {}, ['DISPLAY is not set', *REMEDY]),
    ('', {'DISPLAY': ''}, ['DISPLAY is not set', *REMEDY]),
    ('', {'DISPLAY': ':9876'}, ['DISPLAY ":9876" cannot be opened', *REMEDY]),
    ('', {'DISPLAY': 'nonsense'}, ['DISPLAY "nonsense" cannot be opened', *REMEDY]),
    ('', {'WAYLAND_DISPLAY': 'wayland-none'}, REMEDY),
    ('', {'WAYLAND_SOCKET': '9876', **WAYLAND}, ['WAYLAND_SOCKET is "9876", which is no connection', *REMEDY]),
    ('', {'WAYLAND_SOCKET': '', **WAYLAND}, ['WAYLAND_SOCKET is ""', *REMEDY]),
    (SOCKET, {'XDG_RUNTIME_DIR': '.', **WAYLAND}, ['display "wayland-0" cannot be opened', *REMEDY]),
    (SOCKET + 'os.environ["XDG_RUNTIME_DIR"] = folder.name', WAYLAND, ['"wayland-0" cannot be opened', *REMEDY]),
    ('', {'QT_QPA_PLATFORM': 'xcb'}, ['QT_QPA_PLATFORM is "xcb"', 'DISPLAY is not set', *REMEDY]),
    ('', {'QT_QPA_PLATFORM': 'xcb', 'DISPLAY': ':9876'}, ['DISPLAY ":9876" cannot be opened', *REMEDY]),
    ('', {'QT_QPA_PLATFORM': 'nonsense'}, ['there is no platform "nonsense"', *REMEDY]),
    ('', {'QT_QPA_PLATFORM': ';'}, ['QT_QPA_PLATFORM is ";"', *REMEDY]),
    ('from PyQt6.QtCore import QCoreApplication; application = QCoreApplication([])', {},
     ['there is a QCoreApplication that is no QApplication', 'create a QApplication']),
    ('from PyQt6.QtCore import QCoreApplication; application = QCoreApplication([])', {'QT_QPA_PLATFORM': 'offscreen'},
     ['there is a QCoreApplication that is no QApplication', 'create a QApplication']),
])
def test_without_a_display_only_showing_a_window_fails_and_says_what_to_do(preamble, settings, words):
    said = run_script(preamble + SCRIPT, **settings).splitlines()
    assert len(said) == 3 and len(set(said)) == 1
    for word in words:
        assert word in said[0]


def test_a_platform_that_needs_no_display_is_used_as_it_was_asked_for():
    run_script('''
from quorvane_velmora import ui
from PyQt6.QtCore import QTimer
from PyQt6.QtWidgets import QApplication, QPushButton
ui.makeXmlFromWidgetList([('PushButton', 'application')])
assert QApplication.platformName() == 'offscreen'
QTimer.singleShot(0, lambda: QApplication.activeModalWidget().findChild(QPushButton).click())
assert ui.showMessageBox('t', ['text']) == 'OK'
''', QT_QPA_PLATFORM='nonsense;xcb;offscreen')


def test_on_a_display_without_a_screen_for_now_dialogs_have_their_size_and_take_answers():
    with displays.wayland_without_screens() as socket:
        run_script('''
from quorvane_velmora import testing, ui
from PyQt6.QtWidgets import QApplication
def look(person):
    window = QApplication.activeModalWidget()
    assert (window.width(), window.height()) == (300, 224)
with testing.person() as person:
    person.answer('t', {'A': 'x'}, 'OK', do=look)
    dialog = ui.createDialog('t', ui.makeXmlFromWidgetList([('TextField', 'a', 'A')]), 300, 200)
    assert dialog.launch() == 'CloseButton_OK' and dialog.getValue('a') == 'x'
''', WAYLAND_DISPLAY=socket)
