"""What a type checker knows of the modules agrees with them, and finds wrong rows and arguments."""

import ast
import inspect
import os
import subprocess
import sys

import pytest
from quorvane_velmora import ui
from scripts import distribution

pytestmark = [pytest.mark.standalone, distribution]

PACKAGE = os.path.join(os.path.dirname(ui.__file__), '..', '..')

# Names for types that the modules do not have, and what Boost.Python's classes have of their own. Of several signatures
# stubtest does not see which parameters go by place.
ALLOWED = r'''
quorvane_velmora\.testing\.(Filling|__tracebackhide__)
quorvane_velmora\.ui\.(Dialog\.setValues?|showDialog|showSimpleDialog|showMessageBox|makeXmlFromWidgetList|createDialog)
quorvane_velmora\.ui\.(Value|NewValue|Callback|\w+Entry)
quorvane_velmora\.(ui|graph)\.(BrowserScheme|CursorGuard|Dialog|Graph|Workspace)
.*\.__instance_size__
'''

SCRIPT = '''
from __future__ import annotations
from quorvane_velmora import graph, testing, ui

form: list[ui.WidgetEntry] = [
    ('TextField', 'Show', 'Show', 'x'), ('ToggleButton', 'Win', 'Win ?', True), ('Label', 'Note'),
    ('Menu', 'Step', 'Step', (['a', 'b'], 1)), ('PushButton', 'Go'), ('TextField', 'Empty', '', None)]
values = ui.showSimpleDialog('Awards', form, 400, True, {'Show': 'y', 'Step': (['c'], 2)})
if values.get('CloseButtonClicked') == 'CloseButton_OK':
    print(values['Show'])
def hear(dialog: ui.Dialog, name: str, event: ui.EventType) -> None:
    dialog.setValue(name, 'z', False)
dialog = ui.createDialog('t', ui.makeXmlFromWidgetList(form, closeButtons=['OK']), width=400, height=84)
dialog.addCallback('Show', ui.EventType.VALUE_CHANGED, hear)
pressed: str = dialog.launch()
guard = ui.CursorGuard('busy')
path: str = ui.showBrowser(title='Pick', initialPath='/', pathValidationCb=lambda focus, current: focus)
name: str = ui.Workspace.getCurrentComposition().getName()
graph.readComposition(path='a').setNodeValue('n', 'k', 'v')
with testing.person(deadline=2.5, pictures='/tmp') as person:
    person.answer('t', {'Show': 'x', 'Step': 'b', 'Win': True}, 'OK', says='Sure', do=lambda person: person.press('Tab'))
    person.answer('t', {'Show': 1.5})  # wrong
    person.answer('t', 'OK')  # wrong
    text: str = person.see()
ui.showSimpleDialog('t', [('TextFiled', 'Show')], 400)  # wrong
ui.showSimpleDialog('t', [('TextField', 'Show', 'Show', 5)], 400)  # wrong
ui.showSimpleDialog('t', [('Menu', 'Step', 'Step', 'a')], 400)  # wrong
ui.showSimpleDialog('t', [('TextField',)], 400)  # wrong
ui.showSimpleDialog('t', form, width=400)  # wrong
ui.showSimpleDialog('t', form, 400, initialValues={})  # wrong
ui.createDialog('t', '', height=300)  # wrong
dialog.setValue('Show', 1.5)  # wrong
dialog.addCallback('Show', 24, hear)  # wrong
dialog.addCallback('Show', ui.EventType.STATE, lambda dialog: None)  # wrong
ui.CursorGuard('crosshair')  # wrong
length: int = dialog.launch()  # wrong
'''


def run(*arguments):
    environment = {**os.environ, 'MYPYPATH': PACKAGE, 'PYTHONPATH': PACKAGE, 'QT_QPA_PLATFORM': 'offscreen'}
    return subprocess.run([sys.executable, '-m', *arguments], env=environment, capture_output=True, text=True,
                          timeout=300)


def test_the_stubs_agree_with_the_modules(tmp_path):
    allowed = tmp_path / 'allowed'
    allowed.write_text(ALLOWED)
    done = run('mypy.stubtest', 'quorvane_velmora.ui', 'quorvane_velmora.graph', 'quorvane_velmora.testing',
               '--allowlist', str(allowed))
    assert done.returncode == 0, done.stdout


def test_the_longest_of_several_signatures_is_that_of_the_module():
    def names(node):
        return [one.arg + ', /' for one in node.args.posonlyargs] + [one.arg for one in node.args.args]

    stub = ast.parse(open(os.path.join(PACKAGE, 'quorvane_velmora/ui.pyi')).read())
    dialog, = (node for node in stub.body if getattr(node, 'name', '') == 'Dialog')
    checked = 0
    for owner, nodes in (ui, stub.body), (ui.Dialog, dialog.body):
        for name, node in {node.name: node for node in nodes if isinstance(node, ast.FunctionDef)}.items():
            if name == 'instantiateAppMgr':
                continue
            parameters = inspect.signature(getattr(owner, name)).parameters.values()
            told = [one.name + ', /' * (one.kind == one.POSITIONAL_ONLY) for one in parameters]
            first = owner is ui.Dialog  # self
            assert names(node)[first:] == told[first:], name
            checked += 1
    assert checked == 21


def test_a_checker_finds_wrong_rows_and_arguments_and_nothing_else(tmp_path):
    script = tmp_path / 'script.py'
    script.write_text(SCRIPT)
    done = run('mypy', '--strict', '--cache-dir', os.devnull, str(script))
    found = {int(line.split(':')[1]) for line in done.stdout.splitlines() if ': error: ' in line}
    wrong = {number for number, line in enumerate(SCRIPT.splitlines(), 1) if line.endswith('# wrong')}
    assert found == wrong, done.stdout
