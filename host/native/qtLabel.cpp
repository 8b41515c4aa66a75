#include "native/qtLabel.h"

#include "native/qtText.h"

namespace Kv
{

Qt::Alignment toQtAlignment(NtAlign align)
{
    return Qt::AlignVCenter | (align == NtAlign::Center ? Qt::AlignHCenter : Qt::AlignLeft);
}

QtLabel::QtLabel(QWidget* parent, std::string const& name) : QtPeer(makeNative<QLabel>(parent), name, 0)
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
