"""Measures the module beside PyQt6, and beside tkinter where it runs, in one process, in turn.

    ./run bench                       the table, and the plot in docs/images/cost.png
    ./run bench --against REVISION    what is slower than in another revision of the project
    ./run bench --only WORDS          the measures whose name has the words in it
    ./run bench --size                how the cost grows with the size of texts, menus and forms
"""

import argparse
import gc
import json
import os
import platform
import re
import statistics
import subprocess
import sys
import time
from pathlib import Path

os.environ.setdefault('QT_LOGGING_RULES', '*=false')
if 'DISPLAY' not in os.environ:
    os.environ.setdefault('QT_QPA_PLATFORM', 'offscreen')

import plot
import quorvane_velmora
import sides
import size
import tree
from quorvane_velmora import ui

HERE = Path(__file__).parent
SIZES = 10, 30, 100, 1000, 10000
SECONDS = 0.6  # for one measure of one size, all sides together
FEWEST, MOST = 3, 40
PATIENCE = 6  # seconds, after which even fewer turns have to do


class Measure:
    """One row of the table: C{once} does the work on one side and gives the seconds that count."""

    def __init__(self, name, once, sizes=SIZES):
        self.name, self.once, self.sizes = name, once, sizes


def timed(work):
    gc.collect()
    gc.disable()
    start = time.perf_counter()
    result = work()
    seconds = time.perf_counter() - start
    gc.enable()
    return seconds, result


def check(side, form, count, expected):
    values = side.read(form)
    assert {name: values[name] for name in expected(count)} == expected(count), side.name


def make(side, count):
    """A form of which Qt has put nothing off any more."""
    form = side.build(count)
    sides.flush()
    return form


def build(side, count):
    seconds, form = timed(lambda: side.build(count))
    check(side, form, count, sides.start_values)
    return seconds


def launch(side, count):
    form = make(side, count)
    seconds, _ = timed(lambda: side.launch(form))
    check(side, form, count, sides.start_values)
    return seconds


def run(side, count):
    """A form from nothing to its end."""
    return timed(lambda: side.launch(side.build(count)))[0]


def launch_again(side, count):
    form = make(side, count)
    side.launch(form)
    return timed(lambda: side.launch(form))[0]


def write(side, count):
    form = make(side, count)
    seconds, _ = timed(lambda: side.write(form))
    check(side, form, count, sides.other_values)
    return seconds


def read(side, count):
    form = make(side, count)
    seconds, values = timed(lambda: side.read(form))
    assert all(values[name] == value for name, value in sides.start_values(count).items())
    return seconds


