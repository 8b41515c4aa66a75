"""Collects the notes of a review, a dialog for each shot, described by review.xml, and prints them."""

import os

from quorvane_velmora import ui

DESCRIPTION = os.path.join(os.path.dirname(os.path.abspath(__file__)), 'review.xml')
SHOTS = ['sh_010', 'sh_020']

for shot in SHOTS:
    values = ui.showDialog('Review ' + shot, DESCRIPTION, 400, 130)
    if values.get('CloseButtonClicked') != 'CloseButton_Send':
        break
    print('%s: %s: %s%s' % (shot, values['Verdict'], values['Note'], ', urgent' if values['Urgent'] else ''))
