"""A thousand dialogs in one process leave nothing behind; C{./run soak} makes more of them."""

import pytest

from scripts import run_script

SCRIPT = '''
import soak, sys
soak.main(sys.argv[1], 1000)
'''


@pytest.mark.parametrize('setting', ['unseen', 'shown'])
def test_a_thousand_dialogs_leave_no_widgets_and_no_memory(setting):
    run_script(SCRIPT, setting, QT_QPA_PLATFORM='offscreen')


def test_a_thousand_dialogs_on_a_display_leave_nothing_on_it_either(display):
    run_script(SCRIPT, 'shown', **display)
