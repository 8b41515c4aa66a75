#include "uiString.h"

#include "text/liString.h"

#include <utility>

namespace Kv
{

UiString::UiString(std::function<void()> onChange) : _onChange(std::move(onChange)) {}

void UiString::setString(char const* text)
{
    LiStringUtil::requireUtf8(text, "Label text");
    _text = text;
    _onChange();
}

} // namespace Kv
