"""The examples do what their pages say."""

import os
import pathlib
import runpy
import subprocess
import sys

from callback_tools import no_wait_is_endless, patient  # noqa: F401

EXAMPLES = pathlib.Path(__file__).parents[2] / 'examples'


def run(name):
    runpy.run_path(str(EXAMPLES / name), run_name='__main__')


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


def test_a_vote_needs_the_box_and_a_name(patient, capsys):
    patient.plan(lambda user: user.click('CloseButton_Send'), lambda user: user.click('Vote'),
                 lambda user: user.click('CloseButton_Send'), lambda user: user.close(),
                 lambda user: user.click('Name'), lambda user: user.type('Ada'),
                 lambda user: user.click('CloseButton_Send'))
    run('votes.py')
    assert capsys.readouterr().out == 'Ada votes for The Long Take.\n'


def test_a_review_is_sent_with_its_note(patient, capsys):
    patient.plan(lambda user: user.type('Too dark'), lambda user: user.click('Urgent'),
                 lambda user: user.click('CloseButton_Send'))
    run('review.py')
    assert capsys.readouterr().out == 'Retake: Too dark\n'
