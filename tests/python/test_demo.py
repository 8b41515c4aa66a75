"""What a newcomer starts first."""

import os
import pathlib
import subprocess
import sys

import pytest

pytestmark = pytest.mark.standalone

EXAMPLES = pathlib.Path(__file__).parents[2] / 'examples'


def test_the_demo_plays_itself_where_there_is_no_display_and_leaves_pictures(tmp_path):
    environment = {name: value for name, value in os.environ.items() if name not in ('DISPLAY', 'WAYLAND_DISPLAY')}
    del environment['QT_QPA_PLATFORM']
    done = subprocess.run([sys.executable, str(EXAMPLES / 'demo.py')], env=environment, cwd=tmp_path,
                          capture_output=True, text=True, timeout=60)
    assert done.returncode == 0, done.stderr
    lines = done.stdout.splitlines()
    assert "Show: 'Golden Reel Awards'" in lines and "Category: 'Music'" in lines
    pictures = [pathlib.Path(line.split(': ', 1)[1]) for line in lines if line.startswith('Picture: ')]
    assert len(pictures) == 2 and all(picture.stat().st_size > 1000 for picture in pictures)
