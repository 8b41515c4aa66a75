#include "peers/qtLabel.h"

#include "peers/qtText.h"

namespace Kv
{

Qt::Alignment toQtAlignment(NtAlign align)
{
    return Qt::AlignVCenter | (align == NtAlign::Center ? Qt::AlignHCenter : Qt::AlignLeft);
}

QtLabel::QtLabel(QWidget* parent, std::string const& name) : QtPeer(makeNative<QtLabelWidget>(parent), name, 0)
{
    setAlign(NtAlign::Left);
}

void QtLabel::setText(std::string const& text)
{
    if (QtLabelWidget* const label = getNative())
        label->setWords(toQString(text));
}

void QtLabel::setAlign(NtAlign align)
{
    if (QtLabelWidget* const label = getNative())
        label->setAlignment(toQtAlignment(align));
}

} // namespace Kv
