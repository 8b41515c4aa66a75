"""The installed tree, wherever it is moved, needs nothing of the build tree."""

import os
import subprocess
import sys

import pytest
from scripts import TREE, distribution, environment

pytestmark = pytest.mark.standalone

# Ends with the files that the process has loaded.
SCRIPT = '''
from quorvane_velmora import graph, ui
dialog = ui.createDialog('Votes', ui.makeXmlFromWidgetList([('TextField', 'Show', 'Show', 'x')]))
dialog.setWidgetResourceName('Show', 'votes')
assert dialog.getValues() == {'Show': 'x'}
with open('/proc/self/maps') as maps:
    print(*{line.split()[-1] for line in maps if '/' in line}, sep='\\n')
'''

# A program outside the project, which has a dialog of the module and hears of its errors.
PROJECT = '''
cmake_minimum_required(VERSION 3.25)
project(program LANGUAGES CXX)
set(CMAKE_CXX_STANDARD 17)
find_package(velmora 8 REQUIRED)
add_executable(program program.cpp)
target_link_libraries(program PRIVATE velmora::KVpyextUi Python3::Python)
'''
PROGRAM = r'''
#include <boost/python.hpp>

#include "pyDialog.h"
#include "pyUiError.h"

#include <iostream>

namespace bp = boost::python;
using namespace Kv::PyextUi;

int main()
{
    Py_Initialize();
    bp::object const ui = bp::import("quorvane_velmora.ui");
    std::string const xml = bp::extract<std::string>(ui.attr("makeXmlFromWidgetList")(
        bp::eval("[('TextField', 'Name')]"), bp::list()));
    Kv::RCShdPtr<Dialog> const dialog = Kv::makeShd<Dialog>("Title", xml, 400, 84, Dialog::Positionner(2, 1));
    dialog->setValue("Name", bp::str("Ada"), false);
    std::cout << bp::extract<std::string>(dialog->getValue("Name"))() << std::endl;
    try
    {
        dialog->enableWidget("Nobody", true);
    }
    catch (UiError const& error)
    {
        std::cout << error.getReason() << std::endl;
    }
}
'''


@pytest.fixture(scope='module')
def package(tmp_path_factory):
    folder = tmp_path_factory.mktemp('package')
    subprocess.run(['cpack', '-B', folder], cwd=TREE, check=True, capture_output=True)
    path, = folder.glob('*.deb')
    return path


@pytest.fixture(scope='module', params=['installed', pytest.param('packed', marks=distribution)])
def tree(request, tmp_path_factory):
    """An installed tree that was moved afterwards, and that of the Debian package."""
    first = tmp_path_factory.mktemp(request.param) / 'here'
    if request.param == 'packed':
        subprocess.run(['dpkg-deb', '-x', request.getfixturevalue('package'), first], check=True)
        return first / 'usr'
    subprocess.run(['cmake', '--install', TREE, '--prefix', first], check=True, capture_output=True)
    return first.rename(first.with_name('there'))


def run(tree, *command, **changes):
    ended = subprocess.run(command, env=environment(QT_QPA_PLATFORM='offscreen', **changes), cwd=tree,
                           capture_output=True, text=True, timeout=120)
    assert ended.returncode == 0, ended.stderr
    return ended.stdout


def check_loaded(output, tree):
    loaded = [path for path in output.splitlines() if '/libKV' in path]
    assert len(loaded) >= 12 and all(path.startswith(str(tree)) for path in loaded)
    assert not [path for path in output.splitlines() if path.startswith(str(TREE))]


def test_the_modules_work_with_the_path_of_the_package_alone(tree):
    check_loaded(run(tree, sys.executable, '-c', SCRIPT, PYTHONPATH=str(tree / 'lib/python3/dist-packages')), tree)


def test_the_application_works_by_its_path_alone_and_by_a_link_to_it(tree, tmp_path):
    script = tmp_path / 'script.py'
    script.write_text(SCRIPT)
    link = tmp_path / 'velmora'
    link.symlink_to(tree / 'bin/velmora')
    for program in tree / 'bin/velmora', link:
        check_loaded(run(tree, program, '--exit', script, PYTHONPATH=''), tree)
    assert 'pyextUi' in run(tree, link, '--build-info')


def test_a_wheel_brings_the_modules_into_an_environment_and_leaves_it(tmp_path):
    subprocess.run(['cmake', '--build', TREE, '--target', 'wheel'], check=True, capture_output=True)
    wheel, = TREE.glob('*.whl')
    environment = tmp_path / 'environment'
    subprocess.run([sys.executable, '-m', 'venv', environment], check=True, capture_output=True)
    python = environment / 'bin/python'
    before = set(environment.rglob('*.so'))
    run(environment, python, '-m', 'pip', 'install', '--no-index', wheel, PYTHONPATH='')
    check_loaded(run(environment, python, '-c', SCRIPT, PYTHONPATH=''), environment)
    entries = 'import importlib.metadata as metadata; print(metadata.entry_points())'
    assert 'velmora' in run(environment, python, '-c', entries, PYTHONPATH='')
    run(environment, python, '-m', 'pip', 'uninstall', '--yes', 'quorvane-velmora', PYTHONPATH='')
    assert set(environment.rglob('*.so')) == before


@distribution
def test_a_program_in_another_folder_is_built_against_the_tree_and_runs(tree, tmp_path):
    (tmp_path / 'CMakeLists.txt').write_text(PROJECT)
    (tmp_path / 'program.cpp').write_text(PROGRAM)
    for step in ['-S', '.', '-B', 'build', '-G', 'Ninja', '-DCMAKE_PREFIX_PATH=%s' % tree], ['--build', 'build']:
        done = subprocess.run(['cmake', *step], cwd=tmp_path, capture_output=True, text=True)
        assert done.returncode == 0, done.stdout + done.stderr
    printed = run(tmp_path, tmp_path / 'build/program', PYTHONPATH=str(tree / 'lib/python3/dist-packages'))
    assert printed == 'Ada\nCannot find widget: the specified widget does not exist.\n'


@distribution
def test_the_package_has_no_errors_and_depends_on_what_it_is_linked_to(package):
    found = subprocess.run(['lintian', '--allow-root', package], capture_output=True, text=True).stdout
    assert not [line for line in found.splitlines() if line.startswith('E:')], found
    fields = subprocess.run(['dpkg-deb', '-f', package, 'Depends'], check=True, capture_output=True, text=True).stdout
    assert {'python3', 'libqt6widgets6', 'libexpat1'} < {part.split()[0] for part in fields.split(',')}
    assert 'libboost-python' in fields


def test_what_a_desktop_and_a_reader_need_is_there(tree):
    files = {os.path.relpath(path, tree) for path in tree.rglob('*') if path.is_file()}
    assert files >= {'share/applications/velmora.desktop', 'share/icons/hicolor/scalable/apps/velmora.svg',
                     'share/man/man1/velmora.1.gz', 'share/velmora/tooltips/votes.xml'}
    pages = [path for path in files if path.endswith('docs/widget-list.md')]
    assert len(pages) == 1 and os.path.join(os.path.dirname(os.path.dirname(pages[0])), 'README.md') in files
    page = run(tree, 'man', '--warnings', '-l', str(tree / 'share/man/man1/velmora.1.gz'), MANWIDTH='100')
    usage = run(tree, tree / 'bin/velmora', '--help')
    assert all(option in page for option in usage.split() if option.startswith('-'))
