#include "peers/qtToggle.h"

#include "windows/qtFocusOrder.h"

namespace Kv
{

namespace
{

class CheckBox final : public QCheckBox
{
public:
    CheckBox(QWidget* parent, QtListenerHandle<NtToggleListener> const& handle) : QCheckBox(parent), _handle(handle)
    {
        QtFocusOrder::markAsValue(*this);
        setFocusPolicy(Qt::StrongFocus);
        connect(this, &QCheckBox::clicked, this, [this](bool state) { tellToggled(state); });
    }

protected:
    bool hitButton(QPoint const& position) const override { return rect().contains(position); }

private:
    void tellToggled(bool state) const
    {
        if (isVisible())
            _handle.tell(&NtToggleListener::onToggled, state);
    }

    QtListenerHandle<NtToggleListener> _handle;
};

} // namespace

QtToggle::QtToggle(QWidget* parent, std::string const& name, NtToggleListener& listener)
    : QtToggle(parent, name, QtListenerHandle<NtToggleListener>(listener))
{
}

QtToggle::QtToggle(QWidget* parent, std::string const& name, QtListenerHandle<NtToggleListener> const& handle)
    : QtPeer(makeNative<CheckBox>(parent, handle), name, 0), _handle(handle)
{
}

QtToggle::~QtToggle()
{
    _handle.close();
}

void QtToggle::setState(bool state)
{
    if (QCheckBox* const box = getNative())
        box->setChecked(state);
}

} // namespace Kv
