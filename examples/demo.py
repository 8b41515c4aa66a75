"""The awards form: on the screen if there is one; without one, filled in by a player that saves pictures."""

import ctypes
import os
import runpy
import socket
import sys

HERE = os.path.dirname(os.path.abspath(__file__))
AWARDS = os.path.join(HERE, 'awards.py')


def answers_wayland():
    name = os.environ.get('WAYLAND_DISPLAY')
    if not name:
        return False
    with socket.socket(socket.AF_UNIX) as wayland:
        return not wayland.connect_ex(os.path.join(os.environ.get('XDG_RUNTIME_DIR', ''), name))


def has_display():
    if os.environ.get('QT_QPA_PLATFORM'):
        return os.environ['QT_QPA_PLATFORM'].split(':')[0] not in ('offscreen', 'minimal')
    if answers_wayland():
        return True
    xcb = ctypes.CDLL('libxcb.so.1')
    xcb.xcb_connect.restype = ctypes.c_void_p
    connection = ctypes.c_void_p(xcb.xcb_connect(None, None))
    works = not xcb.xcb_connection_has_error(connection)
    xcb.xcb_disconnect(connection)
    return works


def play():
    """Fills in the form as a person would, and reads the message box that follows."""
    os.environ['QT_QPA_PLATFORM'] = 'offscreen'
    from PyQt6.QtCore import Qt

    from player import Player

    folder = os.path.join(os.getcwd(), 'build', 'demo')
    os.makedirs(folder, mode=0o700, exist_ok=True)
    os.environ.setdefault('XDG_RUNTIME_DIR', folder)
    player = Player(folder, [
        [
            lambda person: person.type('Golden Reel Awards'),
            lambda person: person.tab(),
            lambda person: person.press(Qt.Key.Key_Space),
            lambda person: person.press(Qt.Key.Key_Space),
            lambda person: person.tab(),
            lambda person: person.press(Qt.Key.Key_Down),
            lambda person: person.tab(),
            lambda person: person.type('Thank you, all of you.'),
            lambda person: person.click('CloseButton_OK'),
        ],
        [lambda person: person.click('CloseButton_OK')],
    ])
    print('There is no display: a player fills in the form offscreen.')
    player.run(AWARDS)
    for picture in player.pictures:
        print('Picture: ' + picture)
    sys.exit(0 if len(player.pictures) == 2 else 'The player saw %d of 2 dialogs.' % len(player.pictures))


if has_display():
    runpy.run_path(AWARDS, run_name='__main__')
else:
    play()
