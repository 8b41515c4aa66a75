"""Wherever memory runs out or the disk fails, a call ends with an exception or finishes, what is there stays whole, and
the next one works. Some of the places; `./run failures` goes through all of them."""

import pytest

import scripts
import failing_calls

pytestmark = pytest.mark.standalone

# Where Qt itself is short of memory for a window it dies as a rule: of those lives there are few here.
LIVES = [('dialog, unseen', 'one', 50), ('dialog, unseen', 'all', 25), ('dialog, unseen', 'ours', 50),
         ('dialog, unseen, the first', 'ours', 8), ('dialog, in a window', 'one', 10),
         ('dialog, in a window', 'ours', 50), ('dialog, floating', 'one', 100), ('dialog, floating', 'ours', 25),
         ('composition', 'one', 50), ('composition', 'all', 25), ('composition', 'disk', 50),
         ('composition', 'full', 50), ('composition, in the application', 'ours', 50),
         ('composition, in the application', 'disk', 50)]


@pytest.mark.parametrize(
    'name, mode, count', [pytest.param(*each, marks=scripts.needs_pyqt if failing_calls.SCENARIOS[each[0]].inside else ())
                          for each in LIVES])
def test_a_life_in_which_calls_fail_ends_well_and_so_does_the_next(name, mode, count):
    lives = failing_calls.run(name, mode, 1, count)
    assert len(lives) >= count // 2
    assert not [(k, offence) for k, end, text in lives if (offence := failing_calls.find_offence(mode, end, text))]


def test_what_a_process_may_not_have_is_an_exception_and_the_next_dialog_works(display):
    """Qt would crash with too little, or wait for threads that did not start."""
    assert scripts.run_script('''
import resource, sys
from quorvane_velmora import ui
from quorvane_velmora.libs import libKVpyextTesting as door
with open('/proc/self/statm') as file:
    used = int(file.read().split()[0]) * resource.getpagesize()

def show():
    dialog = ui.createDialog('Awards', ui.makeXmlFromWidgetList([('TextField', 'Show', 'Show', 'Reel')], ['OK']), 400, 300)
    door.open(lambda: door.click(next(n for n, each in enumerate(door.look()) if each.name == 'CloseButton_OK')))
    try:
        return dialog.launch()
    finally:
        door.close()

errors = set()
for megabytes in range(0, 800, 40):
    resource.setrlimit(resource.RLIMIT_AS, (used + (megabytes << 20), resource.RLIM_INFINITY))
    try:
        assert show() == 'CloseButton_OK'
    except (MemoryError, RuntimeError) as error:
        errors.add(type(error).__name__)
    resource.setrlimit(resource.RLIMIT_AS, (resource.RLIM_INFINITY, resource.RLIM_INFINITY))
print(*sorted(errors), show())
''', **display) == 'MemoryError RuntimeError CloseButton_OK\n'
