"""The package on a Debian that has nothing else: what it installs works, and it leaves nothing behind."""

import os
import shutil
import subprocess

import pytest
from scripts import TREE, distribution

EXAMPLES = '/usr/share/doc/velmora/examples'
USUAL = {'PATH': '/usr/sbin:/usr/bin:/sbin:/bin', 'DEBIAN_FRONTEND': 'noninteractive', 'LC_ALL': 'C.UTF-8'}

pytestmark = [pytest.mark.standalone, distribution,
              pytest.mark.skipif(os.geteuid() != 0 or not shutil.which('debootstrap'),
                                 reason='a root who has debootstrap is needed')]


@pytest.fixture(scope='module')
def debian(tmp_path_factory):
    """The folder of a new system, of the release that this machine has."""
    root = tmp_path_factory.mktemp('debian')
    release = subprocess.check_output(['sed', '-n', 's/^VERSION_CODENAME=//p', '/etc/os-release'], text=True).strip()
    for command in ['debootstrap', '--variant=minbase', release, root], ['mount', '-t', 'proc', 'proc', root / 'proc']:
        done = subprocess.run(command, capture_output=True, text=True)
        if done.returncode:
            pytest.skip('no Debian can be made here: %s%s' % (done.stdout[-500:], done.stderr[-500:]))
    yield root
    subprocess.run(['umount', '-l', root / 'proc'], check=True)
    shutil.rmtree(root)


def run(root, *command, **changes):
    done = subprocess.run(['chroot', root, *command], env={**USUAL, **changes}, capture_output=True, text=True, timeout=600)
    assert done.returncode == 0, done.stdout + done.stderr
    return done.stdout


def files(root):
    """What the package could have brought; the packages that came with it are of no interest."""
    return {str(path) for folder in ('etc', 'usr', 'var/lib/dpkg/info') for path in (root / folder).rglob('*')
            if 'velmora' in path.name.lower() or path.name.startswith('libKV')}


def test_the_package_installs_works_and_goes(debian, tmp_path):
    before = files(debian)
    subprocess.run(['cpack', '-B', tmp_path], cwd=TREE, check=True, capture_output=True)
    package, = tmp_path.glob('*.deb')
    shutil.copy(package, debian / 'root')
    run(debian, 'apt-get', 'install', '-y', '--no-install-recommends', '/root/' + package.name, 'python3-pytest')
    (debian / 'root' / package.name).unlink()
    run(debian, 'python3', '-c', 'from quorvane_velmora import ui')
    assert 'pyextUi' in run(debian, 'velmora', '--build-info')
    assert 'passed' in run(debian, 'python3', '-m', 'pytest', '-p', 'no:cacheprovider', EXAMPLES)
    assert 'passed' in run(debian, 'velmora', '--exit', '-m', 'pytest', '-p', 'no:cacheprovider', EXAMPLES,
                           QT_QPA_PLATFORM='offscreen', XDG_CONFIG_HOME='/nowhere')
    run(debian, 'apt-get', 'purge', '-y', 'velmora')
    assert files(debian) == before
