"""A real display, in front of a user who has nothing but keys and a mouse."""

import collections
import re
import subprocess
import threading
import time

from displays import read_scene
from scripts import environment

PATIENCE = 30  # seconds

# What stands in the frame and below the title, in pixels from the left and the top of the screen.
Window = collections.namedtuple('Window', 'identity left top width height')


class Desk:
    """The keyboard and the mouse of an X display, and what stands on it."""

    def __init__(self, keyboard, **display):
        self._keyboard = environment(DISPLAY=keyboard)
        self._environment = environment(**display)
        self._programs = []

    def start(self, *command, **options):
        process = subprocess.Popen(command, env=self._environment, text=True, stdout=subprocess.PIPE, **options)
        limit = threading.Timer(PATIENCE, process.kill)
        limit.start()
        self._programs.append((process, limit))
        return process

    def run(self, *arguments):
        done = subprocess.run(['xdotool', *map(str, arguments)], env=self._keyboard, capture_output=True, text=True,
                              timeout=PATIENCE)
        return done.stdout.split()

    def wait_for_window(self, title):
        """Waits until a window of that title has the keyboard."""
        return self._wait(title, lambda found: found and self._has_keyboard(found))

    def find_window(self, title):
        """The same where another window may have the keyboard."""
        return self._wait(title, lambda found: found)

    def wait_until_gone(self, title):
        self._wait(title, lambda found: not found)

    def _wait(self, title, condition):
        end = time.monotonic() + PATIENCE
        while time.monotonic() < end:
            found = self._find(title)
            if condition(found):
                return found
            time.sleep(0.02)
        raise AssertionError('the window "%s" does not come, or go, or get the keyboard' % title)

    def _find(self, title):
        found = dict(line.split('=') for line in self.run('search', '--onlyvisible', '--name', '^%s$' % title,
                                                          'getwindowgeometry', '--shell'))
        return found and Window(found['WINDOW'], *(int(found[name]) for name in ('X', 'Y', 'WIDTH', 'HEIGHT')))

    def _has_keyboard(self, window):
        return self.run('getwindowfocus', '-f') == [window.identity]

    def click(self, x, y):
        self.run('mousemove', x, y, 'click', 1)

    def click_in(self, window, x, from_bottom):
        self.click(window.left + x, window.top + window.height - from_bottom)

    def drag(self, start, end, steps=8):
        """Pulls what is at a place to another one, with the mouse button down all the way."""
        self.run('mousemove', *start, 'mousedown', 1)
        for step in range(1, steps + 1):
            self.run('mousemove', *(a + (b - a) * step // steps for a, b in zip(start, end)))
        self.run('mouseup', 1)

    def close(self):
        for process, limit in self._programs:
            limit.cancel()
            process.kill()
            process.wait()
            process.stdout.close()


class WaylandDesk(Desk):
    """The same on a Wayland display. The compositor tells where windows stand, with the frames that Qt draws."""

    _VIEW = re.compile(r"role xdg_toplevel, .* window '(.*)' of .*\n.*position: \((.*), (.*)\) -> \((.*), (.*)\)")
    _FRAME, _TITLE = 3, 30

    def _look(self):
        """All windows, the uppermost first, once all are drawn: the mouse does not meet them before."""
        while 'repaint status: no repaint' not in (scene := read_scene(self._environment['WAYLAND_DISPLAY'])):
            assert scene, 'the compositor is gone'
        for title, *corners in self._VIEW.findall(scene):
            left, top, right, bottom = map(int, corners)
            yield Window(title, left + self._FRAME, top + self._TITLE, right - left - 2 * self._FRAME,
                         bottom - top - self._TITLE - self._FRAME)

    def _find(self, title):
        return next((window for window in self._look() if window.identity == title), None)

    def _has_keyboard(self, window):
        return window == next(self._look(), None)

    def close_by_title(self, window):
        self.click(window.left + window.width - 14, window.top - self._TITLE // 2)
