"""Scripts in processes of their own."""

import os
import pathlib
import subprocess
import sys
import tempfile

import pytest
from quorvane_velmora import ui


def has_pyqt():
    try:
        import PyQt6.QtWidgets  # noqa: F401
    except ImportError:
        return False
    return True


PROGRAM = os.readlink('/proc/self/exe')
INSIDE = os.path.basename(PROGRAM) == 'velmora'
# The tree that the tests run in: the build's, with `bin` and `lib`.
TREE = pathlib.Path(ui.__file__).parents[5]
HERE = os.path.dirname(os.path.abspath(__file__))
HAS_PYQT = has_pyqt()
needs_pyqt = pytest.mark.skipif(not HAS_PYQT, reason='needs PyQt6')
# The Debian package and the type checker are for its interpreter.
distribution = pytest.mark.skipif(os.path.realpath(sys.executable) != os.path.realpath('/usr/bin/python3'),
                                  reason='for the interpreter of the distribution')
# For processes at whose end the search for leaks fails itself, whatever they have done: some that showed a window.
NO_SEARCH_FOR_LEAKS = {'ASAN_OPTIONS': os.environ.get('ASAN_OPTIONS', '') + ':detect_leaks=0'}
CHOOSES_DISPLAY = ('DISPLAY', 'QT_QPA_PLATFORM', 'WAYLAND_DISPLAY', 'WAYLAND_SOCKET', 'XDG_SESSION_TYPE')


def environment(**changes):
    """This process's environment without what chooses a display, but with `changes`, and the tests' own modules. The
    application remembers nothing in it."""
    result = {name: value for name, value in os.environ.items() if name not in CHOOSES_DISPLAY}
    result['XDG_CONFIG_HOME'] = result['XDG_STATE_HOME'] = '/dev/null'
    result['PYTHONPATH'] = os.pathsep.join([HERE, result.get('PYTHONPATH', '')])
    return {**result, **changes}


def run_script(text, *arguments, **changes):
    """Runs a script to its end, which must be a good one, and gives what it printed. The tests of the application run
    it in an application of its own."""
    if INSIDE and not changes.keys() & set(CHOOSES_DISPLAY):
        changes['QT_QPA_PLATFORM'] = 'offscreen'
    with tempfile.NamedTemporaryFile('w', suffix='.py') as file:
        file.write(text)
        file.flush()
        command = [PROGRAM, '--exit', file.name] if INSIDE else [sys.executable, '-c', text]
        done = subprocess.run([*command, *arguments], env=environment(**changes), capture_output=True, text=True,
                              timeout=300)
    if not HAS_PYQT and "No module named 'PyQt6" in done.stderr:
        pytest.skip('needs PyQt6')
    assert done.returncode == 0, 'status %d\n%s%s' % (done.returncode, done.stdout, done.stderr)
    return done.stdout
