"""Tests of the examples, as the author of a script would write them.

    python3 -m pytest test_examples.py

Where C{VELMORA_PICTURES} names a folder, a picture of each example is saved there.
"""

import json
import os
import pathlib
import runpy
import sys

import pytest

from quorvane_velmora import ui

EXAMPLES = pathlib.Path(__file__).parent
PICTURES = os.environ.get('VELMORA_PICTURES')


@pytest.fixture
def run(capsys, monkeypatch):
    """Runs an example and gives what it printed."""
    def run(name, *arguments):
        monkeypatch.setattr(sys, 'argv', [name, *map(str, arguments)])
        runpy.run_path(str(EXAMPLES / name), run_name='__main__')
        return capsys.readouterr().out
    return run


@pytest.fixture
def look(request):
    """To be done at the dialog that stands for the example."""
    def look(person):
        assert person.see()
        if PICTURES:
            person.picture(os.path.join(PICTURES, request.node.name[len('test_'):] + '.png'))
    return look


def isInside():
    try:
        ui.Workspace.getNbCompositions()
    except ui.UiError:
        return False
    return True


def test_awards(person, run, look):
    person.answer('Awards', {'Do you win ?': False, 'Category': 'Sound', 'Speech': 'Thank you.'}, 'OK', do=look)
    person.answer('Awards', says='You do not win in the category Sound.', press='OK')
    assert "Show: 'Academy Awards'\n" in run('awards.py')


def test_votes(person, run, look):
    person.answer('Votes', {'Do you vote ?': True}, 'Send')
    person.answer('Votes', says='Please give your name', press='OK')
    person.answer('Votes', {'Your name': 'Ada', 'Best film': 'Magic Hour'}, 'Send', do=look)
    assert run('votes.py') == 'Ada votes for Magic Hour.\n'


def test_review(person, run, look):
    person.answer('Review sh_010', {'Note': 'Too dark', 'Urgent': True}, 'Send', do=look)
    person.answer('Review sh_020', {'Note': 'Fine', 'Verdict': 'Approved', 'Urgent': False}, 'Send')
    assert run('review.py') == 'sh_010: Retake: Too dark, urgent\nsh_020: Approved: Fine\n'


def test_publish(person, run, look):
    person.answer('Publish', {'Shot': 'sh_1', 'Step': 'Lighting'}, 'Publish')
    person.answer('Publish', says='must look like', press='OK')
    person.answer('Publish', {'Shot': 'sh_010', 'What is new': 'Warmer key light'}, 'Publish', do=look)
    assert run('publish.py') == 'sh_010, Lighting: Warmer key light (for review)\n'


def test_rename(person, run, look, tmp_path):
    files = ['Plate_v1.exr', 'mask_v1.exr', 'notes.txt', 'v1', 'v2']
    for name in files:
        (tmp_path / name).touch()
    person.answer('Rename', {'Find': 'v1', 'Replace by': 'v2\n'}, 'Rename')
    person.answer('Rename', says='More than one file would be called v2.', press='OK')
    person.answer('Rename', {'Find': '_v1', 'Letters': 'Lower'}, 'Rename', do=look)
    run('rename.py', tmp_path)
    assert sorted(os.listdir(tmp_path)) == ['maskv2.exr', 'notes.txt', 'platev2.exr', 'v1', 'v2']


def test_rename_without_a_change(person, run, tmp_path):
    (tmp_path / 'a').touch()
    person.answer('Rename', do=lambda person: person.see().index('[Rename] (disabled)'), press='Cancel')
    run('rename.py', tmp_path)


def test_submit(person, run, look):
    person.answer('Render', {'Last frame': 'many'}, 'OK')
    person.answer('Render', says='whole numbers', press='OK')
    person.answer('Render', {'Last frame': '1000'}, 'OK')
    person.answer('Render', says='comes before', press='OK')
    person.answer('Render', {'Last frame': '1024', 'Machines': 'night'}, 'OK', do=look)
    person.answer('Render', says='24 frames in 3 tasks, on night machines.', press='Back')
    person.answer('Render', {'Wait until released': True}, 'OK')
    person.answer('Render', says='It waits', press='Submit')
    assert json.loads(run('submit.py')) == {'First': 1001, 'Last': 1024, 'Size': 10, 'Pool': 'night', 'Hold': True}


def test_settings(person, run, look, tmp_path, monkeypatch):
    monkeypatch.setenv('XDG_CONFIG_HOME', str(tmp_path / 'config'))
    person.answer('Settings', {'Shots are in': '/mnt/shots', 'Working space': 'ACEScg'}, 'OK', do=look)
    run('settings.py')
    seen = []
    person.answer('Settings', do=lambda person: seen.append(person.see()), press='Cancel')
    run('settings.py')
    assert 'Shots are in: "/mnt/shots"' in seen[0] and 'Working space: "ACEScg"' in seen[0]
    next((tmp_path / 'config').iterdir()).write_text('{')
    person.answer('Settings', says='start anew', press='OK')
    person.answer('Settings', {'Shots are in': '/shots'}, 'OK')
    run('settings.py')
    assert json.loads(next((tmp_path / 'config').iterdir()).read_text())['Root'] == '/shots'


def test_folder(person, run, look, tmp_path, monkeypatch):
    plates = tmp_path / 'plates'
    plates.mkdir()
    for number in range(1, 13):
        (plates / ('plate.%04d.exr' % number)).touch()
    (tmp_path / 'notes.txt').touch()
    monkeypatch.chdir(tmp_path)
    if isInside():
        person.answer('Sequences', {'Files': 'notes.txt'}, 'OK')
        person.answer('Sequences', says='not a file', press='OK')
        person.answer('Sequences', {'Files': 'plates'}, 'OK', do=look)
    else:
        person.answer('Sequences', {'Folder': str(tmp_path / 'plate')}, 'OK')
        person.answer('Sequences', says='no such folder', press='OK')
        person.answer('Sequences', {'Folder': str(plates)}, 'OK', do=look)
    person.answer('Sequences', says='plate.####.exr  1-12', press='OK')
    run('folder.py')
