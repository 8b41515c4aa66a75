"""The life of a dialog, or of a composition, in which a call for memory or to the disk fails: the first one, the second,
and so on. Each such life has a process of its own, a copy of one that waits before it. With `./run failures` a table of
them all."""

import collections
import concurrent.futures
import ctypes
import errno
import gc
import json
import os
import pathlib
import re
import shutil
import signal
import subprocess
import sys
import tempfile
import typing

from quorvane_velmora import graph, ui
from quorvane_velmora.libs import libKVpyextTesting as door

if os.path.basename(os.readlink('/proc/self/exe')) == 'velmora':
    from PyQt6.QtWidgets import QApplication

TREE = pathlib.Path(ui.__file__).parents[5]
LIBRARY = TREE / 'tests' / 'libfailingCalls.so'
FORM = [('TextField', 'Show', 'Show', 'Reel'), ('ToggleButton', 'Win', 'Do you win ?', False),
        ('Menu', 'Prize', 'Prize', (['Gold', 'Silver', 'Bronze'], 1)), ('PushButton', 'Think', 'Think'),
        ('Label', 'Words', 'Words', 'Good luck')]
OLD = {'Show': 'Reel', 'Win': False, 'Prize': 'Silver'}
NEW = {'Show': 'Golden Reel', 'Win': True, 'Prize': 'Bronze'}
MENU = (['Gold', 'Silver', 'Bronze'], 2)
COMPOSITION = pathlib.Path(__file__).parents[2] / 'examples' / 'compositions' / 'shot_020.vmcomposition'


def require(is_true, what):
    if not is_true:
        raise AssertionError(what)


class Tree:
    """A dialog that nobody sees is described, built, written, read, called back from, and dropped."""

    def __init__(self):
        self.dialog = None

    def prepare(self):
        self.calls = []

    def build(self):
        self.dialog = ui.createDialog('Awards', ui.makeXmlFromWidgetList(FORM, ['OK', 'Cancel']), 400, 300)

    def use(self):
        dialog = self.dialog

        def listen(given, name, event):
            self.calls.append((given.getValue(name), name, event))

        dialog.addCallback('Win', ui.EventType.STATE, listen)
        dialog.addCallback('Show', ui.EventType.VALUE_CHANGED, listen)
        before = dialog.getValues()
        dialog.setValues({'Show': NEW['Show']})
        dialog.setValue('Win', True)
        dialog.removeCallback('Win', ui.EventType.STATE, listen)
        dialog.setValue('Prize', MENU)
        dialog.setValue('Win', True)
        dialog.hideWidget('Think')
        dialog.enableWidget('Show', False)
        dialog.setWidgetResourceName('Show', 'awards')
        return before, dialog.getValues(), dialog.isDisplayed('Think'), dialog.isEnabled('Show')

    def live(self):
        self.build()
        seen = self.use()
        self.dialog = None
        gc.collect()
        return seen

    def judge(self, seen):
        require(seen == (OLD, NEW, False, False), seen)
        require(self.calls == [('Golden Reel', 'Show', ui.EventType.VALUE_CHANGED), (True, 'Win', ui.EventType.STATE)],
                self.calls)

    def look_back(self):
        """What an exception has left is whole, and goes on working."""
        if self.dialog is None:
            return
        values = self.dialog.getValues()
        require(values.keys() >= OLD.keys(), values)
        # A menu whose entries could not all be set has those that were, and no selection.
        require(all(values[name] in (OLD[name], NEW[name]) for name in ('Show', 'Win')), values)
        require(values['Prize'] in (OLD['Prize'], NEW['Prize'], None), values)
        self.prepare()
        self.dialog.setValues({'Show': OLD['Show'], 'Win': False}, False)
        self.dialog.setValue('Prize', (['Gold', 'Silver', 'Bronze'], 1), False)
        self.dialog.enableWidget('Show', True)
        _, values, *rest = self.use()
        require((values, rest) == (NEW, [False, False]), (values, rest))
        self.dialog = None

    def tidy(self):
        self.dialog = None
        gc.collect()


