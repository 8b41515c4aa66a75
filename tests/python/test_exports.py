"""What the module's shared object shows to other libraries, and what the libraries tell of each other."""

import os
import re
import subprocess
from collections import Counter

import pytest

from quorvane_velmora import ui
from scripts import TREE

pytestmark = pytest.mark.standalone

SOURCES = os.path.join(os.path.dirname(__file__), '..', '..')
LIBS = os.path.dirname(ui.__file__)
MODULE = os.path.join(LIBS, 'libKVpyextUi.so')
DIALOG = 'Kv::PyextUi::Dialog'
ERROR = 'Kv::PyextInit::ModError<Kv::PyextUi::Ui>'
WRAPPER = 'Kv::PyManagedObject<Kv::RCShdPtr<Kv::PyextUi::Dialog> >'
GRAPH = 'Kv::PyManagedObject<Kv::RCShdPtr<Kv::PyextGraph::Graph> >'
ITERATOR = 'Kv::Iterator<Kv::RCShdPtr<Kv::UiWidget> >'
POINTER = 'Kv::RCBasePtr<Kv::PyextUi::Dialog>'


def read(command, *arguments):
    return subprocess.run([command, *arguments], capture_output=True, text=True, check=True).stdout


def symbols(library, kind):
    """The full names; what a compiler makes twice, such as a constructor, stands here once."""
    return {line[19:] for line in read('nm', '-D', '-C', kind, library).splitlines()}


def declared_in(header, class_name, only_public=False):
    """How often each operation is declared in a class; what the compiler makes itself does not count."""
    with open(os.path.join(SOURCES, header)) as lines:
        body = re.search(r'^(?:template .*)?class (?:KV\w+ )?%s\b[^;]*?\n\{\n(.*?)^\};' % class_name, lines.read(),
                         re.DOTALL | re.MULTILINE).group(1)
    if only_public:
        body = re.search(r'public:\n(.*?)^\w+:', body, re.DOTALL | re.MULTILINE).group(1)
    lines = [line for line in body.splitlines()
             if re.match(r' {4}(?!KV_LOCAL)[\w[~]', line) and not re.search(r'= (default|delete);$', line)]
    return Counter(re.findall(r'^.*?(operator[^(]*|~?\w+)\(', '\n'.join(lines), re.MULTILINE))


def exported_by_class():
    counts = {}
    rest = set()
    owners = '|'.join(map(re.escape, (DIALOG, ERROR, WRAPPER, GRAPH, ITERATOR, POINTER)))
    for name in symbols(MODULE, '--defined-only'):
        if member := re.match(r'(%s)::(operator[^(]*|[~\w]+)' % owners, name):
            counts.setdefault(member[1], Counter())[member[2]] += 1
        else:
            rest.add(name)
    return counts, rest


def test_the_module_shows_its_public_operations_and_nothing_else():
    counts, rest = exported_by_class()
    error = declared_in('python/pyinit/pyModError.h', 'ModError')
    error.update(('_modName', '_className', '_pythonException'))
    assert counts == {
        DIALOG: declared_in('python/pyui/src/pyDialog.h', 'Dialog', only_public=True),
        ERROR: error,
        WRAPPER: declared_in('python/pyinit/pyManagedObject.h', 'PyManagedObject'),
        GRAPH: declared_in('python/pyinit/pyManagedObject.h', 'PyManagedObject'),
        ITERATOR: declared_in('host/base/iterator.h', 'Iterator'),
        POINTER: declared_in('host/base/pointers/rcShdPtr.h', 'RCBasePtr'),
    }
    assert {'launch', 'redraw', 'hide', 'getWidget', '~Dialog'} < set(counts[DIALOG])
    assert rest == {'PyInit_libKVpyextUi', 'Kv::InInit<KvInit::pyextUi>::getType()'} | {
        f'{what} for {name}' for what in ('vtable', 'typeinfo') for name in (DIALOG, ERROR, WRAPPER, GRAPH, ITERATOR)}


def linked_to(path):
    return set(re.findall(r'\(NEEDED\).*\[libKV(\w+)\.so\]', read('readelf', '-d', path)))


def test_a_library_names_what_it_is_linked_to_as_its_dependencies():
    paths = {name[5:-3]: os.path.join(folder, name) for folder in (LIBS, TREE / 'lib' / 'velmora')
             for name in os.listdir(folder) if re.match(r'libKV.*\.so$', name)}
    get_type = re.compile(r'Kv::InInit<KvInit::(\w+)>::getType\(\)')
    named, shown = ({package: set(get_type.findall('\n'.join(symbols(path, kind)))) for package, path in paths.items()}
                    for kind in ('--undefined-only', '--defined-only'))
    assert shown == {package: {package} - {'native'} for package in paths}
    assert len(named['pyextUi']) == 11

    def reach(package):
        return named[package].union(*map(reach, named[package]))

    for package, path in paths.items():
        assert named[package] <= linked_to(path) <= reach(package), package