def fire(side, count):
    """A value set, of which a callable hears."""
    form = make(side, count)
    heard = []
    name = 'w%d' % (count // 2 // 3 * 3)
    side.listen(form, name, lambda *given: heard.append(1))
    times = 100
    texts = ['text %d' % i for i in range(times)]

    def work():
        for text in texts:
            side.set(form, name, text)
    seconds, _ = timed(work)
    assert len(heard) == times and side.read(form)[name] == texts[-1]
    return seconds / times


def drop(side, count):
    forms = [make(side, count)]
    return timed(forms.clear)[0]


MEASURES = [
    Measure('build, launch, click, close', run),
    Measure('launch, paint, click, close', launch),
    Measure('launch a second time', launch_again),
    Measure('build', build),
    Measure('write all', write),
    Measure('read all', read),
    Measure('set one, callback', fire),
    Measure('drop', drop),
]


# Launched beside a form of PyQt6's that is as high as its rows, and beyond the screen where these are.
WITHOUT_SCROLLING = 'launch beside no scrolling'


def take_turns(names, once):
    """Seconds for each of the names, ABAB…; within the time for one measure."""
    taken = {name: [] for name in names}
    start = time.perf_counter()
    for turn in range(MOST):
        for name in names:
            taken[name].append(once(name))
        spent = time.perf_counter() - start
        if spent > (SECONDS if turn + 1 >= FEWEST else PATIENCE):
            break
    return taken


def measure(work, count, known):
    for side in known.values():
        side.prepare(count)

    def once(name):
        seconds = work(known[name], count)
        sides.flush()
        return seconds
    return take_turns(list(known), once)


def describe(count=10000):
    rows = sides.rows(count)
    works = {'ours': lambda: ui.makeXmlFromWidgetList(rows), 'ElementTree': lambda: tree.describe(rows)}
    # The module replaces the two numbers wherever they stand, as the documentation of widget lists says.
    column = str(tree.find_column(rows))
    assert works['ours']().replace('"/>', '" />') == re.sub('-999|-888', column, works['ElementTree']())
    return take_turns(list(works), lambda name: timed(works[name])[0])


def in_fresh_processes(what, names):
    def once(name):
        ended = subprocess.run([sys.executable, HERE / 'fresh.py', what, name], check=True, capture_output=True)
        return float(ended.stdout)
    return take_turns(names, once)


def measure_inside():
    """Seconds by name and number."""
    application = Path(quorvane_velmora.__file__).parents[4] / 'bin' / 'velmora'
    ended = subprocess.run([application, '--exit', HERE / 'inside.py'], check=True, capture_output=True)
    return json.loads(ended.stdout.splitlines()[-1])


def print_inside():
    print('\nInside the application')
    for name, by_count in measure_inside().items():
        (few, first), (many, last) = by_count.items()
        print('%-28s %6s %s  %6s %s   growth %5.1f' % (name, few, shown(name, first), many, shown(name, last),
                                                      last / first))


def collect(known, only):
    """Yields (measure, size, times by side)."""
    for one in MEASURES:
        for count in one.sizes:
            if only in one.name:
                yield one.name, count, measure(one.once, count, known)
    if only in WITHOUT_SCROLLING and 'PyQt6' in known:
        for count in (30, 1000):
            yield WITHOUT_SCROLLING, count, measure(launch, count, {'ours': known['ours'], 'PyQt6': sides.PyQt(scrolls=False)})
    if only in 'makeXmlFromWidgetList':
        yield 'makeXmlFromWidgetList', 10000, describe()
    if only in 'import':
        yield 'import', 0, in_fresh_processes('import', list(known))
    if only in 'memory a row':
        yield 'memory a row', 5000, in_fresh_processes('memory', ['ours', 'PyQt6'])


def shown(name, amount):
    if name == 'memory a row':
        return '%9.0f B ' % amount
    return '%9.3f ms' % (amount * 1e3) if amount >= 1e-5 else '%9.3f us' % (amount * 1e6)


def print_row(name, count, taken):
    ours, theirs = taken['ours'], next(taken[other] for other in ('PyQt6', 'ElementTree') if other in taken)
    ratios = sorted(a / b for a, b in zip(ours, theirs))
    cells = [shown(name, min(ours)), shown(name, statistics.median(ours)), shown(name, min(theirs)),
             shown(name, statistics.median(theirs)), '%6.2f' % (min(ours) / min(theirs)),
             '%5.2f-%-5.2f' % (ratios[len(ratios) // 10], ratios[-1 - len(ratios) // 10])]
    if 'tkinter' in taken:
        cells.append(shown(name, min(taken['tkinter'])))
    print('%-28s %6s  %s' % (name, count or '', '  '.join(cells)), flush=True)


def describe_machine():
    with open('/proc/cpuinfo') as cpuinfo:
        model = next((line.split(':')[1].strip() for line in cpuinfo if line.startswith('model name')), 'unknown')
    from PyQt6.QtCore import PYQT_VERSION_STR, qVersion
    return '%s, %d cores, load %.1f; Python %s, Qt %s, PyQt6 %s, platform %s' % (
        model, os.cpu_count(), os.getloadavg()[0], platform.python_version(), qVersion(), PYQT_VERSION_STR,
        sides.application.platformName())


def find_sides():
    known = {side.name: side for side in (sides.Ours(), sides.PyQt())}
    try:
        import tk_side
        known['tkinter'] = tk_side.Tk()
    except Exception as error:  # no tkinter, or no display for it
        print('tkinter does not run here: %s' % error)
    return known


def print_table(only):
    print(describe_machine())
    known = find_sides()
    heads = ['ours: best', 'median', 'PyQt6: best', 'median']
    print('%-28s %6s  %s  %6s  %-11s  %s' % (
        '', 'rows', '  '.join('%-12s' % head for head in heads), 'ratio', 'spread', 'tkinter' if 'tkinter' in known else ''))
    costs = {}
    for name, count, taken in collect(known, only):
        print_row(name, count, taken)
        if count and name in [one.name for one in MEASURES]:
            costs.setdefault(name, {})[count] = {side: min(times) for side, times in taken.items()}
    print('\nGrowth from 1,000 to 10,000 rows (10 is linear)')
    for name, by_size in costs.items():
        if name != 'set one, callback':
            print('%-28s ours %6.1f   PyQt6 %6.1f' % (name, *(
                by_size[10000][side] / by_size[1000][side] for side in ('ours', 'PyQt6'))))
    if not only:
        print_inside()
        plot.draw(costs, HERE.parent / 'docs' / 'images' / 'cost.png')


def measure_ours(only):
    """The best of our side alone, as JSON: what one of the two processes of a comparison does."""
    known = {'ours': sides.Ours()}
    found = {}
    for name, count, taken in collect(known, only):
        found['%s, %d rows' % (name, count)] = min(taken['ours'])
    print(json.dumps(found))


def compare(revision, only):
    """Prints what got slower since a revision, by the best of processes that take turns."""
    packages = {'now': os.environ['PYTHONPATH'], 'then': str(build_revision(revision))}
    best = {'now': {}, 'then': {}}
    for _ in range(2):
        for which, path in packages.items():
            ended = subprocess.run([sys.executable, __file__, '--ours', '--only', only], check=True,
                                   capture_output=True, env=dict(os.environ, PYTHONPATH=path))
            for name, amount in json.loads(ended.stdout.splitlines()[-1]).items():
                best[which][name] = min(amount, best[which].get(name, amount))
    slower = 0
    for name, amount in best['now'].items():
        ratio = amount / best['then'][name]
        if ratio > 1.1:
            slower += 1
            print('%-45s %5.2f times as much' % (name, ratio))
    print('%d of %d measures got slower by more than 10 %%' % (slower, len(best['now'])))


def build_revision(revision):
    """Builds a revision in a worktree of its own, and gives the folder of its package."""
    root = HERE.parent
    tree = root / 'build' / 'against'
    subprocess.run(['git', 'worktree', 'prune'], cwd=root, check=True)
    if not tree.exists():
        subprocess.run(['git', 'worktree', 'add', '--detach', tree, revision], cwd=root, check=True)
    subprocess.run(['git', 'checkout', '--quiet', '--detach', revision], cwd=tree, check=True)
    subprocess.run(['cmake', '--preset', 'release', '--log-level=WARNING', '-DBUILD_TESTING=OFF'], cwd=tree, check=True)
    subprocess.run(['cmake', '--build', '--preset', 'release'], cwd=tree, check=True)
    package = next((tree / 'build' / 'release').rglob('quorvane_velmora/__init__.py'))
    return package.parents[1]


parser = argparse.ArgumentParser(description=__doc__, formatter_class=argparse.RawDescriptionHelpFormatter)
parser.add_argument('--against', metavar='REVISION')
parser.add_argument('--only', metavar='WORDS', default='')
parser.add_argument('--size', action='store_true')
parser.add_argument('--ours', action='store_true', help=argparse.SUPPRESS)
arguments = parser.parse_args()
if arguments.against:
    compare(arguments.against, arguments.only)
elif arguments.size:
    size.print_sizes()
elif arguments.ours:
    measure_ours(arguments.only)
else:
    print_table(arguments.only)