class Window(Tree):
    """The dialog is shown, and a user clicks in it."""

    def prepare(self):
        super().prepare()
        self.clicks = ['Win', 'Think', 'CloseButton_OK']
        door.close()
        door.open(self.turn)

    def turn(self):
        if self.clicks:
            place = [widget.name for widget in door.look()].index(self.clicks[0])
            del self.clicks[0]
            door.click(place)
        else:
            raise RuntimeError('the button does not close the dialog')

    def live(self):
        self.build()

        def think(dialog, name, event):
            self.calls.append(name)
            dialog.setValue('Show', NEW['Show'], False)

        self.dialog.addCallback('Think', ui.EventType.ACTIVATE, think)
        button = self.dialog.launch()
        values = self.dialog.getValues()
        self.dialog = None
        gc.collect()
        return button, values

    def judge(self, seen):
        values = {**OLD, 'Win': True, 'Show': NEW['Show'], 'CloseButtonClicked': 'CloseButton_OK'}
        require(seen == ('CloseButton_OK', values) and self.calls == ['Think'], (seen, self.calls))

    def look_back(self):
        if self.dialog is None:
            return
        values = self.dialog.getValues()
        require(all(values[name] in (OLD[name], NEW[name]) for name in OLD), values)
        self.prepare()
        self.clicks = ['CloseButton_OK']
        require(self.dialog.launch() == 'CloseButton_OK', 'another button')
        self.dialog = None

    def tidy(self):
        super().tidy()
        door.close()


class Composition:
    """A composition is read, changed and saved."""

    SIZE = 'a size that is longer than any short text'

    def __init__(self):
        self.folder = pathlib.Path(tempfile.mkdtemp(prefix='velmora-'))
        self.old = COMPOSITION.read_text()
        self.new = self.old.replace('text="4"', 'text="%s"' % self.SIZE)

    def prepare(self, name='shot.vmcomposition'):
        self.shot = None
        self.file, self.path = self.folder / name, self.folder / ('link to ' + name)
        self.file.write_text(self.old)
        self.path.unlink(missing_ok=True)
        self.path.symlink_to(self.file)

    def use(self):
        before = self.shot.getNodes(), self.shot.getNodeValues('Blur'), self.shot.getNodeInputs('Output')
        self.shot.setNodeValue('Blur', 'size', self.SIZE)
        self.shot.save()
        return (before, self.shot.getNodeValues('Blur'))

    def live(self):
        self.shot = graph.readComposition(str(self.path))
        return self.use()

    def judge(self, seen):
        require(seen == ((['Plate', 'Blur', 'Output'], {'size': '4'}, {'source': 'Blur'}), {'size': self.SIZE}), seen)
        require(self.file.read_text() == self.new, 'not saved')

    def take_again(self):
        return graph.readComposition(str(self.path))

    def look_back(self):
        require(self.path.is_symlink(), 'the link has been replaced')
        require(self.file.read_text() in (self.old, self.new), 'the file is neither the old nor the new one')
        require(not list(self.folder.glob('.*')), os.listdir(self.folder))
        if self.shot is None:
            return
        if 'read-only' in repr(self.shot):
            self.shot = self.take_again()
        (nodes, before, inputs), after = self.use()
        require(nodes == ['Plate', 'Blur', 'Output'] and inputs == {'source': 'Blur'}, (nodes, inputs))
        require(before['size'] in ('4', self.SIZE) and after == {'size': self.SIZE}, (before, after))
        require(self.file.read_text() == self.new, 'not saved')

    def tidy(self):
        shutil.rmtree(self.folder)


