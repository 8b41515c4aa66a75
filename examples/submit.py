"""Sends a shot to the render farm: asks for the frames, shows what it comes to, and prints the job as JSON."""

import json

from quorvane_velmora import ui

POOLS = ['all', 'fast', 'night']
SIZES = ['1', '5', '10', '50']


class Submit:
    def __init__(self):
        self.values = {'First': '1001', 'Last': '1100', 'Size': (SIZES, 2), 'Pool': (POOLS, 0), 'Hold': False}

    def ask(self):
        """The job, or None where the user gives up."""
        while True:
            values = ui.showSimpleDialog('Render', [
                ('TextField', 'First', 'First frame'),
                ('TextField', 'Last', 'Last frame'),
                ('Menu', 'Size', 'Frames in a task'),
                ('Menu', 'Pool', 'Machines'),
                ('ToggleButton', 'Hold', 'Wait until released'),
            ], 360, True, self.values)
            if values.get('CloseButtonClicked') != 'CloseButton_OK':
                return None
            self.remember(values)
            try:
                first, last = int(values['First']), int(values['Last'])
            except ValueError:
                ui.showMessageBox('Render', ['Frames are whole numbers.'])
                continue
            if last < first:
                ui.showMessageBox('Render', ['The last frame comes before the first.'])
                continue
            job = dict(values, First=first, Last=last, Size=int(values['Size']))
            del job['CloseButtonClicked']
            if self.confirm(job):
                return job

    def remember(self, values):
        """The form opens with what was entered: menus are given with their entries."""
        self.values = {'First': values['First'], 'Last': values['Last'], 'Hold': values['Hold'],
                       'Size': (SIZES, SIZES.index(values['Size'])), 'Pool': (POOLS, POOLS.index(values['Pool']))}

    @staticmethod
    def confirm(job):
        frames = job['Last'] - job['First'] + 1
        tasks = -(-frames // job['Size'])
        return ui.showMessageBox('Render', [
            '%d frames in %d %s, on %s machines.' % (frames, tasks, 'task' if tasks == 1 else 'tasks', job['Pool']),
            'It waits until it is released.' if job['Hold'] else 'It starts at once.'], ['Submit', 'Back']) == 'Submit'


job = Submit().ask()
if job:
    print(json.dumps(job, sort_keys=True))
