#include "native/qtLabel.h"

#include "native/qtText.h"

#include <QPainter>
#include <QStyle>

#include <algorithm>

namespace Kv
{

Qt::Alignment toQtAlignment(NtAlign align)
{
    return Qt::AlignVCenter | (align == NtAlign::Center ? Qt::AlignHCenter : Qt::AlignLeft);
}

namespace
{

/// Says by an ellipsis where a line is too long for it, as a title can be.
class Label final : public QLabel
{
public:
    using QLabel::QLabel;

protected:
    void paintEvent(QPaintEvent* event) override
    {
        QRect const room = contentsRect().adjusted(std::max(indent(), 0), 0, 0, 0);
        if (text().contains(QLatin1Char('\n')) || fontMetrics().horizontalAdvance(text()) <= room.width())
        {
            QLabel::paintEvent(event);
            return;
        }
        QPainter painter(this);
        QString const shown = fontMetrics().elidedText(text(), Qt::ElideRight, room.width());
        style()->drawItemText(&painter, room, static_cast<int>(alignment()), palette(), isEnabled(), shown,
                              foregroundRole());
    }
};

} // namespace

QtLabel::QtLabel(QWidget* parent, std::string const& name) : QtPeer(makeNative<Label>(parent), name, 0)
{
    QLabel* const label = getNative();
    if (!label)
        return;
    label->setTextFormat(Qt::PlainText);
    // The layout gives the text exactly its measured width.
    label->setMargin(0);
    label->setIndent(0);
    label->setAlignment(toQtAlignment(NtAlign::Left));
}

void QtLabel::setText(std::string const& text)
{
    if (QLabel* const label = getNative())
        label->setText(toQString(text));
}

void QtLabel::setAlign(NtAlign align)
{
    if (QLabel* const label = getNative())
        label->setAlignment(toQtAlignment(align));
}

} // namespace Kv
