"""Displays that nobody else uses: that of an X server without a window manager, and that of a Wayland compositor in a
window that fills it, so that the keys and the mouse of the one are those of the other.

    displays.py xcb|wayland COMMAND...    runs the command on one of them
"""

import contextlib
import os
import subprocess
import sys
import tempfile
import time

SIZE = 1280, 1024
# Below the window of the compositor.
MARGIN = 24
PATIENCE = 30  # seconds
# A server ends with this process, however that ends.
TOGETHER = 'setpriv', '--pdeathsig', 'KILL'
# Nothing moves, covers the screen or lies on it but the windows.
SETTINGS = '''
[core]
idle-time=0
[shell]
panel-position=none
locking=false
animation=none
startup-animation=none
close-animation=none
focus-animation=none
[input-method]
path=
'''


@contextlib.contextmanager
def running(command, **options):
    # What is loaded ahead of the tests' interpreter is not for the servers.
    environment = {name: value for name, value in os.environ.items() if name != 'LD_PRELOAD'}
    environment.update(options.pop('env', {}))
    process = subprocess.Popen([*TOGETHER, *command], env=environment, stdout=subprocess.DEVNULL, **options)
    try:
        yield process
    finally:
        process.terminate()
        process.wait()


@contextlib.contextmanager
def x_display():
    """Its name."""
    reading, writing = os.pipe()
    # Without the last option it starts anew, deaf for a moment, each time that its only client goes.
    command = ['Xvfb', '-displayfd', str(writing), '-screen', '0', '%dx%dx24' % SIZE, '-noreset']
    with os.fdopen(reading) as answer, running(command, pass_fds=[writing], stderr=subprocess.DEVNULL):
        os.close(writing)
        number = answer.readline().strip()
        assert number, 'the X server does not start'
        yield ':' + number


def read_scene(socket):
    """What stands on that Wayland display, the uppermost first."""
    return subprocess.run(['weston-debug', 'scene-graph'], env={**os.environ, 'WAYLAND_DISPLAY': socket}, text=True,
                          stdout=subprocess.PIPE, stderr=subprocess.DEVNULL, timeout=PATIENCE).stdout


@contextlib.contextmanager
def wayland_compositor(ready, backend, *options, **variables):
    """The path of its socket, once its scene has those words."""
    with tempfile.TemporaryDirectory() as folder:
        socket, settings, log = (os.path.join(folder, name) for name in ('socket', 'settings', 'log'))
        with open(settings, 'w') as file:
            file.write(SETTINGS)
        command = ['weston', '--backend=%s-backend.so' % backend, '--use-pixman', '--debug', '--socket=socket',
                   '--config=' + settings, '--log=' + log, *options]
        with running(command, env={'XDG_RUNTIME_DIR': folder, **variables}, stderr=subprocess.STDOUT) as server:
            end = time.monotonic() + PATIENCE
            while ready not in read_scene(socket):
                if server.poll() is not None or time.monotonic() > end:
                    with open(log) as file:
                        raise AssertionError('the Wayland compositor does not start:\n' + file.read())
                time.sleep(0.02)
            yield socket


@contextlib.contextmanager
def wayland_display(display):
    """The path of its socket. It stands on that X display."""
    size = ['--width=%d' % SIZE[0], '--height=%d' % (SIZE[1] - MARGIN)]
    with wayland_compositor('background', 'x11', *size, DISPLAY=display) as socket:
        # The compositor may lose the first move, and learns where the mouse is whenever that comes into its window.
        below = 'mousemove', '0', str(SIZE[1] - 1)
        subprocess.run(['xdotool', *below, 'mousemove', '0', '0', 'mousemove', '9', '9', *below, 'mousemove', '0', '0'],
                       env={**os.environ, 'DISPLAY': display}, check=True)
        yield socket


def wayland_without_screens():
    """The path of its socket."""
    return wayland_compositor('scene', 'headless', '--no-outputs')


@contextlib.contextmanager
def display(platform):
    """What a program finds its way there by, in its environment."""
    with x_display() as name:
        if platform == 'xcb':
            yield {'DISPLAY': name}
        else:
            with wayland_display(name) as socket:
                yield {'WAYLAND_DISPLAY': socket}


if __name__ == '__main__':
    with display(sys.argv[1]) as variables:
        sys.exit(subprocess.call(sys.argv[2:], env={**os.environ, **variables}))
