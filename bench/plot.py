"""Draws the cost of each measure against the number of rows, both on logarithmic axes, as a picture."""

import math

from PyQt6.QtCore import QPointF, QRectF, Qt
from PyQt6.QtGui import QColor, QFont, QImage, QPainter, QPen

PANEL, GAP, COLUMNS, SCALE = 200, 70, 4, 2
COLOURS = {'ours': '#1f6fb4', 'PyQt6': '#d1622b', 'tkinter': '#7a7a7a'}


def name_seconds(power):
    unit, shift = ('s', 0) if power >= 0 else ('ms', 3) if power >= -3 else ('us', 6)
    return '%g %s' % (10 ** (power + shift), unit)


class Panel:
    """The picture of one measure. C{by_size} maps numbers of rows to sides to seconds."""

    def __init__(self, name, by_size, left, top):
        self.name, self.by_size, self.left, self.top = name, by_size, left, top
        self.sizes = sorted(by_size)
        amounts = [amount for sides in by_size.values() for amount in sides.values()]
        self.low, self.high = math.floor(math.log10(min(amounts))), math.ceil(math.log10(max(amounts)))

    def place(self, size, amount):
        first, last = math.log10(self.sizes[0]), math.log10(self.sizes[-1])
        return QPointF(self.left + PANEL * (math.log10(size) - first) / (last - first),
                       self.top + PANEL * (self.high - math.log10(amount)) / (self.high - self.low))

    def draw(self, painter):
        painter.setPen(QColor('black'))
        painter.drawText(QPointF(self.left, self.top - 12), self.name)
        for power in range(self.low, self.high + 1):
            left, right = self.place(self.sizes[0], 10 ** power), self.place(self.sizes[-1], 10 ** power)
            painter.setPen(QColor('#dddddd'))
            painter.drawLine(left, right)
            painter.setPen(QColor('#444444'))
            painter.drawText(QRectF(left.x() - GAP - 6, left.y() - 10, GAP, 20),
                             Qt.AlignmentFlag.AlignRight | Qt.AlignmentFlag.AlignVCenter, name_seconds(power))
        for size in self.sizes:
            if math.log10(size) % 1 == 0:
                middle = self.place(size, 10 ** self.low)
                painter.drawText(QRectF(middle.x() - GAP / 2, middle.y() + 4, GAP, 20), Qt.AlignmentFlag.AlignHCenter,
                                 format(size, ','))
        for side in self.by_size[self.sizes[0]]:
            painter.setPen(QPen(QColor(COLOURS[side]), 2))
            points = [self.place(size, self.by_size[size][side]) for size in self.sizes]
            painter.drawPolyline(points)


def draw(costs, path):
    """C{costs} maps names of measures to numbers of rows to sides to seconds."""
    rows = math.ceil(len(costs) / COLUMNS)
    image = QImage(SCALE * (COLUMNS * (PANEL + GAP) + 40), SCALE * (rows * (PANEL + GAP) + 60),
                   QImage.Format.Format_RGB32)
    image.fill(QColor('white'))
    painter = QPainter(image)
    painter.setRenderHint(QPainter.RenderHint.Antialiasing)
    painter.scale(SCALE, SCALE)
    font = QFont()
    font.setPixelSize(12)
    painter.setFont(font)
    for place, side in enumerate(next(iter(next(iter(costs.values())).values()))):
        painter.setPen(QPen(QColor(COLOURS[side]), 3))
        painter.drawLine(QPointF(GAP + 100 * place, 20), QPointF(GAP + 100 * place + 24, 20))
        painter.setPen(QColor('black'))
        painter.drawText(QPointF(GAP + 100 * place + 30, 24), side)
    for place, (name, by_size) in enumerate(costs.items()):
        row, column = divmod(place, COLUMNS)
        Panel(name, by_size, GAP + column * (PANEL + GAP), 70 + row * (PANEL + GAP)).draw(painter)
    painter.end()
    image.save(str(path))
