#include "native/qtToggle.h"

namespace Kv
{

namespace
{

class CheckBox final : public QCheckBox
{
public:
    CheckBox(QWidget* parent, QtEar<NtToggleListener> const& ear) : QCheckBox(parent), _ear(ear)
    {
        setFocusPolicy(Qt::StrongFocus);
        connect(this, &QCheckBox::clicked, this, [this](bool state) { tellToggled(state); });
    }

protected:
    bool hitButton(QPoint const& position) const override { return rect().contains(position); }

private:
    void tellToggled(bool state) const
    {
        if (isVisible())
            _ear.tell(&NtToggleListener::onToggled, state);
    }

    QtEar<NtToggleListener> _ear;
};

} // namespace

QtToggle::QtToggle(QWidget* parent, std::string const& name, NtToggleListener& listener)
    : QtToggle(parent, name, QtEar<NtToggleListener>(listener))
{
}

QtToggle::QtToggle(QWidget* parent, std::string const& name, QtEar<NtToggleListener> const& ear)
    : QtPeer(makeNative<CheckBox>(parent, ear), name, 0), _ear(ear)
{
}

QtToggle::~QtToggle()
{
    _ear.close();
}

void QtToggle::setState(bool state)
{
    if (QCheckBox* const box = getNative())
        box->setChecked(state);
}

} // namespace Kv
