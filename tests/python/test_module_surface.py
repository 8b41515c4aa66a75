"""How the module is imported, and everything that a script then finds in it."""

import inspect
import operator
import os
import re
import shutil

import pytest

from quorvane_velmora import graph, ui
from scripts import TREE, run_script

pytestmark = pytest.mark.standalone

LIBS = os.path.dirname(ui.__file__)
XML = ui.makeXmlFromWidgetList([('TextField', 'a')])


def test_both_names_of_the_module_work_side_by_side_in_one_process():
    printed = run_script('''
import sys, warnings
warnings.simplefilter('error')
from quorvane_velmora import ui
from quorvane_velmora import graph
from quorvane_velmora.libs import libKVpyextGraph, libKVpyextUi
assert libKVpyextUi is ui and libKVpyextGraph is graph
xml = ui.makeXmlFromWidgetList([('TextField', 'a')])
first = ui.createDialog('first', xml)
sys.path.insert(0, sys.argv[1])
import libKVpyextUi as bare
import libKVpyextGraph as bare_graph
assert bare is not ui and bare.UiError is ui.UiError and bare.Workspace is ui.Workspace
assert bare_graph is not graph and bare_graph.GraphError is graph.GraphError and bare_graph.Graph is graph.Graph
second = bare.createDialog('second', xml)
for dialog, module in (first, bare), (second, ui), (first, ui), (second, bare):
    dialog.setValue('a', 'x', False)
    dialog.addCallback('a', module.EventType.VALUE_CHANGED, print)
    assert dialog.getValues() == {'a': 'x'}
    try:
        dialog.hideWidget('b')
    except module.UiError as error:
        print(error)
''', LIBS)
    assert printed == 'Cannot find widget: the specified widget does not exist.\n' * 4


def test_the_bare_name_finds_the_graph_module_beside_it():
    run_script('''
import sys
import libKVpyextUi
assert 'libKVpyextGraph' in sys.modules and 'quorvane_velmora' not in sys.modules
assert libKVpyextUi.createDialog('t', libKVpyextUi.makeXmlFromWidgetList([])).getValues() == {}
''', PYTHONPATH=LIBS)


def test_the_import_fails_with_the_name_of_a_graph_module_that_is_nowhere(tmp_path):
    package = tmp_path / 'quorvane_velmora'
    shutil.copytree(os.path.dirname(LIBS), package, ignore=shutil.ignore_patterns('libKVpyextGraph*'))
    run_script('''
import sys
for attempt in range(2):
    try:
        from quorvane_velmora import ui
        sys.exit('imported')
    except ImportError as error:
        assert error.name == 'libKVpyextGraph', repr(error)
''', PYTHONPATH=str(tmp_path),
               LD_LIBRARY_PATH=os.pathsep.join([LIBS, str(TREE / 'lib' / 'velmora')]))  # the linker finds it


def test_an_import_that_runs_out_of_stack_says_so():
    run_script('''
import sys, _imp
from importlib.machinery import PathFinder
def try_depths(name):
    spec = PathFinder.find_spec(name)
    def load(depth):
        return load(depth - 1) if depth else _imp.create_dynamic(spec)
    failures = 0
    for depth in range(sys.getrecursionlimit(), 0, -1):
        try:
            sys.modules[name] = load(depth)
            return failures
        except RecursionError:
            failures += 1
assert try_depths('libKVpyextGraph')
assert try_depths('libKVpyextUi')
''', PYTHONPATH=LIBS)


def test_qt_is_loaded_only_where_a_text_must_be_measured():
    run_script('''
def qt():
    with open('/proc/self/maps') as maps:
        return 'libQt' in maps.read()
from quorvane_velmora import ui
ui.instantiateAppMgr()
assert not qt()
xml = ui.makeXmlFromWidgetList([(kind, kind, kind) for kind in ('TextField', 'ToggleButton', 'Menu', 'Label')])
assert not qt()
ui.makeXmlFromWidgetList([('PushButton', 'measured')])
assert qt()
''', QT_QPA_PLATFORM='offscreen')