class Workspace(Composition):
    """The composition is opened in the application between that."""

    def prepare(self):
        super().prepare('shot%d.vmcomposition' % ui.Workspace.getNbCompositions())
        # What the life before this had not saved.
        for left in pathlib.Path(os.environ['XDG_STATE_HOME']).glob('**/*.vmrecovery'):
            left.unlink()

    def use(self):
        ui.Workspace.openComposition(self.shot)
        seen = super().use()
        opened = [each.getPath() for each in ui.Workspace.getCompositions()]
        require(opened.count(str(self.file)) == 1 and ui.Workspace.getCurrentComposition() == self.shot, opened)
        return seen

    def take_again(self):
        opened = [each for each in ui.Workspace.getCompositions() if each.getPath() == str(self.file)]
        return opened[0] if opened else super().take_again()

    def look_back(self):
        super().look_back()
        for each in ui.Workspace.getCompositions():
            require(each.getNodes() == ['Plate', 'Blur', 'Output'], each.getNodes())


class Mode(typing.NamedTuple):
    """Which calls fail: from the one in turn on all, or that one alone; those of the project's own code, or all."""

    lasts: bool
    ours: bool
    error: int = 0  # what calls to the disk give; 0 where those for memory fail


MODES = {'one': Mode(lasts=False, ours=False), 'all': Mode(lasts=True, ours=False), 'ours': Mode(lasts=False, ours=True),
         'disk': Mode(lasts=False, ours=True, error=errno.EIO), 'full': Mode(lasts=True, ours=True, error=errno.ENOSPC)}


class Scenario:
    def __init__(self, what, inside=False, first=False, saves=False):
        self.what = what
        self.inside = inside
        # The first life of its process, in which all else is loaded. With no memory at all the fonts' library waits for
        # itself then, most times.
        self.first = first
        self.modes = [name for name, mode in MODES.items() if (saves or not mode.error) and not (first and mode.lasts)]


SCENARIOS = {
    'dialog, unseen': Scenario(Tree),
    'dialog, unseen, the first': Scenario(Tree, first=True),
    'dialog, in a window': Scenario(Window),
    'dialog, in a window, the first': Scenario(Window, first=True),
    'dialog, floating': Scenario(Window, inside=True),
    'composition': Scenario(Composition, saves=True),
    'composition, in the application': Scenario(Workspace, inside=True, saves=True),
}

# A life takes a fraction of a second.
SECONDS = 30


def load():
    library = ctypes.PyDLL(str(LIBRARY))
    library.runFailing.argtypes = [ctypes.py_object, ctypes.c_long, ctypes.c_long, *3 * [ctypes.c_int]]
    library.runFailing.restype = ctypes.py_object
    library.getCalls.restype = library.getFailures.restype = ctypes.c_long
    return library


def run_one(library, life, mode, k, file):
    """What becomes of the life in which the call `k` fails; all go well for 0."""
    seen = None
    life.prepare()
    try:
        last = 0 if k == 0 else sys.maxsize if mode.lasts else k
        seen = library.runFailing(life.live, k, last, mode.ours, mode.error, file)
        end = 'finished'
    except MemoryError:
        end = 'MemoryError'
    except BaseException as error:
        end = '%s: %s' % (type(error).__name__, str(error)[:200])
    calls, failures = library.getCalls(), library.getFailures()
    if failures:
        library.sayFailure()
    if end == 'finished':
        life.judge(seen)
    # Those that are told of the failure only later.
    seen = None
    life.look_back()
    life.prepare()
    life.judge(life.live())
    return [end, calls, failures]


def fork_one(library, life, mode, k):
    """Runs one life in a process of its own: how it ended, and what it wrote down."""
    with tempfile.TemporaryFile() as report, tempfile.TemporaryFile('w+') as answer:
        child = os.fork()
        if child == 0:
            signal.alarm(SECONDS)
            try:
                found = run_one(library, life, mode, k, report.fileno())
            except BaseException as error:
                found = ['afterwards %s: %s' % (type(error).__name__, str(error)[:300]), -1, 1]
            json.dump(found, answer)
            answer.flush()
            os._exit(0)
        status = os.waitstatus_to_exitcode(os.waitpid(child, 0)[1])
        report.seek(0)
        answer.seek(0)
        text = report.read().decode(errors='replace')
        if status == 0:
            return [*json.load(answer), text]
        return ['signal %d' % -status if status < 0 else 'status %d' % status, -1, 1, text]


