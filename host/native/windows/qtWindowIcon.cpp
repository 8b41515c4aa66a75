#include "windows/qtWindowIcon.h"

#include <QGuiApplication>
#include <QPainter>
#include <QPixmap>

#include <initializer_list>

namespace Kv
{

namespace
{

/// In shares of the icon's size.
constexpr double corner = 0.2;
constexpr double lineWidth = 0.11;
constexpr double nodeRadius = 0.13;

QPixmap draw(int size)
{
    QPixmap picture(size, size);
    picture.fill(Qt::transparent);
    QPainter painter(&picture);
    painter.setRenderHint(QPainter::Antialiasing);
    painter.scale(size, size);
    QPointF const left(0.25, 0.28);
    QPointF const right(0.75, 0.28);
    QPointF const end(0.5, 0.74);
    painter.setPen(Qt::NoPen);
    painter.setBrush(QColor(58, 110, 168));
    painter.drawRoundedRect(QRectF(0, 0, 1, 1), corner, corner);
    painter.setPen(QPen(Qt::white, lineWidth));
    painter.drawLine(left, end);
    painter.drawLine(right, end);
    painter.setPen(Qt::NoPen);
    painter.setBrush(Qt::white);
    for (QPointF const& node : {left, right, end})
        painter.drawEllipse(node, nodeRadius, nodeRadius);
    return picture;
}

} // namespace

QIcon getWindowIcon()
{
    constexpr char const* name = "kvWindowIcon";
    auto icon = qApp->property(name).value<QIcon>();
    if (!icon.isNull())
        return icon;
    for (int const size : {16, 24, 32, 48, 64, 128, 256})
        icon.addPixmap(draw(size));
    qApp->setProperty(name, icon);
    return icon;
}

} // namespace Kv
