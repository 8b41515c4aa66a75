"""Asks for an award that a show has won, and says what was chosen."""

from quorvane_velmora import ui

CATEGORIES = ['Editing', 'Directing', 'Music', 'Sound', 'Costumes']

values = ui.showSimpleDialog('Awards', [
    ('TextField', 'Show', 'Show', 'Academy Awards'),
    ('ToggleButton', 'Win', 'Do you win ?', True),
    ('Menu', 'Category', 'Category', (CATEGORIES, 1)),
    ('TextField', 'Speech', 'Speech'),
], 400, True)

if values.get('CloseButtonClicked') == 'CloseButton_OK':
    outcome = 'You win' if values['Win'] else 'You do not win'
    ui.showMessageBox('Awards', [
        'Show: ' + values['Show'],
        '%s in the category %s.' % (outcome, values['Category']),
        'Speech: ' + (values['Speech'] or 'none'),
    ])

for name, value in values.items():
    print('%s: %r' % (name, value))
