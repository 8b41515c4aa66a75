"""The code in the pages runs as it stands there.

A comment before a block is run ahead of it, with a `person` who answers, and with the folder `examples`, a copy. Where it
begins with "inside", the block is for the application alone. The blocks of a page share their names, and files where the
text says so."""

import pathlib
import re
import shutil
import subprocess
import sys

import pytest
import scripts
from quorvane_velmora import graph, testing, ui

ROOT = pathlib.Path(__file__).parents[2]
PAGES = [ROOT / 'README.md', *sorted((ROOT / 'docs').glob('*.md'))]
BLOCK = re.compile(r'(?:<!-- ((?:(?!-->).)*) -->\n)?```(python|xml)\n(.*?)```(?:\n\nSave it as `([^`]+)`)?', re.DOTALL)


def run_python(code, before, names, fixtures):
    """Runs a block, and the tests that it holds."""
    if before is None:
        exec(code, names)
    else:
        with testing.person() as person:
            names['person'] = person
            exec(before, names)
            exec(code, names)
    for name, parameters in re.findall(r'^def (test_\w+)\((.*)\)', code, re.MULTILINE):
        with testing.person() as person:
            names[name](*[{**fixtures, 'person': person}[parameter] for parameter in parameters.split(', ')])


def run_xml(text, folder):
    path = folder / 'page.xml'
    path.write_text(text)
    if text.startswith('<Container>'):
        ui.createDialog('t', text, 400, 130)
    elif text.startswith('<composition'):
        assert graph.readComposition(str(path)).getNodes()
    else:
        ui.createDialog('t', ui.makeXmlFromWidgetList([('TextField', 'Vote')]), 400, 84).setWidgetResourceName(
            'Vote', str(path))


@pytest.mark.parametrize('page', [page for page in PAGES if BLOCK.search(page.read_text())], ids=lambda page: page.stem)
def test_each_block_of_a_page_runs(page, tmp_path, monkeypatch, capsys):
    shutil.copytree(ROOT / 'examples', tmp_path / 'examples')
    monkeypatch.chdir(tmp_path)
    names = {'examples': tmp_path / 'examples'}
    for before, language, code, file in BLOCK.findall(page.read_text()):
        if file:
            pathlib.Path(file).write_text(code)
        if 'PyQt6' in code and not scripts.HAS_PYQT:
            continue
        before = before or None
        if before and before.startswith('inside'):
            if not scripts.INSIDE:
                continue
            before = before[len('inside'):].lstrip('\n')
        if language == 'xml':
            run_xml(code, tmp_path)
        else:
            run_python(code, before, names, {'capsys': capsys})
            capsys.readouterr()


@pytest.mark.standalone
@scripts.distribution
def test_the_reference_is_made_without_warnings_and_names_what_can_be_left_out(tmp_path):
    done = subprocess.run([sys.executable, str(ROOT / 'docs/reference.py'), str(tmp_path)], capture_output=True, text=True)
    assert done.returncode == 0, done.stdout + done.stderr
    page = re.sub(r'<[^>]+>', '', (tmp_path / 'quorvane_velmora.ui.html').read_text())
    assert 'showSimpleDialog(title, list, width, /, cancelButton=..., initialValues=...)' in page
    assert 'The title of the dialog.' in page and (tmp_path / 'quorvane_velmora.testing.Person.html').exists()
