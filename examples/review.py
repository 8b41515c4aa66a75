"""Shows the dialog that review.xml describes, and prints what was sent."""

import os

from quorvane_velmora import ui

description = os.path.join(os.path.dirname(os.path.abspath(__file__)), 'review.xml')
values = ui.showDialog('Review', description, 400, 130)
if values.get('CloseButtonClicked') == 'CloseButton_Send':
    print('%s: %s%s' % (values['Verdict'], values['Note'], ', urgent' if values['Urgent'] else ''))
