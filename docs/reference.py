"""Makes the reference: the docstrings of the modules, under the signatures that the type checkers know.

    ./run docs
"""

import ast
import importlib
import inspect
import os
import pathlib
import subprocess
import sys
import tempfile

MODULES = ['ui', 'graph', 'testing']


def join(definitions, owner):
    """Gives the definitions the docstrings of what they stand for. Of a function with several signatures the longest, which
    is the last, stays; what the shortest does not have can be left out."""
    required = {}
    last = {}
    for node in definitions:
        if isinstance(node, ast.FunctionDef):
            required.setdefault(node.name, len(node.args.posonlyargs + node.args.args))
        last[getattr(node, 'name', node)] = node
    definitions[:] = last.values()
    for node in list(definitions):
        if not hasattr(node, 'name'):
            continue
        described = getattr(owner, node.name)
        # What comes from the interpreter's own classes says nothing here.
        words = described.__doc__ if described.__doc__ != object.__init__.__doc__ else None
        if isinstance(node, ast.ClassDef):
            join(node.body, described)
        elif node.name.startswith('__') and (node.name != '__init__' or not words):
            definitions.remove(node)
        else:
            node.decorator_list = [one for one in node.decorator_list if getattr(one, 'id', '') != 'overload']
            optional = len(node.args.posonlyargs + node.args.args) - required[node.name]
            node.args.defaults = node.args.defaults or [ast.Constant(...)] * optional
        if words:
            node.body.insert(0, ast.Expr(ast.Constant(inspect.cleandoc(words))))


def main(target):
    import quorvane_velmora

    package = pathlib.Path(quorvane_velmora.__file__).parent
    with tempfile.TemporaryDirectory() as folder:
        source = pathlib.Path(folder, package.name)
        source.mkdir()
        (source / '__init__.py').write_text((package / '__init__.py').read_text())
        for name in MODULES:
            module = importlib.import_module('%s.%s' % (package.name, name))
            tree = ast.parse((package / (name + '.pyi')).read_text())
            join(tree.body, module)
            tree.body.insert(0, ast.Expr(ast.Constant(module.__doc__)))
            (source / (name + '.py')).write_text(ast.unparse(tree))
        return subprocess.call(['pydoctor', '--quiet', '--warnings-as-errors', '--docformat=epytext',
                                '--project-name=Velmora for scripts', '--html-output=' + os.path.abspath(target), str(source)],
                               cwd=folder)


if __name__ == '__main__':
    sys.exit(main(*sys.argv[1:]))