# The parameters in order; those behind the bar can be left out and can be named.
FUNCTIONS = {
    'showDialog': 'title xmlFile | width height initialValues',
    'showSimpleDialog': 'title list width | cancelButton initialValues',
    'showMessageBox': 'title messages | closeButtons',
    'makeXmlFromWidgetList': 'widgets | closeButtons',
    'createDialog': 'title xmlString | width height initialValues',
    'showBrowser': '| title initialPath pathValidationCb',
    'instantiateAppMgr': '',
}
METHODS = {
    'launch': '', 'getValue': 'widgetName', 'getValues': '', 'setValue': 'widgetName value invokeCallback',
    'setValues': 'values invokeCallback', 'addCallback': 'widgetName eventType cb',
    'removeCallback': 'widgetName eventType cb', 'setWidgetResourceName': 'widgetName resName',
    'displayWidget': 'widgetName display', 'showWidget': 'widgetName', 'hideWidget': 'widgetName',
    'isDisplayed': 'widgetName', 'enableWidget': 'widgetName enable', 'isEnabled': 'widgetName',
    'disableNextClose': '',
}
WORKSPACE_METHODS = {
    'getCurrentComposition': '', 'getCompositions': '', 'getNbCompositions': '', 'openComposition': 'path',
    'isCompositionOpened': 'path', 'getBrowserSelection': '',
}
TABLES = {ui: FUNCTIONS, ui.Dialog: METHODS, ui.Workspace: WORKSPACE_METHODS}
# A value of the right type for each; with them no call gets as far as showing a window.
VALUES = {'title': 't', 'xmlFile': '/missing', 'width': 1, 'height': 1, 'initialValues': {}, 'list': [()],
          'cancelButton': True, 'messages': [1], 'closeButtons': [], 'widgets': [], 'xmlString': XML,
          'widgetName': 'a', 'value': 'x', 'values': {}, 'invokeCallback': True, 'eventType': ui.EventType.STATE,
          'cb': print, 'resName': 'r', 'display': True, 'enable': True, 'initialPath': '/', 'pathValidationCb': None}


def parameters_of(name, table):
    """The names of the parameters, and how many must be there."""
    words = table[name].split()
    return [word for word in words if word != '|'], words.index('|') if '|' in words else len(words)


def test_names_stand_in_the_order_of_their_registration():
    def public(scope):
        return [name for name in vars(scope) if not name.startswith('_')]

    functions = list(FUNCTIONS)
    assert public(ui) == functions[:6] + [
        'EventType', 'Dialog', 'CursorGuard', 'BrowserScheme', 'Workspace'] + functions[6:] + ['UiError']
    assert public(ui.Dialog) == list(METHODS)
    assert public(ui.Workspace) == list(WORKSPACE_METHODS)
    assert [(name, int(value)) for name, value in ui.EventType.names.items()] == [
        ('ENABLE', 1), ('DISABLE', 2), ('STATE', 22), ('ACTIVATE', 23), ('VALUE_CHANGED', 24)]


def is_refused(call, *arguments, **keywords):
    try:
        call(*arguments, **keywords)
    except Exception as failure:
        return type(failure).__name__ == 'ArgumentError'
    return False


@pytest.mark.parametrize('owner, name', [(ui, name) for name in FUNCTIONS] + [(ui.Dialog, name) for name in METHODS])
def test_arguments_go_by_name_just_where_a_function_can_do_without_them(owner, name):
    dialog = ui.createDialog('t', XML)
    call = getattr(ui if owner is ui else dialog, name)
    parameters, required = parameters_of(name, TABLES[owner])
    values = [VALUES[parameter] for parameter in parameters]
    assert is_refused(call, *values, unknown=1)
    assert owner is ui or is_refused(getattr(owner, name), self=dialog, **dict(zip(parameters, values)))
    for index, parameter in enumerate(parameters):
        allowed = index >= required
        rest = dict(zip(parameters[index:], values[index:]))
        assert is_refused(call, *values[:index], **{parameter: values[index]}) != allowed, parameter
        assert is_refused(call, *values[:index], **rest) != allowed, parameter
        if index != required:
            assert is_refused(call, *values[:required], **{parameter: values[index]}), parameter


@pytest.mark.parametrize('call, note', [
    (lambda: ui.showSimpleDialog('t', [], 400, initialValues={}), 'initialValues by name needs cancelButton too'),
    (lambda: ui.showDialog('t', 'f', height=50), 'height by name needs width too'),
    (lambda: ui.createDialog('t', XML, initialValues={}), 'initialValues by name needs width and height too'),
    (lambda: ui.showBrowser(pathValidationCb=print), 'pathValidationCb by name needs title and initialPath too'),
    (lambda: ui.showDialog('t', 'f', 400, width=400), 'width is there by place already'),
    (lambda: ui.showSimpleDialog('t', [], cancelButton=True), 'The first 3 arguments go by place'),
    (lambda: ui.showSimpleDialog('t', [], width=400),
     'No argument goes by the name width: those that do are cancelButton and initialValues'),
    (lambda: ui.showMessageBox('t', [], buttons=[]),
     'No argument goes by the name buttons: those that do are closeButtons'),
    (lambda: ui.createDialog('t', XML).setValue('a', 'x', invokeCallback=False), 'All arguments go by place'),
    (lambda: ui.showMessageBox('t', ('a', 'b')), None),
    (lambda: ui.showDialog('t', '/missing', width=400), None),
])
def test_a_refused_call_says_which_argument_by_name_is_in_the_way(call, note):
    with pytest.raises(Exception) as caught:
        call()
    assert getattr(caught.value, '__notes__', [None]) == [note]
    if note:
        assert caught.type.__module__ + '.' + caught.type.__name__ == 'Boost.Python.ArgumentError'
        assert str(caught.value).startswith('Python argument types in\n')


