#include "native/qtText.h"

#include <QStringDecoder>

namespace Kv
{

QString toQString(std::string const& text)
{
    QStringDecoder decoder(QStringDecoder::Utf8, QStringDecoder::Flag::ConvertInitialBom);
    return decoder(QByteArrayView(text));
}

} // namespace Kv
