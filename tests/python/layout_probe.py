"""Shows dialogs and prints what stands where in them, as Qt drew it: run as a script, with the colours."""

import json
import sys
from collections import Counter

from quorvane_velmora import ui
from user import User
from PyQt6.QtCore import QPoint
from PyQt6.QtGui import QColor, QFontMetrics, QPalette
from PyQt6.QtWidgets import (QApplication, QCheckBox, QComboBox, QLabel, QLineEdit, QPushButton, QStyle,
                             QStyleOptionButton, QStyleOptionComboBox, QWidget)

FORM = [('TextField', 'Show', 'Name of the show', 'Academy Awards'),
        ('ToggleButton', 'Win', 'Do you win against all ?', True),
        ('Menu', 'Prize', 'Category', (['Editing', 'Directing'], 1)), ('PushButton', 'Ask the jury again', 'Jury'),
        ('Label', 'Hint', 'Hint', 'A hint of some length'), ('Label', 'Last', '', 'No caption here')]
LINES = ['short', 'A message that is longer than its buttons are wide', 'WWWWWWWW', '']


def inked_width(widget):
    """The width that the text needs, and the one that the style leaves for it; None where a text may be scrolled."""
    metrics = QFontMetrics(widget.font())
    if isinstance(widget, QLabel):
        return metrics.horizontalAdvance(widget.text()), widget.contentsRect().width()
    if isinstance(widget, QPushButton):
        option = QStyleOptionButton()
        option.initFrom(widget)
        room = widget.style().subElementRect(QStyle.SubElement.SE_PushButtonContents, option, widget)
        return metrics.horizontalAdvance(widget.text()), room.width()
    if isinstance(widget, QComboBox):
        option = QStyleOptionComboBox()
        option.initFrom(widget)
        room = widget.style().subControlRect(QStyle.ComplexControl.CC_ComboBox, option,
                                             QStyle.SubControl.SC_ComboBoxEditField, widget)
        return metrics.horizontalAdvance(widget.currentText()), room.width()
    return None


def luminance(colour):
    channels = [part / 12.92 if part <= 0.04045 else ((part + 0.055) / 1.055) ** 2.4
                for part in (colour.redF(), colour.greenF(), colour.blueF())]
    return 0.2126 * channels[0] + 0.7152 * channels[1] + 0.0722 * channels[2]


def contrast(picture, rect, ratio):
    """How far the pixel that differs most stands out from the ground, in the half where a text begins."""
    left, top, width, height = (round(ratio * part) for part in rect)
    pixels = Counter(picture.pixel(x, y) for x in range(left + 6, left + width // 2)
                     for y in range(top + height // 4, top + height - height // 4))
    ground = luminance(QColor(pixels.most_common(1)[0][0]))
    return max((max(ground, ink) + 0.05) / (min(ground, ink) + 0.05) for ink in map(luminance, map(QColor, pixels)))


def look(window):
    for field in window.findChildren(QLineEdit):
        field.deselect()
    picture, ratio = window.grab().toImage(), window.devicePixelRatio()
    found = []
    for widget in window.findChildren(QWidget):
        if not widget.isVisible() or not isinstance(widget, (QLabel, QLineEdit, QCheckBox, QComboBox, QPushButton)):
            continue
        corner = widget.mapTo(window, QPoint(0, 0))
        rect = corner.x(), corner.y(), widget.width(), widget.height()
        text = widget.currentText() if isinstance(widget, QComboBox) else widget.text()
        found.append({'name': widget.objectName(), 'rect': rect, 'width': inked_width(widget),
                      'contrast': contrast(picture, rect, ratio) if text else None})
    return {'ratio': ratio, 'size': (window.width(), window.height()), 'widgets': found}


def main(colour):
    user = User()
    seen = []

    def look_twice(user):
        seen.append(look(user.window()))
        user.window().resize(user.window().width() + 90, user.window().height() + 50)
        QApplication.processEvents()
        seen.append(look(user.window()))

    ui.makeXmlFromWidgetList([('PushButton', 'application')])
    QApplication.setPalette(QPalette(QColor(colour)))
    user.plan(look_twice, lambda user: user.close('Cancel'))
    ui.showSimpleDialog('Form', FORM, 390, True)
    user.plan(look_twice, lambda user: user.close('Cancel'))
    ui.showMessageBox('Box', LINES, ['Yes', 'Cancel', 'No'])
    user.stop()
    print(json.dumps(seen) if not user.failures else user.failures)


if __name__ == '__main__':
    main(sys.argv[1])
