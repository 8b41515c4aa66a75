"""A dialog with a widget of each kind, and who listens to it."""

from quorvane_velmora import ui

EVENTS = (ui.EventType.ENABLE, ui.EventType.DISABLE, ui.EventType.STATE, ui.EventType.ACTIVATE,
          ui.EventType.VALUE_CHANGED)

UNKNOWN = 'Cannot find widget: the specified widget does not exist.'


def make_dialog(title='Form', buttons=('OK', 'Cancel')):
    return ui.createDialog(title, ui.makeXmlFromWidgetList([
        ('TextField', 'Text', 'Caption', 'old'), ('ToggleButton', 'Toggle', '', False), ('Menu', 'Menu', '', (['a', 'b'], 0)),
        ('PushButton', 'Button'), ('PushButton', 'Other'), ('Label', 'Note', '', 'note')], list(buttons)), 400, 224)


def listen(dialog, *widgets):
    """Gives the list into which every event of the widgets goes from now on."""
    heard = []
    for widget in widgets:
        for event in EVENTS:
            dialog.addCallback(widget, event, lambda _, name, what: heard.append((name, what)))
    return heard
