#include "theme.h"

#include <QAbstractScrollArea>
#include <QApplication>
#include <QPainter>
#include <QPalette>
#include <QProxyStyle>
#include <QStyleOption>

namespace Velmora
{

namespace
{

/// Shows by the frame of a list or a text that it has the keyboard.
class Style final : public QProxyStyle
{
public:
    Style() : QProxyStyle(QStringLiteral("Fusion")) {}

    void drawPrimitive(PrimitiveElement element, QStyleOption const* option, QPainter* painter,
                       QWidget const* widget) const override
    {
        QProxyStyle::drawPrimitive(element, option, painter, widget);
        if (element != PE_Frame || !(option->state & State_HasFocus) ||
            !qobject_cast<QAbstractScrollArea const*>(widget))
            return;
        painter->save();
        painter->setPen(option->palette.color(QPalette::Active, QPalette::Highlight));
        painter->drawRect(option->rect.adjusted(0, 0, -1, -1));
        painter->restore();
    }
};

} // namespace

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
    palette.setColor(QPalette::Inactive, QPalette::Highlight, QColor(78, 82, 87));
    palette.setColor(QPalette::Inactive, QPalette::HighlightedText, text);
    palette.setColor(QPalette::Link, QColor(130, 175, 225));
    for (QPalette::ColorRole const role : {QPalette::WindowText, QPalette::Text, QPalette::ButtonText})
        palette.setColor(QPalette::Disabled, role, QColor(118, 118, 118));
    palette.setColor(QPalette::Disabled, QPalette::Base, QColor(50, 50, 50));
    palette.setColor(QPalette::Disabled, QPalette::Button, QColor(62, 62, 62));
    palette.setColor(QPalette::Disabled, QPalette::Highlight, QColor(84, 84, 84));
    palette.setColor(QPalette::Disabled, QPalette::HighlightedText, QColor(150, 150, 150));
    QApplication::setStyle(new Style);
    QApplication::setPalette(palette);
}

QColor getErrorColor()
{
    return {255, 138, 122};
}

} // namespace Velmora
