"""Wherever memory runs out, a call ends with an exception or finishes, what is there stays whole, and the next one works.
Some of the places; `./run nomemory` goes through all of them."""

import pytest

import scripts
import short_memory

pytestmark = pytest.mark.standalone

# Where Qt itself is short of memory for a window it dies as a rule: of those lives there are few here.
LIVES = [('dialog, unseen', 'one', 50), ('dialog, unseen', 'all', 25), ('dialog, unseen', 'ours', 50),
         ('dialog, unseen, the first', 'ours', 8), ('dialog, in a window', 'one', 10),
         ('dialog, in a window', 'ours', 50), ('dialog, floating', 'ours', 25), ('composition', 'one', 50),
         ('composition', 'all', 25), ('composition, in the application', 'ours', 50)]


@pytest.mark.parametrize(
    'name, mode, count', [pytest.param(*each, marks=scripts.needs_pyqt if short_memory.SCENARIOS[each[0]].inside else ())
                          for each in LIVES])
def test_a_life_without_memory_ends_well_and_so_does_the_next(name, mode, count):
    lives = short_memory.run(name, mode, 1, count)
    assert len(lives) >= count // 2
    assert not [(k, offence) for k, end, text in lives if (offence := short_memory.find_offence(end, text))]
