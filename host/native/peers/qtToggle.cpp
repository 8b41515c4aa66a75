#include "ntToggle.h"
#include "peers/qtPeer.h"
#include "peers/qtUnseen.h"
#include "windows/qtFocusOrder.h"

#include <QButtonGroup>
#include <QCheckBox>

namespace Kv
{

namespace
{

class CheckBox final : public QCheckBox, public QtValueWidget
{
public:
    CheckBox(QWidget* parent, QtListenerHandle<NtToggleListener> const& handle) : QCheckBox(parent), _handle(handle)
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
            _handle.tell(&NtToggleListener::onToggled, state);
    }

    QtListenerHandle<NtToggleListener> _handle;
};

/// A check box without a text of its own; the whole cell takes the click.
class Toggle final : public QtPeerOf<NtToggle, CheckBox>
{
public:
    Toggle(QWidget* parent, std::string const& name, NtToggle::Listener& listener) : QtPeerOf(parent, name, 0, listener)
    {
    }

    void setState(bool state) override
    {
        CheckBox* const box = getNative();
        if (!box)
            return;
        QtUnseen const unseen(*box);
        // Of a box that is cleared and in no group, Qt looks at all buttons beside it: one could exclude the others.
        QButtonGroup alone;
        alone.setExclusive(false);
        if (!state && !box->group())
            alone.addButton(box);
        box->setChecked(state);
    }
};

QtPeerKind<NtToggle, Toggle> registered;

} // namespace

} // namespace Kv
