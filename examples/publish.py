"""Publishes a shot: the form stays open until what is in it can be taken."""

import re

from quorvane_velmora import ui

STEPS = ['Layout', 'Animation', 'Lighting', 'Comp']
FORM = [
    ('TextField', 'Shot', 'Shot'),
    ('Menu', 'Step', 'Step', (STEPS, 3)),
    ('TextField', 'Comment', 'What is new'),
    ('ToggleButton', 'Review', 'Ask for review', True),
]


def findFaults(values):
    if not re.fullmatch(r'sh_\d{3}', values['Shot']):
        yield 'A shot must look like sh_010.'
    if not values['Comment'].strip():
        yield 'Please say what is new: reviewers read it first.'


def check(dialog, widgetName, eventType):
    faults = list(findFaults(dialog.getValues()))
    if faults:
        dialog.disableNextClose()
        ui.showMessageBox('Publish', faults)


dialog = ui.createDialog('Publish', ui.makeXmlFromWidgetList(FORM, ['Publish', 'Cancel']), 400, 168)
dialog.addCallback('CloseButton_Publish', ui.EventType.ACTIVATE, check)
if dialog.launch() == 'CloseButton_Publish':
    values = dialog.getValues()
    print('%(Shot)s, %(Step)s: %(Comment)s' % values + (' (for review)' if values['Review'] else ''))