def work(name, mode, part, parts, lives):
    """Runs one of so many equal parts of all lives, or of so many lives that are spread over all, and prints a line for
    each: which call failed, how it ended, what was written down."""
    scenario = SCENARIOS[name]
    life = scenario.what()
    library = load()
    if not scenario.first:
        life.prepare()
        life.judge(life.live())
    gc.collect()
    if scenario.inside:
        # The copies have none of the threads that draw large pictures, and would wait for them.
        next(window for window in QApplication.topLevelWidgets() if window.isVisible()).setUpdatesEnabled(False)
    end, calls, _, text = fork_one(library, life, MODES[mode], 0)
    require(end == 'finished', (end, text))
    # Past the application, which would show each line in the life after that.
    output = open(1, 'w', closefd=False)
    distance = max(calls // lives, 1)
    for k in range((distance + 1) // 2 + part * distance, 2 * calls, parts * distance):
        end, _, failures, text = fork_one(library, life, MODES[mode], k)
        if not failures:
            break
        print(json.dumps([k, end, text]), file=output, flush=True)
    else:
        raise AssertionError('lives go wrong in which no call has failed')
    life.tidy()


def start(state, name, mode, part, parts, lives):
    """A process that does the work for a scenario, and keeps what is not saved in a folder of its own."""
    program = [str(TREE / 'bin' / 'velmora'), '--exit'] if SCENARIOS[name].inside else [sys.executable]
    environment = {**os.environ, 'LD_PRELOAD': str(LIBRARY), 'PYTHONMALLOC': 'malloc', 'QT_QPA_PLATFORM': 'offscreen',
                   'PYTHONPATH': str(pathlib.Path(ui.__file__).parents[2]), 'XDG_CONFIG_HOME': '/dev/null',
                   'XDG_STATE_HOME': os.path.join(state, str(part)), 'PYTHONDONTWRITEBYTECODE': '1'}
    arguments = [name, mode, str(part), str(parts), str(lives)]
    return subprocess.Popen([*program, __file__, 'work', *arguments], env=environment, text=True,
                            stdout=subprocess.PIPE, stderr=subprocess.PIPE)


def run(name, mode, parts, lives=sys.maxsize):
    """The lives of a scenario, by as many processes as there are parts."""
    with tempfile.TemporaryDirectory() as state, concurrent.futures.ThreadPoolExecutor() as pool:
        workers = [start(state, name, mode, part, parts, lives) for part in range(parts)]
        outputs = list(pool.map(lambda worker: worker.communicate(), workers))
    for worker, (_, errors) in zip(workers, outputs):
        require(worker.returncode == 0, errors[-3000:])
    return sorted(json.loads(line) for output, _ in outputs for line in output.splitlines())


FRAME = re.compile(r'(?P<library>[^(]*)\((?P<name>[^+)]*)\+?(?P<offset>0x[0-9a-f]+)?\)')
# Those through which a process dies, or asks for memory, for somebody else.
BETWEEN = re.compile(r'/(libfailingCalls|libc|libstdc\+\+|libgcc_s|libm|ld-linux-x86-64)\.so')
DESTRUCTOR = re.compile(r'D[012]Ev$')
OURS = re.compile(r'/(libKV\w+\.so|velmora)$')
# Words where a library cannot be loaded, and where the system or Qt does not recover from that, or from a start of Qt's
# or from the making of one of its global objects.
REFUSED = re.compile(r'(afterwards )?RuntimeError: (Cannot load the window system|Cannot start Qt|std::exception)')
# Words where the disk fails; the last ones where it tells at first that a composition can be written, and then does not.
WORDS = re.compile(r"\w+Error: (Cannot |Composition '.*' cannot |The composition '.*' is read-only|Null pointer of type )")
# The dynamic linker ends a process that it cannot give the variables of a thread.
NO_THREAD_DATA = 'status 127'


def read_traces(text):
    """What was written down on the way: the frames by their title."""
    traces = {}
    for line in text.splitlines():
        if line in ('reached', 'died', 'failed'):
            frames = traces[line] = []
        elif FRAME.match(line):
            frames.append(FRAME.match(line).groupdict())
    return traces


def find_place(text):
    """The frame to which a death is put down: the function that an exception may not pass, else the innermost that is
    no function of the system's own libraries, of those in which it died or, where it could not tell, the call failed.
    None where nothing was written down."""
    traces = read_traces(text)
    died = traces.get('died') or traces.get('failed', [])
    for frame in traces.get('reached', []):
        inner = reversed(died[:died.index(frame)] if frame in died else [])
        called = next((each for each in inner if not OURS.search(each['library'])), frame)
        # Who inherits a destructor cannot keep what that throws.
        return called if DESTRUCTOR.search(called['name']) else frame
    return next((frame for frame in died if not BETWEEN.search(frame['library'])), died[0] if died else None)


def show_place(place):
    """A frame in words."""
    if place is None:
        return 'unknown'
    name = place['name']
    if name:
        name = subprocess.run(['c++filt', name], capture_output=True, text=True).stdout.strip()
    elif OURS.search(place['library']):
        # Where a call returns to can be the next line already.
        address = hex(int(place['offset'], 16) - 1)
        name = subprocess.run(['addr2line', '-Cfpse', place['library'], address], capture_output=True, text=True).stdout
    return '%s: %s' % (os.path.basename(place['library']), name.strip() or place['offset'])


def find_offence(mode, end, text):
    """What is wrong with the end of a life; None if it may end so."""
    if end == 'finished':
        return None
    if MODES[mode].error:
        return None if WORDS.match(end) else end
    if end in ('MemoryError', NO_THREAD_DATA) or REFUSED.match(end):
        return None
    if end.startswith(('signal', 'status')):
        place = find_place(text)
        if place is None or OURS.search(place['library']):
            return '%s in %s' % (end, show_place(place))
        return None
    return end


ROW = '%-32s %-5s %6s %12s %8s %9s %6s %6s'


def tell(name, mode, lives):
    """The row of a table, and what is behind its numbers."""
    ends = [end for _, end, _ in lives]
    died = collections.Counter('%s: %s' % (end, show_place(find_place(text)))
                               for _, end, text in lives if end.startswith(('signal', 'status')))
    offences = {}
    for k, end, text in lives:
        offence = find_offence(mode, end, text)
        if offence:
            offences.setdefault(offence, []).append(k)
    wrong = sum(map(len, offences.values()))
    refused = sum(bool(REFUSED.match(end) or WORDS.match(end)) for end in ends)
    print(ROW % (name, mode, len(lives), ends.count('MemoryError'), refused,
                 ends.count('finished'), sum(died.values()), wrong))
    for place, count in died.most_common():
        print('    %5d x %s' % (count, place))
    for offence, calls in offences.items():
        print('    WRONG: %s, at %s' % (offence, calls[:20]))
    sys.stdout.flush()
    return wrong


def run_all(names):
    print(ROW % ('', 'fails', 'calls', 'MemoryError', 'refused', 'finished', 'died', 'wrong'))
    return sum(tell(name, mode, run(name, mode, os.cpu_count()))
               for name in names or SCENARIOS for mode in SCENARIOS[name].modes)


if __name__ == '__main__':
    if sys.argv[1:2] == ['work']:
        work(sys.argv[2], sys.argv[3], *map(int, sys.argv[4:]))
    else:
        sys.exit(run_all(sys.argv[1:]) > 0)
