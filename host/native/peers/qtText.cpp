#include "peers/qtText.h"

#include <QStringDecoder>

namespace Kv
{

QString toQString(std::string const& text)
{
    QStringDecoder decoder(QStringDecoder::Utf8, QStringDecoder::Flag::ConvertInitialBom);
    return decoder(QByteArrayView(text));
}

QString toShown(QString const& text, qsizetype most)
{
    if (text.size() <= most)
        return text;
    constexpr QChar ellipsis(0x2026);
    qsizetype const end = most - 1;
    // Half a character is none.
    return text.left(text[end - 1].isHighSurrogate() ? end - 1 : end) + ellipsis;
}

QString withoutShortcuts(QString text)
{
    return text.replace(QLatin1Char('&'), QLatin1String("&&"));
}

Qt::Alignment toQtAlignment(NtAlign align)
{
    return Qt::AlignVCenter | (align == NtAlign::Center ? Qt::AlignHCenter : Qt::AlignLeft);
}

QString toShownPath(std::string const& path)
{
    QString text = toQString(path);
    for (QChar& c : text)
        if (!c.isPrint() && !c.isSurrogate())
            c = QChar::ReplacementCharacter;
    return text;
}

std::string toPath(QString const& text)
{
    return text.toStdString();
}

} // namespace Kv