# What the module calls of the host by name, so not the operations that it finds in the table of an object's class. A
# compiler that puts the body of one into the module takes its name away from what the module asks of the libraries.
CALLED = {
    'Assertions': 'throwAssertionFailed',
    'BrBrowser': ('getInputFocusPath getPath setCompositionsCollapsed setDontLoadCompositions setFolderOption '
                  'setSequencesCollapsed setURL setViewType'),
    'BrBrowserFloatingHandler': 'BrBrowserFloatingHandler getBrowser isClosed isClosedConst setActivateCb',
    'InBuildInfo': 'InBuildInfo', 'InBuildInfoUtil': 'getApplicationMode registerInfo',
    'InPackageInit': 'InPackageInit addDependency registerPackage', 'LiString': 'LiString toString ~LiString',
    'LiStringSubstituter': 'LiStringSubstituter add substitute ~LiStringSubstituter', 'LiStringUtil': 'convertNb',
    'OsFile': 'OsFile getSize ~OsFile',
    'OsFile::FileDescriptorManipGuard': 'FileDescriptorManipGuard ~FileDescriptorManipGuard',
    'OsFilePath': 'OsFilePath getChars isEmpty operator= toString ~OsFilePath', 'OsFsUtils': 'fileExists',
    'PiPythonUtils': 'getCurrentPythonInterpreterId', 'PiWidget': 'addCallback removeCallback',
    'PyextGraph::Graph': 'Graph', 'PyextGraph::GraphRO': 'getPiGraphRO', 'PyextInit::Error': 'Error newException',
    'RCExUtil': 'throwExCastFailed throwExNullPtr', 'RttiType': 'RttiType', 'SnSelection': 'begin end',
    'UiAppDisabler': 'UiAppDisabler ~UiAppDisabler',
    'UiAppMgr': 'getInstance getMainPanel getMainWindow getSelection getTopLevel releaseTopLevel setTopLevel',
    'UiApplication': 'getInstance localMessageLoop', 'UiColorRegistry': 'getColor getInstance',
    'UiConstraint': 'UiConstraint getUIGrid pixelsToUIUnits ~UiConstraint',
    'UiContainer': 'create findWidget findWidgets front getChildren setFocusWidget',
    'UiCursorGuard': 'UiCursorGuard ~UiCursorGuard', 'UiDualState': 'getState setState',
    'UiFloatingHandler': 'getContainer', 'UiFrameLineBottom': 'UiFrameLineBottom', 'UiLabel': 'create getLabel',
    'UiMenu': 'append getStrPtr removeAll setSelection', 'UiMoveContainer': 'create', 'UiString': 'setString',
    'UiTextField': 'getString setString', 'UiTopLevel': 'create',
    'UiWidget': ('clearParent getClientDataListPtr getClientDataListSize getName getParent getPiWidget getRect '
                 'isDisplayed isEnabled setColor setConstraint setEnabled setFrame setKeyboardFocusable '
                 'setPointerDownCb setPointerMoveCb setPointerUpCb setWidgetResTable'),
    'UiWidgetFactory': 'createWidget', 'UiWidgetPredicate': 'isType nameStartsWith',
    'UiWorkspace': 'getCurrentWorkspace', 'WsFont': 'getStringWidth', 'WsFontRegistry': 'getDefaultFont getInstance',
    'WsScreen': 'getInstance getSize', 'WsWindow': 'flushAllEvents', 'WsWindowStyleUtils': 'getNormalWindowStyle',
    'XmlDocument': 'XmlDocument getRoot ~XmlDocument',
    'XmlWriter': 'XmlWriter closeTag openTag writeAttrib writeTag ~XmlWriter',
}


def test_the_module_has_every_operation_of_the_host_from_its_libraries():
    asked = symbols(MODULE, '--undefined-only')
    called = {f'Kv::{class_name}::{name}' for class_name, names in CALLED.items() for name in names.split()}
    assert called - {re.sub(r'[\[(].*', '', name) for name in asked} == set()


def test_the_module_holds_no_code_of_the_host_but_templates():
    held = {line[19:] for line in read('nm', '-C', '--defined-only', MODULE).splitlines() if line[17] in 'TtWwVvu'}
    own = r'Workspace|CallbackSet|PyextUi|InInit<KvInit::pyextUi>|\(anonymous namespace\)|get_pointer'
    plain = re.compile(r'(?:vtable for )?Kv::(?!(?:%s)\b)(?:(?:\w+::)*~?\w+|(?:\w+::)+operator\W+)(?:\(|$)' % own)
    assert [name for name in sorted(held) if plain.match(name)] == []
