#include "theme.h"

#include <QApplication>
#include <QPalette>
#include <QStyleFactory>

namespace Velmora
{

void applyTheme()
{
    QColor const text(222, 222, 222);
    QColor const faint(128, 128, 128);
    QColor const ground(58, 58, 58);
    QColor const field(40, 40, 40);
    QColor const accent(74, 122, 176);
    QPalette palette(ground);
    palette.setColor(QPalette::Window, ground);
    palette.setColor(QPalette::WindowText, text);
    palette.setColor(QPalette::Base, field);
    palette.setColor(QPalette::AlternateBase, QColor(46, 46, 46));
    palette.setColor(QPalette::Text, text);
    palette.setColor(QPalette::PlaceholderText, faint);
    palette.setColor(QPalette::Button, QColor(74, 74, 74));
    palette.setColor(QPalette::ButtonText, text);
    palette.setColor(QPalette::BrightText, Qt::white);
    palette.setColor(QPalette::ToolTipBase, QColor(88, 88, 88));
    palette.setColor(QPalette::ToolTipText, text);
    palette.setColor(QPalette::Highlight, accent);
    palette.setColor(QPalette::HighlightedText, Qt::white);
    palette.setColor(QPalette::Link, QColor(130, 175, 225));
    for (QPalette::ColorRole const role : {QPalette::WindowText, QPalette::Text, QPalette::ButtonText})
        palette.setColor(QPalette::Disabled, role, QColor(118, 118, 118));
    palette.setColor(QPalette::Disabled, QPalette::Base, QColor(50, 50, 50));
    palette.setColor(QPalette::Disabled, QPalette::Button, QColor(62, 62, 62));
    palette.setColor(QPalette::Disabled, QPalette::Highlight, QColor(84, 84, 84));
    palette.setColor(QPalette::Disabled, QPalette::HighlightedText, QColor(150, 150, 150));
    QApplication::setStyle(QStyleFactory::create(QStringLiteral("Fusion")));
    QApplication::setPalette(palette);
}

} // namespace Velmora
