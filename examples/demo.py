"""The awards form: on the screen if there is one; without one, filled in by a person of C{quorvane_velmora.testing}."""

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
    from quorvane_velmora import testing

    folder = os.path.join(os.getcwd(), 'build', 'demo')
    os.makedirs(folder, mode=0o700, exist_ok=True)
    os.environ.setdefault('XDG_RUNTIME_DIR', folder)
    pictures = [os.path.join(folder, name) for name in ('awards.png', 'outcome.png')]
    print('There is no display: the form is filled in offscreen.')
    with testing.person() as person:
        person.answer('Awards', {'Show': 'Golden Reel Awards', 'Category': 'Music', 'Speech': 'Thank you, all of you.'},
                      'OK', do=lambda person: person.picture(pictures[0]))
        person.answer('Awards', says='You win', press='OK', do=lambda person: person.picture(pictures[1]))
        runpy.run_path(AWARDS, run_name='__main__')
    for picture in pictures:
        print('Picture: ' + picture)


if has_display():
    runpy.run_path(AWARDS, run_name='__main__')
else:
    play()
