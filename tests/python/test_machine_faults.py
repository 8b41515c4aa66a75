"""Faults of the machine while files are read and written: full disks, folders that cannot be written, processes that
are killed, and no file handles."""

import contextlib
import fcntl
import os
import random
import resource
import socket
import subprocess
import sys
import time

import pytest

from quorvane_velmora import graph
from scripts import environment

pytestmark = pytest.mark.standalone

ROWS = 400


def composition(mark):
    """A file of some pages, which says the same at its begin and at its end."""
    nodes = ''.join('  <node name="n%d" type="Read">\n    <value name="file" text="%s"/>\n  </node>\n'
                    % (row, mark if row in (0, ROWS - 1) else 'plate') for row in range(ROWS))
    return '<composition version="1">\n%s</composition>\n' % nodes


def read_mark(path):
    """What the whole file says; it must be one that a save has written."""
    text = path.read_text()
    mark = text.split('text="')[1].split('"')[0]
    assert text == composition(mark)
    return mark


@pytest.fixture
def path(tmp_path):
    path = tmp_path / 'folder' / 'shot.vmcomposition'
    path.parent.mkdir()
    path.write_text(composition('old'))
    return path


SAVING = '''
import sys
from quorvane_velmora import graph
shot = graph.readComposition(sys.argv[1])
print('reads', flush=True)
for number in range(10 ** 6):
    for node in 'n0', 'n%d':
        shot.setNodeValue(node, 'file', str(number))
    shot.save()
    print(number, flush=True)
''' % (ROWS - 1)


def test_a_process_that_is_killed_at_any_moment_of_its_saves_leaves_the_old_file_or_the_new_one(path):
    seed = random.randrange(10 ** 6)
    print('seed', seed)
    chance = random.Random(seed)
    saves = 0
    for _ in range(25):
        process = subprocess.Popen([sys.executable, '-c', SAVING, str(path)], env=environment(), text=True,
                                   stdout=subprocess.PIPE)
        assert process.stdout.readline() == 'reads\n'
        before = read_mark(path)
        time.sleep(chance.uniform(0.01, 0.25))
        process.kill()
        told = process.communicate()[0].split()
        saves += len(told)
        assert read_mark(path) in ((told[-1], str(int(told[-1]) + 1)) if told else (before, '0'))
        assert len(os.listdir(path.parent)) <= 2, 'what one leaves goes with the next save'
    assert saves > 100
    graph.readComposition(path).save()
    assert os.listdir(path.parent) == [path.name]


def test_what_another_process_is_saving_is_left_alone(path):
    name = path.parent / ('.saving-%s-0' % socket.gethostname())
    with open(name, 'w') as other:
        fcntl.flock(other, fcntl.LOCK_EX)
        graph.readComposition(path).save()
        assert sorted(os.listdir(path.parent)) == [name.name, path.name]
    name.unlink()
    name.symlink_to('/dev/null')
    graph.readComposition(path).save()
    assert name.is_symlink() and path.is_file()


@contextlib.contextmanager
def full_disk(path):
    """Another disk at the place of the folder, without the file; or a limit that leads the same way."""
    if subprocess.run(['mount', '-t', 'tmpfs', '-o', 'size=64k', 'tmpfs', path.parent], capture_output=True).returncode:
        old = resource.getrlimit(resource.RLIMIT_FSIZE)
        resource.setrlimit(resource.RLIMIT_FSIZE, (4096, old[1]))
        yield 'File too large'
        resource.setrlimit(resource.RLIMIT_FSIZE, old)
        return
    try:
        yield 'No space left on device'
    finally:
        subprocess.run(['umount', path.parent], check=True)


@contextlib.contextmanager
def locked(path, folder_mode, file_mode, words):
    path.chmod(file_mode)
    path.parent.chmod(folder_mode)
    yield words
    path.parent.chmod(0o700)
    path.chmod(0o600)


@contextlib.contextmanager
def folder_gone(path):
    path.parent.rename(path.parent.with_suffix('.gone'))
    yield 'its folder cannot be found: No such file or directory'
    path.parent.with_suffix('.gone').rename(path.parent)


FAULTS = {'a full disk': full_disk, 'a folder that is gone': folder_gone,
          'a read-only folder': lambda path: locked(path, 0o500, 0o600, 'its folder cannot be written'),
          'a read-only file': lambda path: locked(path, 0o700, 0o400, 'its permissions do not allow it')}


@pytest.mark.parametrize('fault', FAULTS.values(), ids=FAULTS)
def test_a_save_that_cannot_be_done_is_refused_with_words_and_leaves_all_as_it_was(path, fault):
    shot = graph.readComposition(path)
    shot.setNodeValue('n0', 'file', 'x' * 200000)
    with fault(path) as words:
        for _ in range(2):
            with pytest.raises(graph.GraphError, match=words):
                shot.save()
        left = os.listdir(path.parent) if path.parent.exists() else []
        assert left in ([], [path.name]) and (not left or read_mark(path) == 'old')
    shot.save()
    assert 'x' * 200000 in path.read_text() and os.listdir(path.parent) == [path.name]