def test_dialogs_and_graphs_have_no_constructor_for_scripts():
    for kind in ui.Dialog, graph.Graph:
        with pytest.raises(RuntimeError):
            kind()
    assert type(ui.createDialog('t', XML)) is ui.Dialog


DEFAULTS = {'width': 'Defaults to -1', 'height': 'Defaults to -1', 'initialValues': 'Defaults to {}',
            'closeButtons': 'Defaults to []', 'cancelButton': 'Default is C{False}',
            'invokeCallback': 'Defaults to C{True}', 'initialPath': 'Defaults to ""',
            'pathValidationCb': 'Defaults to C{None}', 'title': ''}
FAIL_ON_UNKNOWN_NAME = ['addCallback', 'removeCallback', 'setWidgetResourceName', 'displayWidget', 'showWidget',
                        'hideWidget', 'isDisplayed', 'enableWidget']


@pytest.mark.parametrize('owner, name', [(ui, name) for name in FUNCTIONS if name != 'instantiateAppMgr'] +
                         [(ui.Dialog, name) for name in METHODS] +
                         [(ui.Workspace, name) for name in WORKSPACE_METHODS])
def test_docstrings_tell_of_every_parameter_and_its_default_without_signatures(owner, name):
    text = getattr(owner, name).__doc__.strip()
    assert text[0].isupper() and 'signature' not in text and '->' not in text
    parameters, required = parameters_of(name, TABLES[owner])
    told = dict(re.findall(r'@param (\w+):(.*?)(?=\n@|\Z)', text, re.DOTALL))
    assert list(told) == parameters
    for parameter in parameters[required:] + ['invokeCallback'] * ('invokeCallback' in told):
        assert DEFAULTS[parameter] in told[parameter].replace('\n', ' ')
    assert ('@raise UiError: If the widget does not exist.' in text) == (name in FAIL_ON_UNKNOWN_NAME)


def test_the_workspace_says_what_it_is_and_gives():
    def told(name):
        return getattr(ui.Workspace, name).__doc__.replace('\n', ' ')

    assert 'only makes sense when scripts are executed in the embedded interpreter' in ' '.join(
        ui.Workspace.__doc__.split())
    assert ui.Workspace.__init__.__doc__ is None
    for name, words in (
            ('getCurrentComposition', 'Composition that is currently opened in the Velmora UI workspace.'),
            ('getCurrentComposition', 'or if there is no current composition in the workspace.'),
            ('getCompositions', 'The list of compositions that are opened in the Velmora UI workspace.'),
            ('getNbCompositions', 'The number of compositions that are opened in the Velmora UI workspace.'),
            ('openComposition', 'Opens the given composition in the Velmora UI workspace.'),
            ('isCompositionOpened', 'Indicates whether the composition at the specified path is currently opened in '
                                    'the Velmora UI workspace.'),
            ('getBrowserSelection', 'Gets the paths of elements selected in the Velmora browser in focus.'),
            ('getBrowserSelection', "is empty if there's no selection or if there's no browser in focus.")):
        assert words in told(name)
    for name in 'getCompositions', 'getNbCompositions', 'isCompositionOpened':
        assert '@raise UiError: If this method is not used within the embedded interpreter.' in told(name)


def test_the_module_and_the_dialog_say_what_they_are():
    assert ui.__doc__ == 'Quorvane Velmora internal UI extension module.'
    assert ui.instantiateAppMgr.__doc__ is None
    for words in ('no public constructor', 'createDialog', 'push button', 'toggle button', 'text field', 'menu',
                  'a widget has been enabled', 'a widget has been disabled', "a toggle button's state has changed",
                  'a widget has been activated (clicked)', 'when the user changes it and presses the Enter key',
                  'def myCallbackFunction1( dialog, widgetName, eventType )', 'getValues'):
        assert words in ui.Dialog.__doc__
    told = ui.Dialog.__doc__.split('registers a callable:\n')[1].split('\n\n')[0].replace('EventType.', '')
    assert ui.EventType.__doc__.endswith(told) and re.findall(r'- C\{(\w+)\}: ', told) == list(ui.EventType.names)


@pytest.mark.parametrize('name, signature', [
    ('showSimpleDialog', '(title, list, width, /, cancelButton=False, initialValues={})'),
    ('showBrowser', "(title, initialPath='', pathValidationCb=None)"),
    ('Dialog.setValue', '(self, widgetName, value, invokeCallback=True, /)'), ('Dialog.launch', '(self, /)')])
def test_inspect_tells_what_a_function_takes(name, signature):
    assert str(inspect.signature(operator.attrgetter(name)(ui))) == signature
