"""Scripts in processes of their own."""

import os
import subprocess
import sys

HERE = os.path.dirname(os.path.abspath(__file__))
CHOOSES_DISPLAY = ('DISPLAY', 'QT_QPA_PLATFORM', 'WAYLAND_DISPLAY', 'WAYLAND_SOCKET', 'XDG_SESSION_TYPE')


def environment(**changes):
    """This process's environment without what chooses a display, but with `changes`, and the tests' own modules."""
    result = {name: value for name, value in os.environ.items() if name not in CHOOSES_DISPLAY}
    result['PYTHONPATH'] = os.pathsep.join([HERE, result.get('PYTHONPATH', '')])
    return {**result, **changes}


def run_script(text, *arguments, **changes):
    """Runs a script to its end, which must be a good one, and gives what it printed."""
    done = subprocess.run([sys.executable, '-c', text, *arguments], env=environment(**changes), capture_output=True,
                          text=True, timeout=300)
    assert done.returncode == 0, 'status %d\n%s%s' % (done.returncode, done.stdout, done.stderr)
    return done.stdout
