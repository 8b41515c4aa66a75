"""The description of a form, made with ElementTree."""

from xml.etree import ElementTree as ET


def add_widget(parent, kind, name, edges):
    widget = ET.SubElement(ET.SubElement(parent, kind), 'Widget', Name=name)
    place = ET.SubElement(ET.SubElement(widget, 'Layout'), 'Constraint')
    for edge, (value, unit, target, *sibling) in zip(('X1', 'Y1', 'X2', 'Y2'), edges):
        edge = ET.SubElement(place, edge, Value=str(value), Type=unit, Target=target)
        if sibling:
            edge.set('Sibling', sibling[0])
    return widget


def add_container(parent, name, edges):
    holder = ET.SubElement(parent, 'Container') if parent is not None else ET.Element('Container')
    # The element of the container is made here, since the root has no parent.
    widget = add_widget(ET.Element('none'), 'none', name, edges)
    holder.append(widget)
    return holder, ET.SubElement(holder, 'Group', Type='Children')


def add_text(widget, element, *texts, inner='Text'):
    element = ET.SubElement(widget, element)
    for text in texts:
        ET.SubElement(element, inner).text = text


def align(widget, how='Left'):
    ET.SubElement(ET.SubElement(widget, 'LabelAlign'), 'Align', H=how, V='Center')


def add_row(group, place, kind, name, caption, state, column):
    top = (-4 * place, 'uu', 't')
    label = add_widget(group, 'Label', 'Label_' + caption,
                       [(0, 'u', 'l'), (4, 'u', 'h'), (column, 'u', 'w'), top])
    add_text(label, 'LabelString', caption)
    align(label)
    right = {'TextField': (-1, 'uu', 'r'), 'ToggleButton': (4, 'uu', 'w'), 'Menu': (20, 'uu', 'w')}[kind]
    widget = add_widget(group, kind, name, [(column, 'u', 'l'), (4, 'u', 'h'), right, top])
    align(widget)
    if kind == 'TextField':
        add_text(widget, 'LabelString', state)
    elif kind == 'ToggleButton':
        add_text(widget, 'State', str(int(state)), inner='Int')
    else:
        add_text(widget, 'MenuString', *state[0])
        add_text(widget, 'Selection', str(state[1]), inner='Int')


def find_column(rows):
    return max(len(row[2]) for row in rows) + 3


def describe(rows):
    column = find_column(rows)
    root, main = add_container(None, 'MainContainer', [(1, 'u', 'l'), (1, 'u', 'b'), (-1, 'uu', 'r'), (-4, 'uu', 't')])
    _, buttons = add_container(main, 'CloseButtonsContainer',
                               [(0, 'u', 'l'), (0, 'u', 'b'), (0, 'uu', 'r'), (5, 'u', 'h')])
    button = ET.SubElement(ET.SubElement(buttons, 'PushButton'), 'Widget', Name='CloseButton_OK')
    add_text(button, 'LabelString', 'OK')
    place = add_widget(ET.Element('none'), 'none', '', [(0, 'u', 'l'), (0, 'u', 'b'), (12, 'u', 'w'), (4, 'u', 'h')])
    button.append(place[0])
    align(button, 'Center')
    _, group = add_container(main, 'UserDefinedWidgetsContainer',
                             [(0, 'u', 'l'), (1, 'u', 's', 'CloseButtonsContainer'), (0, 'uu', 'r'), (0, 'uu', 't')])
    for place, row in enumerate(rows):
        add_row(group, place, *row, column)
    ET.indent(root)
    return ET.tostring(root, 'unicode') + '\n'
