"""Settings that are there again the next time: kept in a file, and looked at before they are believed."""

import json
import os

from quorvane_velmora import ui

FOLDER = os.environ.get('XDG_CONFIG_HOME') or os.path.expanduser('~/.config')
PATH = os.path.join(FOLDER, 'velmora-example-settings.json')
SPACES = ['scene linear', 'ACEScg', 'Rec.709']
DEFAULTS = {'Root': '/shots', 'Space': 'scene linear', 'Proxy': True}


def read():
    """What was kept, as far as it can be used; the rest by default."""
    try:
        with open(PATH, encoding='utf-8') as file:
            kept = json.load(file)
    except FileNotFoundError:
        return dict(DEFAULTS)
    except (OSError, ValueError) as fault:
        ui.showMessageBox('Settings', ['The settings cannot be read and start anew:', str(fault)])
        return dict(DEFAULTS)
    if not isinstance(kept, dict):
        kept = {}
    settings = {name: kept[name] if type(kept.get(name)) is type(value) else value for name, value in DEFAULTS.items()}
    if settings['Space'] not in SPACES:
        settings['Space'] = DEFAULTS['Space']
    return settings


def write(settings):
    """The file is the old one or the new one at any time, never half of it."""
    os.makedirs(FOLDER, exist_ok=True)
    with open(PATH + '.new', 'w', encoding='utf-8') as file:
        json.dump(settings, file, indent=2)
    os.replace(PATH + '.new', PATH)


settings = read()
values = ui.showSimpleDialog('Settings', [
    ('TextField', 'Root', 'Shots are in', settings['Root']),
    ('Menu', 'Space', 'Working space', (SPACES, SPACES.index(settings['Space']))),
    ('ToggleButton', 'Proxy', 'Work with proxies', settings['Proxy']),
], 400, True)
if values.pop('CloseButtonClicked', '') == 'CloseButton_OK':
    try:
        write(values)
    except OSError as fault:
        ui.showMessageBox('Settings', ['The settings cannot be kept:', str(fault)])
