"""A real display, in front of a user who has nothing but keys and a mouse."""

import subprocess
import threading
import time

from scripts import environment

PATIENCE = 30  # seconds


class Desk:
    """The keyboard and the mouse of a display, and what stands on it."""

    def __init__(self, display):
        self._environment = environment(DISPLAY=display)
        self._programs = []

    def start(self, *command, **options):
        process = subprocess.Popen(command, env=self._environment, text=True, stdout=subprocess.PIPE, **options)
        limit = threading.Timer(PATIENCE, process.kill)
        limit.start()
        self._programs.append((process, limit))
        return process

    def run(self, *arguments):
        done = subprocess.run(['xdotool', *map(str, arguments)], env=self._environment, capture_output=True, text=True,
                              timeout=PATIENCE)
        return done.stdout.split()

    def wait_for_window(self, title):
        """Waits until a window of that title has the keyboard, and gives its identity."""
        return self._wait(title, lambda found: found and found == self.run('getwindowfocus', '-f'))[0]

    def find_window(self, title):
        """The same where another window may have the keyboard."""
        return self._wait(title, lambda found: found)[0]

    def wait_until_gone(self, title):
        self._wait(title, lambda found: not found)

    def _wait(self, title, condition):
        end = time.monotonic() + PATIENCE
        while time.monotonic() < end:
            found = self.run('search', '--onlyvisible', '--name', '^%s$' % title)
            if condition(found):
                return found
            time.sleep(0.02)
        raise AssertionError('the window "%s" does not come, or go, or get the keyboard' % title)

    def click(self, x, y):
        self.run('mousemove', x, y, 'click', 1)

    def click_in(self, window, x, from_bottom):
        geometry = dict(line.split('=') for line in self.run('getwindowgeometry', '--shell', window))
        self.click(int(geometry['X']) + x, int(geometry['Y']) + int(geometry['HEIGHT']) - from_bottom)

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
