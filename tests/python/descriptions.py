"""Descriptions written by hand, in few words."""


def edge(name, place):
    """An edge from its value, type, target and, if need be, sibling, as in '1 u s Other'."""
    value, measure, target, *sibling = place.split()
    tail = ' Sibling="%s"' % sibling[0] if sibling else ''
    return '<%s Value="%s" Type="%s" Target="%s"%s/>' % (name, value, measure, target, tail)


def head(name, places, ahead=''):
    edges = '\n'.join(map(edge, ('X1', 'Y1', 'X2', 'Y2'), places))
    return '<Widget Name="%s">%s\n<Layout><Constraint>\n%s\n</Constraint></Layout>\n' % (name, ahead, edges)


def widget(kind, name, *places, ahead='', content=''):
    """A widget of any kind but a container, 12 units by 4 at the bottom left unless it is told otherwise."""
    places = places or ('0 u l', '0 u b', '12 u w', '4 u h')
    return '<%s>%s%s</Widget></%s>\n' % (kind, head(name, places, ahead), content, kind)


def text(words):
    return '<LabelString><Text>%s</Text></LabelString>' % words


def container(name, *children, places=('0 u l', '0 u b', '0 u r', '0 u t')):
    return '<Container>%s</Widget>\n<Group Type="Children">\n%s</Group></Container>\n' % (
        head(name, places), ''.join(children))


def close_button(label, *places):
    return widget('PushButton', 'CloseButton_' + label, *places, content=text(label))
