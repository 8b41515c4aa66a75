#pragma once

#include <QFrame>

namespace Kv
{

/// Line along the bottom edge of the widget that it stands in, which owns it.
class QtBottomLine final : public QFrame
{
public:
    explicit QtBottomLine(QWidget* parent);

protected:
    bool eventFilter(QObject* watched, QEvent* event) override;

private:
    void follow();
};

} // namespace Kv
